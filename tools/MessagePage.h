// A request for quote or a quote as a person would want to read it.
#pragma once

#include "Sections.h"
#include "Terminal.h"
#include "varnex3/inbox/MessageDef.h"

namespace varnex3::tool {

// Whether there is a page for messages of this type.
bool HasPage(MessageDef& message);

// The facts by subject, in words, without what has no value; of a quote its items as a table, and their sums. A section
// that could not be read to its end tells why.
void PrintPage(Terminal& terminal, const std::vector<OwnValue>& values, const std::vector<Section>& sections);

} // namespace varnex3::tool
