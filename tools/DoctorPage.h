// The report as a page for people.
#pragma once

#include "DoctorReport.h"
#include "Terminal.h"

namespace varnex3::tool {

void PrintPage(Terminal& terminal, const DoctorReport& report);

} // namespace varnex3::tool
