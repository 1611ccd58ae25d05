// The C face: walks over the interface tables and names no class and no member itself.
#include "varnex3_c.h"

#include <cstring>
#include <set>
#include <string>
#include <vector>

#include "varnex3/Library.h"
#include "varnex3/core/Conversions.h"
#include "varnex3/core/Error.h"
#include "varnex3/core/Json.h"

using namespace varnex3;

namespace {

// --- The one place where errors leave the library ------------------------------------------

struct LastError
{
    std::int32_t number = 0;
    std::string source;
    std::string description;
};

LastError& TheLastError()
{
    thread_local LastError error;
    return error;
}

template <class Action>
std::int32_t Guarded(Name operation, Action action) noexcept
{
    try {
        action();
        return 0;
    } catch (...) {
        try {
            const Error error = CurrentError(operation);
            TheLastError() = {error.Number(), ToUtf8(error.Source()), ToUtf8(error.Description())};
            return error.Number();
        } catch (...) { // not even the words could be stored
            TheLastError().number = static_cast<std::int32_t>(ErrorNumber::OutOfMemory);
            return TheLastError().number;
        }
    }
}

void RequireHandle(const void* given, Name operation, Name what)
{
    if (!given)
        Raise(ErrorNumber::ObjectNotSet, operation, ToText(what) + u" is null");
}

// --- Names --------------------------------------------------------------------------------

using Names = std::set<std::string, std::less<>>;

void Collect(Names& names, const ClassInfo& info)
{
    names.emplace(info.name);
    names.emplace(info.doc);
    for (const Member& member : info.members) {
        names.emplace(member.name);
        names.emplace(member.doc);
        names.emplace(member.type.name);
        for (const Parameter& parameter : member.Parameters()) {
            names.emplace(parameter.name);
            names.emplace(parameter.type.name);
            names.emplace(parameter.initial);
        }
    }
}

void Collect(Names& names, const EnumInfo& info)
{
    names.emplace(info.name);
    names.emplace(info.doc);
    for (const Enumerator& constant : info.values) {
        names.emplace(constant.name);
        names.emplace(constant.doc);
    }
}

Names CollectNames()
{
    Names names;
    for (const ClassInfo* const info : Classes())
        Collect(names, *info);
    for (const EnumInfo* const info : Enumerations())
        Collect(names, *info);
    return names;
}

// A name or a doc of the tables, ended with a NUL and never freed.
const char* Lasting(Name name)
{
    static const Names names = CollectNames();
    return names.find(name)->c_str();
}

Name Given(const char* name) { return name ? Name(name) : Name(); }

const ClassInfo& RequiredClass(const char* name, Name operation)
{
    if (const ClassInfo* const info = FindClass(Given(name)))
        return *info;
    Raise(ErrorNumber::CannotCreateObject, operation, u"there is no class " + Quoted(ToUtf16(Given(name))));
}

template <class List>
decltype(auto) At(const List& list, std::int32_t position, Name operation)
{
    if (position < 0 || static_cast<std::size_t>(position) >= list.size())
        Raise(ErrorNumber::SubscriptOutOfRange, operation,
              u"position " + Quoted(ToText(Variant(position))) + u" is out of range");
    return list[static_cast<std::size_t>(position)];
}

// --- Values -------------------------------------------------------------------------------

Record* AsRecord(varnex3_record* record) { return reinterpret_cast<Record*>(record); }
varnex3_record* AsHandle(Record* record) { return reinterpret_cast<varnex3_record*>(record); }

std::int32_t KindOf(const Type& type)
{
    switch (type.kind) {
    case Kind::None:
        return VARNEX3_EMPTY;
    case Kind::Text:
        return VARNEX3_TEXT;
    case Kind::Double:
        return VARNEX3_DOUBLE;
    case Kind::Date:
        return VARNEX3_DATE;
    case Kind::Int16:
        return VARNEX3_INT16;
    case Kind::Int32:
        return VARNEX3_INT32;
    case Kind::Boolean:
        return VARNEX3_BOOLEAN;
    case Kind::Object:
        return VARNEX3_OBJECT;
    case Kind::Enumeration:
        return VARNEX3_ENUM;
    case Kind::Variant:
        return VARNEX3_VARIANT;
    }
    return VARNEX3_EMPTY;
}

Variant FromValue(const varnex3_value& value)
{
    switch (value.kind) {
    case VARNEX3_EMPTY:
        return Empty;
    case VARNEX3_TEXT:
        return ToUtf16({value.text ? value.text : "", value.text ? value.length : 0});
    case VARNEX3_DOUBLE:
        return value.number;
    case VARNEX3_DATE:
        return Date{value.number};
    case VARNEX3_INT16:
    case VARNEX3_INT32:
    case VARNEX3_ENUM:
        return value.integer;
    case VARNEX3_BOOLEAN:
        return value.integer != 0;
    case VARNEX3_OBJECT:
        return Ref<Record>(AsRecord(value.record));
    default:
        throw Error(ErrorNumber::InvalidArgument, {},
                    u"a value of unknown kind " + Quoted(ToText(Variant(value.kind))));
    }
}

// Hands a value to the caller, who clears it.
struct Hand
{
    varnex3_value& to;

