// What the program tells of a message, in its own words, and where the summary has it.
#pragma once

#include <span>
#include <string>

#include "varnex3/inbox/MessageDef.h"

namespace varnex3::tool {

struct SummaryField
{
    Name label;
    Name property;       // of MessageDef
    bool isHead = false; // tells what the message is, not what it says
};

// In the order in which a person reads them.
std::span<const SummaryField> SummaryFields();

// A property of the summary as text.
Text ValueOf(MessageDef& message, Name property);

// The name of a constant; the number when it has none.
std::string EnumeratorText(const EnumInfo& enumeration, std::int32_t value);

// Whether the root element is that of a message; Xalo_Unknown is.
bool IsMessage(MessageDef& message);

} // namespace varnex3::tool
