// The versions that a version change announces.
#pragma once

#include "varnex3/core/Rows.h"

namespace varnex3 {

class VersionChangeDef final : public Record
{
    VARNEX_RECORD(VersionChangeDef, "The versions in force and the next one.");
    VARNEX_SERIALISE("The Version group with the versions that are not empty; nothing when all are. Nothing is "
                     "escaped.");
    VARNEX_PARSEXML_OF_MESSAGE(Text, "Reads the three versions and gives the record written again; an absent one is "
                                     "the empty text, and nothing here is an error.");
    VARNEX_PROPERTY(Text, sXaloVersion, XaloVersion, "Version of the message language.");
    VARNEX_PROPERTY(Text, sVarnexVersion, VarnexVersion, "Version of the exchange that is in force.");
    VARNEX_PROPERTY(Text, sNextVarnexVersion, NextVarnexVersion, "Version of the exchange that comes next.");
    VARNEX_RECORD_END;
};

} // namespace varnex3
