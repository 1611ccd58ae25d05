// What a message has beside the sections that there are classes for.
#pragma once

#include <optional>
#include <vector>

#include "ElementLines.h"
#include "Sections.h"
#include "varnex3/core/Error.h"
#include "varnex3/xml/Document.h"

namespace varnex3::tool {

// A value of its own that a message has, as the file has it.
struct OwnValue
{
    Name element;
    Text text;
    std::optional<Error> error; // why the message's class could not read it
};

// Those that messages of any type have, the number of the message and of its quote left out: the summary has them.
// Also what no class reads back: the reason of an inspection, the date of an invoice.
std::vector<OwnValue> ReadOwnValues(const xml::Document& document);

// All that stands below the root beside those values and the two numbers, but for what the sections tell. Of a section
// that could not be read to its end all comes here, of another one the elements that its class does not know.
std::vector<ElementLine> ReadOtherValues(const xml::Document& document, const std::vector<Section>& sections);

} // namespace varnex3::tool
