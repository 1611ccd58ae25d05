#include "varnex3/server/Values.h"

#include <cstring>
#include <new>

#include "varnex3/core/Conversions.h"
#include "varnex3/core/Error.h"
#include "varnex3/server/Face.h"

namespace varnex3::server {

namespace {

// The bytes of a variable that may be passed by reference; 0 for types that are not.
std::size_t SizeOf(VARTYPE type)
{
    switch (type) {
    case VT_I1:
    case VT_UI1:
        return 1;
    case VT_I2:
    case VT_UI2:
    case VT_BOOL:
        return 2;
    case VT_I4:
    case VT_UI4:
    case VT_INT:
    case VT_UINT:
    case VT_R4:
    case VT_ERROR:
        return 4;
    case VT_R8:
    case VT_DATE:
    case VT_CY:
    case VT_I8:
    case VT_UI8:
        return 8;
    case VT_BSTR:
    case VT_DISPATCH:
    case VT_UNKNOWN:
        return sizeof(void*);
    default:
        return 0;
    }
}

// The value of an object's default property: that of a field of a row set, for example.
std::optional<Variant> DefaultOf(IUnknown* object)
{
    IDispatch* dispatch = nullptr;
    if (FAILED(object->QueryInterface(IID_IDispatch, reinterpret_cast<void**>(&dispatch))))
        return std::nullopt;
    DISPPARAMS none{};
    OwnedVariant value;
    const HRESULT status = dispatch->Invoke(DISPID_VALUE, IID_NULL, LOCALE_INVARIANT, DISPATCH_PROPERTYGET, &none,
                                            &value, nullptr, nullptr);
    dispatch->Release();
    const bool isObject = V_VT(&value) == VT_DISPATCH || V_VT(&value) == VT_UNKNOWN;
    return FAILED(status) || isObject ? std::nullopt : ValueOf(value);
}

std::optional<Variant> ValueOf(IUnknown* object)
{
    if (!object)
        return Ref<Record>();
    if (Record* const record = RecordBehind(object))
        return Ref<Record>(record);
    return DefaultOf(object);
}

// Integers of other widths, currency and decimals; nothing for what is no number.
std::optional<Variant> NumberOf(const VARIANT& given)
{
    OwnedVariant number;
    const bool isNull = V_VT(&given) == VT_NULL || V_VT(&given) == VT_ERROR;
    if (isNull || FAILED(VariantChangeTypeEx(&number, const_cast<VARIANT*>(&given), LOCALE_INVARIANT, 0, VT_R8)))
        return std::nullopt;
    return V_R8(&number);
}

Variant Converted(const Variant& value, const Type& type)
{
    switch (type.kind) {
    case Kind::Text:
        return ToText(value);
    case Kind::Double:
        return ToDouble(value);
    case Kind::Date:
        return ToDate(value);
    case Kind::Int16:
        return ToInt16(value);
    case Kind::Int32:
    case Kind::Enumeration:
        return ToInt32(value);
    case Kind::Boolean:
        return ToBoolean(value);
    case Kind::Object:
        if (std::holds_alternative<Ref<Record>>(value))
            return value;
        throw Error(ErrorNumber::TypeMismatch, {}, u"an object of class " + ToText(type.name) + u" is required");
    case Kind::None:
    case Kind::Variant:
        break;
    }
    return value;
}

template <class T>
VARIANT Filled(VARTYPE type, T VARIANT::*place, T value)
{
    VARIANT filled{};
    V_VT(&filled) = type;
    filled.*place = value;
    return filled;
}

struct ForHost
{
    VARIANT operator()(EmptyValue) const { return {}; }
    VARIANT operator()(const Text& text) const { return Filled(VT_BSTR, &VARIANT::bstrVal, ToBstr(text)); }
    VARIANT operator()(double number) const { return Filled(VT_R8, &VARIANT::dblVal, number); }
    VARIANT operator()(std::int32_t number) const { return Filled(VT_I4, &VARIANT::lVal, LONG{number}); }
    VARIANT operator()(std::int16_t number) const { return Filled(VT_I2, &VARIANT::iVal, SHORT{number}); }
    VARIANT operator()(bool flag) const
    {
        return Filled(VT_BOOL, &VARIANT::boolVal, flag ? VARIANT_TRUE : VARIANT_FALSE);
    }
    VARIANT operator()(Date date) const { return Filled(VT_DATE, &VARIANT::date, DATE{date.serial}); }
    VARIANT operator()(const Ref<Record>& record) const
    {
        return Filled(VT_DISPATCH, &VARIANT::pdispVal, reinterpret_cast<IDispatch*>(Face::PortFor(record)));
    }
};

} // namespace

BSTR ToBstr(TextView text)
{
    const auto* const wide = reinterpret_cast<const OLECHAR*>(text.data());
    if (const BSTR made = SysAllocStringLen(wide, static_cast<UINT>(text.size())))
        return made;
    throw std::bad_alloc();
}

VARTYPE VarTypeOf(Kind kind)
{
    constexpr VARTYPE types[] = {VT_VOID, VT_BSTR, VT_R8, VT_DATE,     VT_I2,
                                 VT_I4,   VT_BOOL, VT_I4, VT_DISPATCH, VT_VARIANT};
    return types[static_cast<std::size_t>(kind)];
}

VARIANT Dereferenced(const VARIANT& given)
{
    if (V_VT(&given) == (VT_BYREF | VT_VARIANT))
        return Dereferenced(*V_VARIANTREF(&given));
    const auto type = static_cast<VARTYPE>(V_VT(&given) & ~VT_BYREF);
    const std::size_t size = SizeOf(type);
    if (!V_ISBYREF(&given) || size == 0)
        return given;
    VARIANT value{};
    V_VT(&value) = type;
    std::memcpy(&V_BYREF(&value), V_BYREF(&given), size);
    return value;
}

std::optional<Variant> ValueOf(const VARIANT& given)
{
    const VARIANT value = Dereferenced(given);
    switch (V_VT(&value)) {
    case VT_EMPTY:
        return Empty;
    case VT_BSTR:
        return Text(ViewOf(V_BSTR(&value)));
    case VT_R8:
        return V_R8(&value);
    case VT_DATE:
        return Date{V_DATE(&value)};
    case VT_BOOL:
        return V_BOOL(&value) != VARIANT_FALSE;
    case VT_I2:
        return std::int16_t{V_I2(&value)};
    case VT_I4:
        return std::int32_t{V_I4(&value)};
    case VT_DISPATCH:
    case VT_UNKNOWN:
        return ValueOf(V_UNKNOWN(&value));
    default:
        return NumberOf(value);
    }
}

VARIANT ToHost(const Variant& value) { return std::visit(ForHost(), value); }

VARIANT ToHost(const Variant& value, const Type& type) { return ToHost(Converted(value, type)); }

HRESULT StoreIn(const VARIANT& variable, const VARIANT& value)
{
    if (V_VT(&variable) == (VT_BYREF | VT_VARIANT))
        return VariantCopy(V_VARIANTREF(&variable), const_cast<VARIANT*>(&value));
    const auto type = static_cast<VARTYPE>(V_VT(&variable) & ~VT_BYREF);
    OwnedVariant converted;
    const HRESULT status = VariantChangeTypeEx(&converted, const_cast<VARIANT*>(&value), LOCALE_INVARIANT, 0, type);
    if (FAILED(status))
        return status;
    OwnedVariant old(Dereferenced(variable)); // frees what the variable held
    std::memcpy(V_BYREF(&variable), &V_BYREF(&converted), SizeOf(type));
    converted.Give();
    return status;
}

} // namespace varnex3::server
