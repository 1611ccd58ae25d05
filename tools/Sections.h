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
    bool isEvery = false;       // read from every element of the name, not only the first
};

// Those sections below the root element that there is a class for, in the order in which messages have them. A class
// that is only ever written is read by its rows: its elements have the names of its properties.
std::vector<Section> ReadSections(const xml::Document& document);

} // namespace varnex3::tool
