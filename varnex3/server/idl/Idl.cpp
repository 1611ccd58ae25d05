#include "varnex3/server/idl/Idl.h"

namespace varnex3::server::idl {

namespace {

// The names of what a property is stored from and what a call gives. They clash with no public name: Describe's test.
constexpr std::string_view kStored = "newValue";
constexpr std::string_view kResult = "pResult";

std::string Quoted(std::string_view text)
{
    std::string quoted = "\"";
    for (const char c : text) {
        if (c == '"' || c == '\\')
            quoted += '\\';
        quoted += c;
    }
    return quoted + '"';
}

std::string HelpString(std::string_view doc) { return "helpstring(" + Quoted(doc) + ")"; }

std::string ToIdl(const ValueType& type)
{
    switch (type.kind) {
    case Kind::Text:
        return "BSTR";
    case Kind::Double:
        return "double";
    case Kind::Date:
        return "DATE";
    case Kind::Int16:
        return "short";
    case Kind::Int32:
        return "long";
    case Kind::Boolean:
        return "VARIANT_BOOL";
    case Kind::Enumeration:
        return type.name;
    case Kind::Object:
        return "_" + type.name + "*";
    default:
        return "VARIANT";
    }
}

std::string DefaultOf(const Argument& argument)
{
    if (!argument.initial)
        return "";
    const bool isText = argument.type.kind == Kind::Text;
    return ", defaultvalue(" + (isText ? Quoted(*argument.initial) : *argument.initial) + ")";
}

std::string ToIdl(const Argument& argument)
{
    std::string text = argument.isByReference ? "[in, out" : "[in";
    if (argument.isOptional)
        text += ", optional" + DefaultOf(argument);
    return text + "] " + ToIdl(argument.type) + (argument.isByReference ? "* " : " ") + argument.name;
}

// What follows the arguments: the value to store, or the place for the result.
std::string LastArgument(const Slot& slot)
{
    if (slot.access == Access::Put || slot.access == Access::PutReference)
        return "[in] " + ToIdl(slot.type) + " " + std::string(kStored);
    if (slot.type.kind == Kind::None)
        return "";
    return "[out, retval] " + ToIdl(slot.type) + "* " + std::string(kResult);
}

std::string ArgumentsOf(const Slot& slot)
{
    std::string text;
    const auto add = [&](const std::string& argument) {
        text += (text.empty() || argument.empty() ? "" : ", ") + argument;
    };
    for (const Argument& argument : slot.arguments)
        add(ToIdl(argument));
    add(LastArgument(slot));
    return text;
}

std::string_view AttributeOf(Access access)
{
    constexpr std::array<std::string_view, 4> attributes{"", "propget, ", "propput, ", "propputref, "};
    return attributes[static_cast<std::size_t>(access)];
}

std::string ToIdl(const Slot& slot)
{
    return "        [id(" + std::to_string(slot.dispid) + "), " + std::string(AttributeOf(slot.access))
           + HelpString(slot.doc) + "]\n        HRESULT " + slot.name + "(" + ArgumentsOf(slot) + ");\n";
}

std::string ToIdl(const Enumeration& enumeration)
{
    std::string text = "    typedef [uuid(" + enumeration.guid + "), v1_enum, " + HelpString(enumeration.doc)
                       + "]\n    enum " + enumeration.name + "\n    {\n";
    for (const Constant& constant : enumeration.constants) // widl takes no help strings here
        text += "        " + constant.name + " = " + std::to_string(constant.value)
                + (&constant == &enumeration.constants.back() ? "" : ",") + " // " + constant.doc + "\n";
    return text + "    } " + enumeration.name + ";\n\n";
}

std::string InterfaceOf(const Class& described)
{
    std::string text = "    [object, uuid(" + described.interfaceGuid + "), " + described.interfaceAttributes
                       + ",\n     " + HelpString(described.interfaceDoc) + "]\n    interface " + described.interfaceName
                       + " : IDispatch\n    {\n";
    for (const Slot& slot : described.slots)
        text += ToIdl(slot);
    return text + "    };\n\n";
}

std::string CoClassOf(const Class& described)
{
    return "    [uuid(" + described.guid + "), " + described.attributes + (described.attributes.empty() ? "" : ", ")
           + HelpString(described.doc) + "]\n    coclass " + described.name + "\n    {\n        [default] interface "
           + described.interfaceName + ";\n    };\n\n";
}

// The bytes of an identifier as C has them in braces or as arguments: "0x6CD4640B, 0xE818, 0x5F00, 0xAA, ...".
std::string BytesOf(const std::string& guid)
{
    std::string text = "0x" + guid.substr(0, 8) + ", 0x" + guid.substr(9, 4) + ", 0x" + guid.substr(14, 4);
    const std::string last = guid.substr(19, 4) + guid.substr(24);
    for (std::size_t i = 0; i < last.size(); i += 2)
        text += ", 0x" + last.substr(i, 2);
    return text;
}

// What a header has for a class: CLSID_VersionDef and, in C++, __uuidof(VersionDef).
std::string ClassInHeader(const Class& described)
{
    const std::string bytes = BytesOf(described.guid);
    const std::string lines[] = {"DEFINE_GUID(CLSID_" + described.name + ", " + bytes + ");",
                                 "#ifdef __cplusplus",
                                 "class DECLSPEC_UUID(\"" + described.guid + "\") " + described.name + ";",
                                 "#ifdef __CRT_UUID_DECL",
                                 "__CRT_UUID_DECL(class " + described.name + ", " + bytes + ")",
                                 "#endif",
                                 "#endif"};
    std::string text;
    for (const std::string& line : lines)
        text += "    cpp_quote(" + Quoted(line) + ")\n";
    return text + "\n";
}

std::string HeadOf(const Library& library)
{
    return "// Made from the rows of the classes by varnex3_idl: change those, not this.\nimport "
           "\"oaidl.idl\";\n\n[uuid("
           + library.guid + "), version(" + std::to_string(library.major) + "." + std::to_string(library.minor)
           + "),\n " + HelpString(library.doc) + "]\nlibrary " + library.name
           + "\n{\n    importlib(\"stdole2.tlb\");\n\n";
}

// Everything, with the classes as the function given writes them.
std::string ToIdl(const Library& library, std::string (*classToIdl)(const Class&))
{
    std::string text = HeadOf(library);
    for (const Enumeration& enumeration : library.enumerations)
        text += ToIdl(enumeration);
    for (const Class& described : library.classes) // each interface may name any other one
        text += "    interface " + described.interfaceName + ";\n";
    text += "\n";
    for (const Class& described : library.classes)
        text += InterfaceOf(described);
    for (const Class& described : library.classes)
        text += classToIdl(described);
    text.pop_back();
    return text + "};\n";
}

} // namespace

std::string ToIdl(const Library& library) { return ToIdl(library, &CoClassOf); }

std::string ToHeaderIdl(const Library& library) { return ToIdl(library, &ClassInHeader); }

} // namespace varnex3::server::idl
