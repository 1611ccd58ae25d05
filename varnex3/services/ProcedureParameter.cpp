#include "varnex3/services/ProcedureParameter.h"

#include <algorithm>
#include <array>
#include <string>

#include "varnex3/core/Conversions.h"
#include "varnex3/core/Error.h"

namespace varnex3 {

namespace {

struct TypeCode
{
    std::int16_t odbcType;
    DatabaseType type;
    DatabaseType unsignedType;
};

using enum DatabaseType;

constexpr std::array kTypeCodes{
    TypeCode{-7, Boolean, Boolean},
    TypeCode{-6, UnsignedTinyInt, UnsignedTinyInt}, // 0 to 255 in SQL Server
    TypeCode{5, SmallInt, UnsignedSmallInt},
    TypeCode{4, Integer, UnsignedInt},
    TypeCode{-5, BigInt, UnsignedBigInt},
    TypeCode{7, Single, Single},
    TypeCode{6, Double, Double},
    TypeCode{8, Double, Double},
    TypeCode{2, Numeric, Numeric},
    TypeCode{3, Numeric, Numeric},
    TypeCode{1, Char, Char},
    TypeCode{12, VarChar, VarChar},
    TypeCode{-1, LongVarChar, LongVarChar},
    TypeCode{-8, WChar, WChar},
    TypeCode{-9, VarWChar, VarWChar},
    TypeCode{-10, LongVarWChar, LongVarWChar},
    TypeCode{91, DBDate, DBDate},
    TypeCode{92, DBTime, DBTime},
    TypeCode{93, DBTimeStamp, DBTimeStamp},
    TypeCode{-2, Binary, Binary},
    TypeCode{-3, VarBinary, VarBinary},
    TypeCode{-4, LongVarBinary, LongVarBinary},
    TypeCode{-11, Guid, Guid},
};

using Conversion = Variant (*)(TextView text, std::int64_t size);

template <class Convert>
Variant UnlessMismatch(Convert convert, const Variant& otherwise)
{
    try {
        return convert();
    } catch (const Error& error) {
        if (error.Number() != static_cast<std::int32_t>(ErrorNumber::TypeMismatch))
            throw;
        return otherwise;
    }
}

Variant NarrowInteger(TextView text, std::int64_t)
{
    return UnlessMismatch([&] { return Variant(ToInt16(Text(text))); }, std::int16_t{0});
}
Variant WideInteger(TextView text, std::int64_t)
{
    return UnlessMismatch([&] { return Variant(ToInt32(Text(text))); }, std::int32_t{0});
}
Variant Fraction(TextView text, std::int64_t)
{
    return UnlessMismatch([&] { return Variant(NumberFrom(text)); }, 0.0);
}
Variant Moment(TextView text, std::int64_t)
{
    return UnlessMismatch([&] { return Variant(DateFrom(text)); }, Empty);
}
Variant Flag(TextView text, std::int64_t) { return ToBoolean(Text(text)); }
Variant AsItIs(TextView text, std::int64_t)
{
    if (text.size() > kLongestText)
        throw Error(ErrorNumber::Overflow, {},
                    Quoted(text) + u" has " + ToText(std::to_string(text.size())) + u" characters, more than the "
                        + ToText(std::to_string(kLongestText)) + u" of a database's longest text");
    return Text(text);
}
Variant Cut(TextView text, std::int64_t size)
{
    return size == kUnlimitedSize ? AsItIs(text, size) : Text(text.substr(0, static_cast<std::size_t>(size)));
}

struct ConversionRow
{
    DatabaseType type;
    Conversion conversion;
};

constexpr std::array kConversions{
    ConversionRow{SmallInt, NarrowInteger},
    ConversionRow{Integer, NarrowInteger}, // narrow although the type is not
    ConversionRow{TinyInt, NarrowInteger},
    ConversionRow{UnsignedTinyInt, NarrowInteger},
    ConversionRow{UnsignedInt, NarrowInteger}, // the same
    ConversionRow{Single, Fraction},
    ConversionRow{Double, Fraction},
    ConversionRow{Numeric, Fraction},
    ConversionRow{BigInt, WideInteger},
    ConversionRow{UnsignedBigInt, WideInteger},
    ConversionRow{AutomationDate, Moment},
    ConversionRow{DBDate, Moment},
    ConversionRow{DBTime, Moment},
    ConversionRow{DBTimeStamp, Moment},
    ConversionRow{Boolean, Flag},
    ConversionRow{Char, Cut},
    ConversionRow{VarChar, Cut},
};

} // namespace

DatabaseType DatabaseTypeOf(std::int16_t odbcType, TextView typeName)
{
    const auto* const found = std::ranges::find(kTypeCodes, odbcType, &TypeCode::odbcType);
    if (found == kTypeCodes.end())
        return DatabaseType::Other;
    const bool isUnsigned = typeName.ends_with(u"unsigned");
    return isUnsigned ? found->unsignedType : found->type;
}

Variant ConvertedText(TextView text, DatabaseType type, std::int64_t size)
{
    const auto* const found = std::ranges::find(kConversions, type, &ConversionRow::type);
    return (found == kConversions.end() ? AsItIs : found->conversion)(text, size);
}

} // namespace varnex3
