// varnex3 doctor: why the workshop's database does or does not answer, on one page that shows no password.
#pragma once

#include "Status.h"
#include "Terminal.h"

namespace varnex3::tool {

struct DoctorOptions
{
    bool isJson = false;
};

// Whatever keeps the database from answering is a finding. Changes nothing, and tries the server once.
Status Doctor(const DoctorOptions& options, const Console& console);

} // namespace varnex3::tool
