// The sections of a message, each read by the record class it belongs to.
#pragma once

#include <optional>
#include <vector>

#include "varnex3/core/Error.h"
#include "varnex3/core/Interface.h"
#include "varnex3/xml/Document.h"

namespace varnex3::tool {

struct Section
{
    Name element;
    Ref<Record> record;         // with what was read before an error
    std::optional<Error> error; // why the class could not read all of it
};

// A value that a message has beside its sections, as the file has it.
struct OwnValue
{
    Name element;
    Text text;
    std::optional<Error> error; // why the message's class could not read it
};

// Those that a quote has; the reason of an inspection, which no class reads, too. Other messages have none.
std::vector<OwnValue> ReadOwnValues(const xml::Document& document);

// Those sections below the root element that there is a class for, in the order in which messages have them.
std::vector<Section> ReadSections(const xml::Document& document);

} // namespace varnex3::tool
