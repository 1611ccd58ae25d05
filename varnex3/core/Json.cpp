#include "varnex3/core/Json.h"

#include <algorithm>
#include <nlohmann/json.hpp>
#include <set>
#include <vector>

#include "varnex3/core/Conversions.h"
#include "varnex3/core/Error.h"
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

// ---- reading

constexpr Name kReading = "FromJson";

// A property as its path from the outermost record: QuoteItemsField.QuoteItems[3].ItemNo.
std::string Below(const std::string& path, Name property)
{
    return path + (path.empty() ? "" : ".") + std::string(property);
}

std::string Below(const std::string& path, Name list, std::size_t position)
{
    return Below(path, list) + "[" + std::to_string(position) + "]";
}

[[noreturn]] void Refuse(ErrorNumber number, const std::string& path, const Text& reason)
{
    Raise(number, kReading, path.empty() ? reason : ToUtf16(path) + u": " + reason);
}

Text Shown(const Json& json) { return Quoted(ToUtf16(json.is_string() ? json.get<std::string>() : json.dump())); }

[[noreturn]] void RefuseType(const std::string& path, const Json& json, TextView wanted)
{
    Refuse(ErrorNumber::TypeMismatch, path, Shown(json) + u" is " + Text(wanted));
}

// What a conversion gives; what it raises is told with the path.
template <class Conversion>
auto At(const std::string& path, Conversion conversion)
{
    try {
        return conversion();
    } catch (const Error& error) {
        throw error.About(kReading, ToUtf16(path));
    }
}

Text TextFrom(const Json& json, const std::string& path)
{
    if (!json.is_string())
        RefuseType(path, json, u"not a text");
    return ToUtf16(json.get<std::string>());
}

// A whole number, of any size that JSON can have.
Variant WholeNumberFrom(const Json& json, const std::string& path)
{
    if (!json.is_number_integer())
        RefuseType(path, json, u"not a whole number");
    return json.get<double>();
}

std::int32_t EnumeratorFrom(const EnumInfo& enumeration, const Json& json, const std::string& path)
{
    if (!json.is_string())
        return At(path, [&] { return ToInt32(WholeNumberFrom(json, path)); });
    const auto found = std::ranges::find(enumeration.values, json.get<std::string>(), &Enumerator::name);
    if (found == enumeration.values.end())
        RefuseType(path, json, u"no value of " + ToText(enumeration.name));
    return found->value;
}

// A value as a getter of this type gives it.
Variant ValueFrom(const Type& type, const Json& json, const std::string& path)
{
    switch (type.kind) {
    case Kind::Text:
        return TextFrom(json, path);
    case Kind::Date:
        return At(path, [&] { return DateFrom(TextFrom(json, path)); });
    case Kind::Double:
        if (!json.is_number())
            RefuseType(path, json, u"not a number");
        return json.get<double>();
    case Kind::Int16:
        return At(path, [&] { return ToInt16(WholeNumberFrom(json, path)); });
    case Kind::Int32:
        return At(path, [&] { return ToInt32(WholeNumberFrom(json, path)); });
    case Kind::Boolean:
        if (!json.is_boolean())
            RefuseType(path, json, u"neither true nor false");
        return json.get<bool>();
    case Kind::Enumeration:
        return EnumeratorFrom(*type.enumeration, json, path);
    case Kind::None:
    case Kind::Object:
    case Kind::Variant:
        break;
    }
    RefuseType(path, json, u"no value that JSON can give");
}

void Fill(Record& record, const Json& object, const std::string& path);

void RequireProperties(const ClassInfo& info, const Json& object, const std::string& path)
{
    if (!object.is_object())
        RefuseType(path, object, u"not an object");
    for (const auto& [name, value] : object.items()) {
        const Member* const member = FindMember(info, name);
        if (!member || !member->IsProperty())
            Refuse(ErrorNumber::NoSuchMember, path, ToText(info.name) + u" has no property " + Quoted(ToUtf16(name)));
    }
}

struct GivenValue
{
    const Member& member;
    Variant value;
};

std::vector<GivenValue> GivenValues(const ClassInfo& info, const Json& object, const std::string& path)
{
    std::vector<GivenValue> values;
    for (const Member& member : info.members) {
        const bool isValue = member.IsWritable() && !member.IsIndexed() && member.type.kind != Kind::Object;
        const auto given = isValue ? object.find(std::string(member.name)) : object.end();
        if (given != object.end())
            values.push_back({member, ValueFrom(member.type, *given, Below(path, member.name))});
    }
    return values;
}

// Of two views of one value, storing the second may change the first again: the second round sets that right, where
// both can be had.
void PutValues(Record& record, const std::vector<GivenValue>& values, const std::string& path)
{
    constexpr int kRounds = 2;
    for (int round = 0; round < kRounds; ++round)
        for (const auto& [member, value] : values)
            if (member.get(&record, {}) != value)
                member.put(&record, {}, value);
    for (const auto& [member, value] : values)
        if (const Variant stored = member.get(&record, {}); stored != value)
            Refuse(ErrorNumber::InvalidArgument, Below(path, member.name),
                   Shown(JsonOf(member.type, value)) + u" does not agree with the other properties, which make it "
                       + Shown(JsonOf(member.type, stored)));
}

void FillChildren(Record& record, const Json& object, const std::string& path)
{
    for (const Member& member : record.Class().members) {
        const bool isChild = member.IsProperty() && !member.IsIndexed() && member.type.kind == Kind::Object;
        const auto given = isChild ? object.find(std::string(member.name)) : object.end();
        if (given != object.end())
            Fill(*std::get<Ref<Record>>(member.get(&record, {})), *given, Below(path, member.name));
    }
}

