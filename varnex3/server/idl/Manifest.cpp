#include "varnex3/server/idl/Manifest.h"

namespace varnex3::server::idl {

namespace {

// The marshaler of automation interfaces, which every Windows has.
constexpr std::string_view kProxyStub = "{00020424-0000-0000-C000-000000000046}";

std::string Escaped(std::string_view text)
{
    std::string escaped;
    for (const char c : text)
        escaped += c == '&' ? "&amp;" : c == '<' ? "&lt;" : c == '"' ? "&quot;" : std::string(1, c);
    return escaped;
}

std::string Attribute(std::string_view name, std::string_view value)
{
    return " " + std::string(name) + "=\"" + Escaped(value) + "\"";
}

std::string Braced(const std::string& guid) { return "{" + guid + "}"; }

std::string ToText(const Class& described, const Library& library)
{
    const std::string name = library.name + "." + described.name;
    return "    <comClass" + Attribute("clsid", Braced(described.guid)) + Attribute("progid", name)
           + Attribute("threadingModel", "Apartment") + Attribute("tlbid", Braced(library.guid)) + ">\n      <progid>"
           + name + "." + std::to_string(library.major) + "</progid>\n    </comClass>\n";
}

std::string InterfaceOf(const Class& described, const Library& library)
{
    return "  <comInterfaceExternalProxyStub" + Attribute("name", described.interfaceName)
           + Attribute("iid", Braced(described.interfaceGuid)) + Attribute("tlbid", Braced(library.guid))
           + Attribute("proxyStubClsid32", kProxyStub) + "/>\n";
}

} // namespace

std::string ToManifest(const Library& library, std::string_view architecture, std::string_view version)
{
    std::string text = "<?xml version=\"1.0\" encoding=\"UTF-8\" standalone=\"yes\"?>\n"
                       "<assembly xmlns=\"urn:schemas-microsoft-com:asm.v1\" manifestVersion=\"1.0\">\n"
                       "  <assemblyIdentity"
                       + Attribute("type", "win32") + Attribute("name", library.name + ".Component")
                       + Attribute("version", version) + Attribute("processorArchitecture", architecture)
                       + "/>\n  <file" + Attribute("name", library.name + ".dll") + ">\n";
    for (const Class& described : library.classes)
        text += ToText(described, library);
    text += "    <typelib" + Attribute("tlbid", Braced(library.guid))
            + Attribute("version", std::to_string(library.major) + "." + std::to_string(library.minor))
            + Attribute("helpdir", "") + Attribute("flags", "HASDISKIMAGE") + "/>\n  </file>\n";
    for (const Class& described : library.classes)
        text += InterfaceOf(described, library);
    return text + "</assembly>\n";
}

} // namespace varnex3::server::idl