    void operator()(EmptyValue) const { to = {}; }
    void operator()(const Text& text) const { GiveText(ToUtf8(text)); }
    void operator()(double number) const { to = {VARNEX3_DOUBLE, 0, number, nullptr, 0, nullptr}; }
    void operator()(Date date) const { to = {VARNEX3_DATE, 0, date.serial, nullptr, 0, nullptr}; }
    void operator()(std::int16_t value) const { to = {VARNEX3_INT16, value, 0, nullptr, 0, nullptr}; }
    void operator()(std::int32_t value) const { to = {VARNEX3_INT32, value, 0, nullptr, 0, nullptr}; }
    void operator()(bool flag) const { to = {VARNEX3_BOOLEAN, flag ? 1 : 0, 0, nullptr, 0, nullptr}; }
    void operator()(const Ref<Record>& record) const
    {
        if (record)
            record->AddRef();
        to = {VARNEX3_OBJECT, 0, 0, nullptr, 0, AsHandle(record.get())};
    }
    void GiveText(const std::string& utf8) const
    {
        char* const copy = new char[utf8.size() + 1];
        std::memcpy(copy, utf8.c_str(), utf8.size() + 1);
        to = {VARNEX3_TEXT, 0, 0, copy, utf8.size(), nullptr};
    }
};

void GiveValue(varnex3_value* to, const Variant& value)
{
    if (to)
        std::visit(Hand{*to}, value);
}

std::vector<Variant> FromValues(const varnex3_value* values, std::int32_t count)
{
    if (count < 0 || (count > 0 && !values))
        throw Error(ErrorNumber::InvalidArgument, {},
                    u"the argument count " + Quoted(ToText(Variant(count))) + u" does not fit");
    std::vector<Variant> variants;
    variants.reserve(static_cast<std::size_t>(count));
    for (std::int32_t i = 0; i < count; ++i)
        variants.push_back(FromValue(values[i]));
    return variants;
}

void CallAndGive(const ClassInfo& info, Record* record, Name name, varnex3_value* arguments, std::int32_t count,
                 varnex3_value* result)
{
    std::vector<Variant> values = FromValues(arguments, count);
    const Variant returned = Call(info, record, name, values);
    const auto parameters = FindMember(info, name)->Parameters();
    for (std::size_t i = 0; i < values.size(); ++i)
        if (parameters[i].isOutput)
            GiveValue(&arguments[i], values[i]);
    GiveValue(result, returned);
}

} // namespace

const char* varnex3_version(void) { return VARNEX3_VERSION; }

std::int32_t varnex3_class_count(void) { return static_cast<std::int32_t>(Classes().size()); }

std::int32_t varnex3_class_at(std::int32_t position, varnex3_class* result)
{
    return Guarded("varnex3_class_at", [&] {
        const ClassInfo& info = *At(Classes(), position, "varnex3_class_at");
        *result = {Lasting(info.name), Lasting(info.doc), info.IsModule(),
                   static_cast<std::int32_t>(info.members.size())};
    });
}

std::int32_t varnex3_member_at(const char* class_name, std::int32_t position, varnex3_member* result)
{
    constexpr Name operation = "varnex3_member_at";
    return Guarded(operation, [&] {
        const Member& member = At(RequiredClass(class_name, operation).members, position, operation);
        *result = {Lasting(member.name),
                   Lasting(member.doc),
                   member.IsProperty(),
                   member.IsWritable(),
                   KindOf(member.type),
                   Lasting(member.type.name),
                   static_cast<std::int32_t>(member.parameterCount)};
    });
}

std::int32_t varnex3_parameter_at(const char* class_name, std::int32_t member, std::int32_t position,
                                  varnex3_parameter* result)
{
    constexpr Name operation = "varnex3_parameter_at";
    return Guarded(operation, [&] {
        const Member& owner = At(RequiredClass(class_name, operation).members, member, operation);
        const Parameter& parameter = At(owner.Parameters(), position, operation);
        *result = {Lasting(parameter.name), KindOf(parameter.type),     Lasting(parameter.type.name),
                   parameter.isOptional,    Lasting(parameter.initial), parameter.isByReference,
                   parameter.isOutput};
    });
}

std::int32_t varnex3_enumeration_count(void) { return static_cast<std::int32_t>(Enumerations().size()); }

std::int32_t varnex3_enumeration_at(std::int32_t position, varnex3_enumeration* result)
{
    return Guarded("varnex3_enumeration_at", [&] {
        const EnumInfo& info = *At(Enumerations(), position, "varnex3_enumeration_at");
        *result = {Lasting(info.name), Lasting(info.doc), static_cast<std::int32_t>(info.values.size())};
    });
}

