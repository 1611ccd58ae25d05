// The version of the message language, first in every message.
#pragma once

#include "varnex3/core/Rows.h"

namespace varnex3 {

// The version that DLLVersion tells: the one compiled in, unless the component finds another in its own file.
struct LibraryVersion
{
    std::int16_t major;
    std::int16_t minor;
};
LibraryVersion& RunningVersion();

class VersionDef final : public Record
{
    VARNEX_RECORD(VersionDef, "The version of the message language that a message is written in.");
    VARNEX_SERIALISE("The Version group, always written.");
    VARNEX_PARSEXML(Variant, "Reads the version; an absent one gives the empty text, and nothing here is an error.");
    VARNEX_PROPERTY(Text, sXaloVersion, XaloVersion, "Version of the message language, such as 1.6.");
    VARNEX_READONLY(Text, DLLVersion, "Version of this library: major and minor number, such as 3.0.");
    VARNEX_RECORD_END;
};

} // namespace varnex3
