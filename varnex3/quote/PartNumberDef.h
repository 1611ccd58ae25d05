// A part number by itself.
#pragma once

#include "varnex3/core/Rows.h"

namespace varnex3 {

class PartNumberDef final : public Record
{
    VARNEX_RECORD(PartNumberDef, "Holds a part number, for the host alone: it is neither written nor read.");
    VARNEX_PROPERTY(Text, sPartNumber, PartNumber, "Part number.");
    VARNEX_RECORD_END;
};

} // namespace varnex3
