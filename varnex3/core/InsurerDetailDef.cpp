#include "varnex3/core/InsurerDetailDef.h"

namespace varnex3 {

VARNEX_DEFINE(InsurerDetailDef);

namespace {

bool IsInRange(std::int32_t position, std::size_t count)
{
    return position >= 0 && static_cast<std::size_t>(position) < count;
}

} // namespace

void InsurerDetailDef::Add(const Text& sFieldName, const Text& sValue) { Take(sFieldName, sValue); }

void InsurerDetailDef::Take(Text fieldName, Text value)
{
    fields.Add(std::move(fieldName), std::move(value), "InsurerDetailDef.Add");
}

Text InsurerDetailDef::Values(const Variant& Index)
{
    if (const std::optional<std::int32_t> position = PositionFrom(Index))
        return IsInRange(*position, fields.Count()) ? fields.ItemAt(static_cast<std::size_t>(*position)) : Text();
    const Text field = ToText(Index);
    if (const Text* const value = fields.Find(field))
        return *value;
    return fields.Add(field, {}, "InsurerDetailDef.Values"); // reading an unknown name adds it
}

void InsurerDetailDef::Values(const Variant& Index, const Text& value)
{
    if (PositionFrom(Index))
        return; // values are changed by name only
    if (Text* const found = fields.Find(ToText(Index)))
        *found = value;
}

Text InsurerDetailDef::Fields(const Variant& Index)
{
    const std::optional<std::int32_t> position = PositionFrom(Index);
    if (!position)
        Raise(ErrorNumber::TypeMismatch, "InsurerDetailDef.Fields",
              u"Index: " + Quoted(ToText(Index)) + u" is not a number");
    if (!IsInRange(*position, fields.Count()))
        Raise(ErrorNumber::SubscriptOutOfRange, "InsurerDetailDef.Fields",
              u"Index: " + Quoted(ToText(Index)) + u" is outside the list of " + ToText(Variant(Count())));
    return fields.KeyAt(static_cast<std::size_t>(*position));
}

std::int16_t InsurerDetailDef::Count() const { return CountOf(fields.Count(), "InsurerDetailDef.Count"); }

} // namespace varnex3
