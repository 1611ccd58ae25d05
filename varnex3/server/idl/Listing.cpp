#include "varnex3/server/idl/Listing.h"

#include <array>

namespace varnex3::server::idl {

namespace {

std::string WordFor(const ValueType& type)
{
    constexpr std::array<std::string_view, 10> words{"nothing", "text",    "double", "date",   "int16",
                                                     "int32",   "Boolean", "enum",   "object", "variant"};
    return type.name.empty() ? std::string(words[static_cast<std::size_t>(type.kind)]) : type.name;
}

std::string InitialOf(const Argument& argument)
{
    if (!argument.initial)
        return "";
    return " = " + (argument.type.kind == Kind::Text ? '"' + *argument.initial + '"' : *argument.initial);
}

std::string ToText(const Argument& argument)
{
    const std::string text =
        (argument.isByReference ? "inout " : "") + argument.name + ": " + WordFor(argument.type) + InitialOf(argument);
    return argument.isOptional ? "[" + text + "]" : text;
}

std::string Aligned(const std::string& text, std::size_t width)
{
    return std::string(width - std::min(width, text.size()), ' ') + text;
}

std::string ToText(const Slot& slot)
{
    constexpr std::array<std::string_view, 4> words{"method", "get   ", "put   ", "putref"};
    return "    " + Aligned(std::to_string(slot.slot), 4) + Aligned(std::to_string(slot.dispid), 5) + "  "
           + std::string(words[static_cast<std::size_t>(slot.access)]) + " "
           + Signature(slot.name, slot.arguments, slot.type) + "\n";
}

std::string ToText(const Enumeration& enumeration)
{
    std::string text = "\nenum " + enumeration.name + " {" + enumeration.guid + "}\n";
    for (const Constant& constant : enumeration.constants)
        text += "    " + Aligned(std::to_string(constant.value), 4) + "  " + constant.name + "\n";
    return text;
}

std::string ToText(const Class& described)
{
    std::string text = "\nclass " + described.name + " {" + described.guid + "}"
                       + (described.attributes.empty() ? "" : " " + described.attributes) + "\n  interface "
                       + described.interfaceName + " {" + described.interfaceGuid + "} " + described.interfaceAttributes
                       + "\n";
    for (const Slot& slot : described.slots)
        text += ToText(slot);
    return text;
}

} // namespace

std::string Signature(const std::string& name, const std::vector<Argument>& arguments, const ValueType& type)
{
    std::string text;
    for (const Argument& argument : arguments)
        text += (text.empty() ? "" : ", ") + ToText(argument);
    return name + (text.empty() ? "" : "(" + text + ")") + ": " + WordFor(type);
}

std::string ToListing(const Library& library)
{
    std::string text = "library " + library.name + " " + std::to_string(library.major) + "."
                       + std::to_string(library.minor) + " {" + library.guid + "}\n";
    for (const Enumeration& enumeration : library.enumerations)
        text += ToText(enumeration);
    for (const Class& described : library.classes)
        text += ToText(described);
    return text;
}

std::string ToHelpStrings(const Library& library)
{
    std::string text = library.name + ": " + library.doc + "\n";
    for (const Enumeration& enumeration : library.enumerations)
        text += enumeration.name + ": " + enumeration.doc + "\n";
    for (const Class& described : library.classes) {
        text += described.name + ": " + described.doc + "\n" + described.interfaceName + ": " + described.interfaceDoc
                + "\n";
        for (const Slot& slot : described.slots)
            text += described.name + "." + slot.name + ": " + slot.doc + "\n";
    }
    return text;
}

} // namespace varnex3::server::idl
