#include "varnex3/core/Json.h"

#include <algorithm>
#include <nlohmann/json.hpp>

#include "varnex3/core/Conversions.h"
#include "varnex3/core/Interface.h"
#include "varnex3/core/modFunctions.h"

namespace varnex3 {

namespace {

using Json = nlohmann::ordered_json;

Json JsonOf(Record& record);

constexpr bool IsHighSurrogate(char16_t c) { return c >= 0xD800 && c <= 0xDBFF; }
constexpr bool IsLowSurrogate(char16_t c) { return c >= 0xDC00 && c <= 0xDFFF; }

// The text with U+FFFD for every lone surrogate.
Text WithoutLoneSurrogates(Text text)
{
    for (std::size_t i = 0; i < text.size(); ++i) {
        const bool isPair = IsHighSurrogate(text[i]) && i + 1 < text.size() && IsLowSurrogate(text[i + 1]);
        if (isPair)
            ++i;
        else if (IsHighSurrogate(text[i]) || IsLowSurrogate(text[i]))
            text[i] = u'\uFFFD';
    }
    return text;
}

Json JsonOf(const EnumInfo& enumeration, std::int32_t value)
{
    const auto found = std::ranges::find(enumeration.values, value, &Enumerator::value);
    return found == enumeration.values.end() ? Json(value) : Json(std::string(found->name));
}

struct ToJsonValue
{
    const Type& type;

    Json operator()(EmptyValue) const { return nullptr; }
    Json operator()(const Text& text) const { return ToUtf8(WithoutLoneSurrogates(text)); }
    Json operator()(Date date) const { return ToUtf8(FormatDate(date, 1)); }
    Json operator()(const Ref<Record>& child) const { return child ? JsonOf(*child) : Json(nullptr); }
    Json operator()(std::int32_t value) const
    {
        return type.enumeration ? JsonOf(*type.enumeration, value) : Json(value);
    }
    Json operator()(auto number) const { return number; }
};

Json JsonOf(const Type& type, const Variant& value) { return std::visit(ToJsonValue{type}, value); }

Json ItemsOf(Record& record, const Member& member, std::int32_t count)
{
    Json items = Json::array();
    for (std::int32_t i = 0; i < count; ++i) {
        Variant index = i;
        items.push_back(JsonOf(member.type, member.get(&record, {&index, 1})));
    }
    return items;
}

Json JsonOf(Record& record)
{
    Json object = Json::object();
    const Member* const count = FindMember(record.Class(), "Count");
    for (const Member& member : record.Class().members) {
        if (!member.IsProperty())
            continue;
        if (!member.IsIndexed())
            object[std::string(member.name)] = JsonOf(member.type, member.get(&record, {}));
        else if (count)
            object[std::string(member.name)] = ItemsOf(record, member, ToInt32(count->get(&record, {})));
    }
    return object;
}

} // namespace

std::string ToJson(Record& record) { return JsonOf(record).dump(); }

} // namespace varnex3
