#include "varnex3/notices/Xalo_VarnexVersionChange.h"

namespace varnex3 {

VARNEX_DEFINE(Xalo_VarnexVersionChange);

void Xalo_VarnexVersionChange::Write(XmlWriter& xml) const
{
    xml.OpenMessage("Xalo_VarnexVersionChange");
    xml.Append(objVersionField, objSourceField, objDestinationField, objRepairerField);
    xml.CloseMessage("Xalo_VarnexVersionChange");
}

void Xalo_VarnexVersionChange::Read(const XmlSection& section)
{
    section.ReadInto(objVersionField, "Xalo_VarnexVersionChange/Version");
    section.ReadInto(objSourceField, "Xalo_VarnexVersionChange/Source");
    section.ReadInto(objDestinationField, "Xalo_VarnexVersionChange/Destination");
    section.ReadInto(objRepairerField, "Xalo_VarnexVersionChange/Repairer");
}

} // namespace varnex3
