// A public class without members.
#pragma once

#include "varnex3/core/Rows.h"

namespace varnex3 {

class XaloBase final : public Record
{
    VARNEX_RECORD(XaloBase, "A class without members, kept for the hosts that name it.");
    VARNEX_RECORD_END;
};

} // namespace varnex3