// The array of an indexed property; empty when it is left out.
const Json& ArrayOf(const Member& member, const Json& object, const std::string& path)
{
    static const Json none = Json::array();
    const auto given = object.find(std::string(member.name));
    if (given == object.end())
        return none;
    if (!given->is_array())
        RefuseType(Below(path, member.name), *given, u"not an array");
    return *given;
}

struct Column
{
    const Member* member;
    const Json& items;
};

// The indexed property that gives what a list's Add takes as this parameter: Fields gives sFieldName, Values sValue. A
// list with one indexed property has no other.
bool IsColumnOf(const Parameter& parameter, const Member& member)
{
    const Name inOne = member.name.substr(0, member.name.size() - 1); // without the s of several
    return parameter.name.substr(1).starts_with(inOne);               // without the s of a text
}

std::vector<Column> ColumnsOf(const ClassInfo& list, const Member& add, const Json& object, const std::string& path)
{
    std::vector<const Member*> indexed;
    for (const Member& member : list.members)
        if (member.IsIndexed())
            indexed.push_back(&member);

    std::vector<Column> columns;
    for (const Parameter& parameter : add.Parameters()) {
        const auto isColumn = [&](const Member* member) { return IsColumnOf(parameter, *member); };
        const auto found = indexed.size() == 1 ? indexed.begin() : std::ranges::find_if(indexed, isColumn);
        if (found == indexed.end())
            Refuse(ErrorNumber::NoSuchMember, path,
                   ToText(list.name) + u" does not give back the " + ToText(parameter.name) + u" of its items");
        columns.push_back({*found, ArrayOf(**found, object, path)});
    }
    return columns;
}

// A list of values, one or several an item.
void AddValues(Record& list, const Member& add, const Json& object, const std::string& path)
{
    const std::vector<Column> columns = ColumnsOf(list.Class(), add, object, path);
    for (const Column& column : columns)
        if (column.items.size() != columns[0].items.size())
            Refuse(ErrorNumber::InvalidArgument, path,
                   ToText(columns[0].member->name) + u" and " + ToText(column.member->name)
                       + u" do not have the same number of items");
    for (std::size_t i = 0; i < columns[0].items.size(); ++i) {
        std::vector<Variant> arguments;
        arguments.reserve(columns.size());
        for (const auto& [member, items] : columns)
            arguments.push_back(ValueFrom(member->type, items[i], Below(path, member->name, i)));
        At(Below(path, columns[0].member->name, i), [&] { return Call(list, add.name, arguments); });
    }
}

// A list of records: Add gives each, new.
void AddRecords(Record& list, const Member& add, const Json& object, const std::string& path)
{
    for (const Member& member : list.Class().members) {
        if (!member.IsIndexed())
            continue;
        const Json& items = ArrayOf(member, object, path);
        for (std::size_t i = 0; i < items.size(); ++i)
            Fill(*std::get<Ref<Record>>(Call(list, add.name)), items[i], Below(path, member.name, i));
    }
}

void AddItems(Record& record, const Json& object, const std::string& path)
{
    const Member* const add = FindMember(record.Class(), "Add");
    if (!add)
        return;
    if (add->type.kind == Kind::Object)
        AddRecords(record, *add, object, path); // not where Add takes a key: it says that the key is missing
    else
        AddValues(record, *add, object, path);
}

void Fill(Record& record, const Json& object, const std::string& path)
{
    RequireProperties(record.Class(), object, path);
    PutValues(record, GivenValues(record.Class(), object, path), path);
    FillChildren(record, object, path);
    AddItems(record, object, path);
}

// Refuses what the parser would settle silently: a name that an object has twice.
class NamesSeen
{
public:
    bool operator()(int /*depth*/, Json::parse_event_t event, const Json& parsed)
    {
        if (event == Json::parse_event_t::object_start)
            open.emplace_back();
        else if (event == Json::parse_event_t::object_end)
            open.pop_back();
        else if (event == Json::parse_event_t::key && !open.back().insert(parsed.get<std::string>()).second)
            Refuse(ErrorNumber::InvalidArgument, {}, u"the name " + Shown(parsed) + u" stands twice in one object");
        return true;
    }

private:
    std::vector<std::set<std::string>> open;
};

Json Parsed(std::string_view text)
{
    try {
        return Json::parse(text, NamesSeen());
    } catch (const Json::parse_error& error) {
        const std::string_view words = error.what();
        const std::size_t end = words.find("] "); // of the parser's own number
        Refuse(ErrorNumber::InvalidArgument, {}, ToUtf16(words.substr(end == Name::npos ? 0 : end + 2)));
    }
}

} // namespace

std::string ToJson(Record& record) { return JsonOf(record).dump(); }

void FromJson(Record& record, std::string_view json) { Fill(record, Parsed(json), {}); }

Ref<Record> FromNamedJson(std::string_view json, const ClassInfo* (*find)(Name))
{
    const Json named = Parsed(json);
    if (!named.is_object() || named.size() != 1)
        Refuse(ErrorNumber::InvalidArgument, {}, Shown(named) + u" is no object of one name, a class's");
    const std::string& name = named.begin().key();
    const ClassInfo* const info = find(name);
    if (!info || info->IsModule())
        Refuse(ErrorNumber::NoSuchMember, {}, u"there is no class " + Quoted(ToUtf16(name)));
    Ref<Record> record = info->create();
    Fill(*record, named.front(), name);
    return record;
}

} // namespace varnex3
