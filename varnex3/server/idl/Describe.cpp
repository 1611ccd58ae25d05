#include "varnex3/server/idl/Describe.h"

#include "varnex3/Library.h"
#include "varnex3/server/Guids.h"
#include "varnex3/server/idl/Spelling.h"

namespace varnex3::server::idl {

namespace {

bool IsNumber(Kind kind)
{
    return kind == Kind::Int16 || kind == Kind::Int32 || kind == Kind::Double || kind == Kind::Enumeration;
}

// An omitted variable of a number is 0; one of a text has no default that a type library could hold.
std::optional<std::string> InitialOf(const Parameter& parameter)
{
    if (!parameter.isOptional)
        return std::nullopt;
    if (!parameter.isByReference)
        return std::string(parameter.initial);
    return IsNumber(parameter.type.kind) ? std::optional<std::string>("0") : std::nullopt;
}

std::vector<Slot> DescribeSlots(const ClassInfo& info)
{
    std::vector<Slot> slots;
    for (const Operation& operation : OperationsOf(info)) {
        const Member& member = *operation.member;
        slots.push_back({operation.slot, operation.dispid, operation.access, std::string(member.name),
                         std::string(member.doc), DescribeParameters(member), DescribeType(member.type)});
    }
    return slots;
}

Class DescribeClass(const ClassInfo& info)
{
    return {.name = std::string(info.name),
            .guid = ToString(ClassGuid(info.name)),
            .doc = std::string(info.doc),
            .attributes = std::string(info.isPredeclared ? kPredeclared : ""),
            .interfaceName = "_" + std::string(info.name),
            .interfaceGuid = ToString(InterfaceGuid(info.name)),
            .interfaceDoc = std::string(info.doc),
            .interfaceAttributes = std::string(kInterfaceAttributes),
            .slots = DescribeSlots(info)};
}

Enumeration DescribeEnumeration(const EnumInfo& info)
{
    Enumeration described{std::string(info.name), ToString(EnumerationGuid(info.name)), std::string(info.doc), {}};
    for (const Enumerator& constant : info.values)
        described.constants.push_back({std::string(constant.name), constant.value, std::string(constant.doc)});
    return described;
}

void Claim(Spelling& spelling, const Library& library)
{
    spelling.Claim(library.name, "the library");
    for (const Enumeration& enumeration : library.enumerations) {
        spelling.Claim(enumeration.name, "an enumeration");
        for (const Constant& constant : enumeration.constants)
            spelling.Claim(constant.name, "a constant of " + enumeration.name);
    }
    for (const Class& described : library.classes) {
        spelling.Claim(described.name, "a class");
        spelling.Claim(described.interfaceName, "an interface");
        for (const Slot& slot : described.slots)
            spelling.Claim(slot.name, described.name + "." + slot.name);
    }
}

void SpellParameters(Spelling& spelling, Library& library)
{
    for (Class& described : library.classes)
        for (Slot& slot : described.slots)
            for (Argument& argument : slot.arguments)
                argument.name = spelling.OfParameter(argument.name);
}

} // namespace

ValueType DescribeType(const Type& type) { return {type.kind, std::string(type.name)}; }

std::vector<Argument> DescribeParameters(const Member& member)
{
    std::vector<Argument> arguments;
    for (const Parameter& parameter : member.Parameters())
        arguments.push_back({std::string(parameter.name), DescribeType(parameter.type), parameter.isByReference,
                             parameter.isOptional, InitialOf(parameter)});
    return arguments;
}

Library Describe(std::span<const ClassInfo* const> classes, std::span<const EnumInfo* const> enumerations)
{
    Library library{
        "Varnex3", ToString(LibraryGuid()), VARNEX3_VERSION_MAJOR, VARNEX3_VERSION_MINOR, VARNEX3_DESCRIPTION, {}, {}};
    for (const EnumInfo* const info : enumerations)
        library.enumerations.push_back(DescribeEnumeration(*info));
    for (const ClassInfo* const info : classes)
        if (!info->IsModule())
            library.classes.push_back(DescribeClass(*info));
    Spelling spelling;
    Claim(spelling, library);
    spelling.Check();
    SpellParameters(spelling, library);
    return library;
}

Library Describe() { return Describe(Classes(), Enumerations()); }

} // namespace varnex3::server::idl
