// Reference data as tables of codes.
#pragma once

#include "FactSheet.h"
#include "varnex3/notices/ReferenceDataDef.h"

namespace varnex3::tool {

// A part for each data type: its codes and what they mean.
void PrintReferenceData(FactSheet& sheet, ReferenceDataDef& data);

} // namespace varnex3::tool
