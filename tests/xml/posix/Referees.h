// Two established parsers, asked about a document: expat, checking namespaces, and libxml2.
#pragma once

#include <string>
#include <string_view>

namespace varnex3::xml::referees {

struct Opinion
{
    bool isAccepted = false;
    int error = 0;    // the parser's own number of the last thing it found wrong, warnings included
    std::string tree; // libxml2's, when accepted: a line an element, as List writes it
};

Opinion AskExpat(std::string_view bytes);
Opinion AskLibxml(std::string_view bytes);

} // namespace varnex3::xml::referees
