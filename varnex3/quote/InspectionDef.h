// The request for an inspection of the vehicle.
#pragma once

#include "varnex3/core/Rows.h"

namespace varnex3 {

// What Serialise writes does not come back through ParseXML: it is written as an attribute and read from an element,
// and a quote looks for it under another name.
class InspectionDef final : public Record
{
    VARNEX_RECORD(InspectionDef, "The request for an inspection, by its reason.");
    VARNEX_SERIALISE(
        "An empty InspectionReqested element, spelled so, with the reason as its attribute, escaped and "
        "on one line: each line end in it, CR LF or LF, becomes a blank. Nothing when there is no reason.");
    VARNEX_PARSEXML(Variant, "Reads the reason from an InspectionReason element, not from the attribute that Serialise "
                             "writes; an absent one gives the empty text.");
    VARNEX_PROPERTY(Text, sInspectionReason, InspectionReason, "Why an inspection is asked for.");
    VARNEX_RECORD_END;
};

} // namespace varnex3
