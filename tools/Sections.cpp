#include "Sections.h"

#include "varnex3/varnex3.h"

namespace varnex3::tool {

namespace {

struct SectionClass
{
    Name element;
    const ClassInfo& info;
};

Section Read(const SectionClass& entry, const xml::Node& node)
{
    Section section{entry.element, entry.info.create(), {}};
    try {
        Variant markup = node.Xml();
        Call(*section.record, "ParseXML", {&markup, 1});
    } catch (const Error& error) {
        section.error = error;
    }
    return section;
}

} // namespace

std::vector<Section> ReadSections(const xml::Document& document)
{
    const SectionClass classes[] = {
        {"Version", VersionDef::Info()}, {"Source", SourceDef::Info()},     {"Destination", DestinationDef::Info()},
        {"Insurer", InsurerDef::Info()}, {"Repairer", RepairerDef::Info()}, {"ClaimHeader", ClaimHeaderDef::Info()},
        {"Vehicle", VehicleDef::Info()}, {"Customer", CustomerDef::Info()},
    };
    std::vector<Section> sections;
    for (const SectionClass& entry : classes)
        if (const xml::Node node = document.DocumentElement().SelectSingle(entry.element))
            sections.push_back(Read(entry, node));
    return sections;
}

} // namespace varnex3::tool
