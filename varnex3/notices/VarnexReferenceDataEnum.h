// A public class without members, which hosts may use by its name alone.
#pragma once

#include "varnex3/core/Rows.h"

namespace varnex3 {

class VarnexReferenceDataEnum final : public Record
{
    VARNEX_RECORD(VarnexReferenceDataEnum, "A predeclared class without members, kept for the hosts that refer to it.");
    VARNEX_PREDECLARED;
    VARNEX_RECORD_END;
};

} // namespace varnex3
