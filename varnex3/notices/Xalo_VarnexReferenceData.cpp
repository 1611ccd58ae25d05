#include "varnex3/notices/Xalo_VarnexReferenceData.h"

namespace varnex3 {

VARNEX_DEFINE(Xalo_VarnexReferenceData);

void Xalo_VarnexReferenceData::Write(XmlWriter& xml) const
{
    xml.OpenMessage("Xalo_VarnexReferenceData");
    xml.Append(objVersionField, objSourceField, objDestinationField, objRepairerField, objReferenceDataField);
    xml.CloseMessageWithoutLineEnd("Xalo_VarnexReferenceData");
}

void Xalo_VarnexReferenceData::Read(const XmlSection& section)
{
    section.ReadInto(objVersionField, "Xalo_VarnexReferenceData/Version");
    section.ReadInto(objSourceField, "Xalo_VarnexReferenceData/Source");
    section.ReadInto(objDestinationField, "Xalo_VarnexReferenceData/Destination");
    section.ReadInto(objRepairerField, "Xalo_VarnexReferenceData/Repairer");
    section.ReadInto(objReferenceDataField, "Xalo_VarnexReferenceData/ReferenceData");
}

} // namespace varnex3
