// The interface of a class as plain data: what every face (COM, C, Python, JSON, the reference) is made from.
//
// The rows of a class (Rows.h) say it once; a face walks over it and names no class and no member itself.
#pragma once

#include <array>
#include <cstdint>
#include <span>

#include "varnex3/core/Variant.h"

namespace varnex3 {

// What kind of value travels. None: nothing comes back. Variant: a value of any kind, Empty included.
enum class Kind : std::uint8_t
{
    None,
    Text,
    Double,
    Date,
    Int16,
    Int32,
    Boolean,
    Enumeration,
    Object,
    Variant
};

// The name of a kind as the documentation writes it, such as "16-bit integer".
Name NameOf(Kind kind);

// A constant of an enumeration.
struct Enumerator
{
    Name name;
    std::int32_t value = 0;
    Name doc;
};

// A 32-bit enumeration. A property of its type may hold any number; the gaps between the values are part of it.
struct EnumInfo
{
    Name name;
    Name doc;
    std::span<const Enumerator> values;
};

struct Type
{
    Kind kind = Kind::None;
    Name name;                             // of the enumeration or the class; empty otherwise
    const EnumInfo* enumeration = nullptr; // of an enumeration
};

struct Parameter
{
    Name name;
    Type type;
    bool isByReference = false; // hosts pass a variable
    bool isOutput = false;      // and find a result in it afterwards
    bool isOptional = false;
    Name initial; // the text that an omitted argument has
};

enum class MemberKind : std::uint8_t
{
    Method,
    Property
};

// The arguments of a call, in order; those by reference are written back into it.
using Arguments = std::span<Variant>;

// One member of an interface. Its place among the members, from 1, is its dispatch id.
struct Member
{
    static constexpr std::size_t kMaxParameters = 6;

    MemberKind kind = MemberKind::Method;
    Name name;
    Name doc;
    Type type; // of the property, or of the method's result
    std::array<Parameter, kMaxParameters> parameterSlots{};
    std::size_t parameterCount = 0;

    // Calls the method or reads the property. Arguments are converted; omitted optional ones may be left off the end.
    Variant (*get)(Record* record, Arguments arguments) = nullptr;
    // Stores the property; null when it is read-only.
    void (*put)(Record* record, Arguments arguments, const Variant& value) = nullptr;

    constexpr std::span<const Parameter> Parameters() const { return {parameterSlots.data(), parameterCount}; }
    constexpr bool IsProperty() const { return kind == MemberKind::Property; }
    constexpr bool IsIndexed() const { return IsProperty() && parameterCount > 0; }
    constexpr bool IsWritable() const { return put != nullptr; }
};

// A class, or a module: a set of functions that need no object.
struct ClassInfo
{
    Name name;
    Name doc;
    std::span<const Member> members;
    Ref<Record> (*create)() = nullptr; // null for a module
    bool isPredeclared = false;        // hosts may use its name without creating an object

    constexpr bool IsModule() const { return create == nullptr; }
};

// The member of this name (letter case counts), or null.
const Member* FindMember(const ClassInfo& info, Name name);

// The calls by name that the faces make. For a module, record is null. Arguments may be given as texts or numbers of
// another type: they are converted (Conversions.h). Errors of a conversion have the source "Class.Member"; an unknown
// member is NoSuchMember, a property that cannot be stored ReadOnlyProperty, a missing argument ArgumentMissing, one
// too many WrongArgumentCount.

// Reads a property.
Variant Get(Record& record, Name property, Arguments arguments = {});

// Stores a property.
void Put(Record& record, Name property, const Variant& value, Arguments arguments = {});

// Calls a method, or a function of a module.
Variant Call(const ClassInfo& info, Record* record, Name method, Arguments arguments = {});
inline Variant Call(Record& record, Name method, Arguments arguments = {})
{
    return Call(record.Class(), &record, method, arguments);
}

} // namespace varnex3