std::int32_t varnex3_constant_at(std::int32_t enumeration, std::int32_t position, varnex3_constant* result)
{
    constexpr Name operation = "varnex3_constant_at";
    return Guarded(operation, [&] {
        const Enumerator& constant = At(At(Enumerations(), enumeration, operation)->values, position, operation);
        *result = {Lasting(constant.name), Lasting(constant.doc), constant.value};
    });
}

std::int32_t varnex3_constant_value(const char* enumeration, const char* constant, std::int32_t* result)
{
    constexpr Name operation = "varnex3_constant_value";
    return Guarded(operation, [&] {
        for (const EnumInfo* const info : Enumerations())
            for (const Enumerator& value : info->values)
                if (info->name == Given(enumeration) && value.name == Given(constant)) {
                    *result = value.value;
                    return;
                }
        Raise(ErrorNumber::InvalidArgument, operation,
              u"there is no constant " + Quoted(ToUtf16(Given(constant))) + u" of an enumeration "
                  + Quoted(ToUtf16(Given(enumeration))));
    });
}

std::int32_t varnex3_create(const char* class_name, varnex3_record** result)
{
    constexpr Name operation = "varnex3_create";
    return Guarded(operation, [&] {
        const ClassInfo& info = RequiredClass(class_name, operation);
        if (info.IsModule())
            Raise(ErrorNumber::CannotCreateObject, operation, Quoted(ToText(info.name)) + u" is a module, not a class");
        const Ref<Record> record = info.create();
        record->AddRef(); // the caller's
        *result = AsHandle(record.get());
    });
}

void varnex3_add_ref(varnex3_record* record)
{
    if (record)
        AsRecord(record)->AddRef();
}

void varnex3_release(varnex3_record* record)
{
    if (record)
        AsRecord(record)->Release();
}

const char* varnex3_class_of(const varnex3_record* record)
{
    return record ? Lasting(reinterpret_cast<const Record*>(record)->Class().name) : "";
}

std::int32_t varnex3_get(varnex3_record* record, const char* property, varnex3_value* result)
{
    return varnex3_get_indexed(record, property, nullptr, 0, result);
}

std::int32_t varnex3_get_indexed(varnex3_record* record, const char* property, const varnex3_value* indexes,
                                 std::int32_t index_count, varnex3_value* result)
{
    constexpr Name operation = "varnex3_get";
    return Guarded(operation, [&] {
        RequireHandle(record, operation, "record");
        std::vector<Variant> arguments = FromValues(indexes, index_count);
        GiveValue(result, Get(*AsRecord(record), Given(property), arguments));
    });
}

std::int32_t varnex3_put(varnex3_record* record, const char* property, const varnex3_value* value)
{
    return varnex3_put_indexed(record, property, nullptr, 0, value);
}

std::int32_t varnex3_put_indexed(varnex3_record* record, const char* property, const varnex3_value* indexes,
                                 std::int32_t index_count, const varnex3_value* value)
{
    constexpr Name operation = "varnex3_put";
    return Guarded(operation, [&] {
        RequireHandle(record, operation, "record");
        RequireHandle(value, operation, "value");
        std::vector<Variant> arguments = FromValues(indexes, index_count);
        Put(*AsRecord(record), Given(property), FromValue(*value), arguments);
    });
}

std::int32_t varnex3_put_reference(varnex3_record* record, const char* property, varnex3_record* value)
{
    const varnex3_value reference{VARNEX3_OBJECT, 0, 0, nullptr, 0, value};
    return varnex3_put(record, property, &reference);
}

std::int32_t varnex3_call(varnex3_record* record, const char* method, varnex3_value* arguments,
                          std::int32_t argument_count, varnex3_value* result)
{
    constexpr Name operation = "varnex3_call";
    return Guarded(operation, [&] {
        RequireHandle(record, operation, "record");
        CallAndGive(AsRecord(record)->Class(), AsRecord(record), Given(method), arguments, argument_count, result);
    });
}

std::int32_t varnex3_call_function(const char* module, const char* function, varnex3_value* arguments,
                                   std::int32_t argument_count, varnex3_value* result)
{
    constexpr Name operation = "varnex3_call_function";
    return Guarded(operation, [&] {
        const ClassInfo& info = RequiredClass(module, operation);
        if (!info.IsModule())
            Raise(ErrorNumber::ObjectNotSet, operation,
                  Quoted(ToText(info.name)) + u" is a class: its methods need a record");
        CallAndGive(info, nullptr, Given(function), arguments, argument_count, result);
    });
}

std::int32_t varnex3_to_json(varnex3_record* record, varnex3_value* result)
{
    constexpr Name operation = "varnex3_to_json";
    return Guarded(operation, [&] {
        RequireHandle(record, operation, "record");
        Hand{*result}.GiveText(ToJson(*AsRecord(record)));
    });
}

void varnex3_value_clear(varnex3_value* value)
{
    if (!value)
        return;
    delete[] value->text;
    varnex3_release(value->record);
    *value = {};
}

std::int32_t varnex3_error_number(void) { return TheLastError().number; }
const char* varnex3_error_source(void) { return TheLastError().source.c_str(); }
const char* varnex3_error_description(void) { return TheLastError().description.c_str(); }
