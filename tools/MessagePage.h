// A message as a person would want to read it.
#pragma once

#include "OwnValues.h"
#include "Sections.h"
#include "Terminal.h"
#include "varnex3/inbox/MessageDef.h"

namespace varnex3::tool {

// Whether there is a page for messages of this type: there is for every message that has a class.
bool HasPage(MessageDef& message);

// The facts by subject, in words, without what has no value; as tables the items of a quote, the amounts of an invoice,
// the errors of a report and the codes of reference data. A section that could not be read to its end tells why.
void PrintPage(Terminal& terminal, const std::vector<OwnValue>& values, const std::vector<Section>& sections);

} // namespace varnex3::tool
