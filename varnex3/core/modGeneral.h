// One indented line of XML, and one value or fragment out of a document.
#pragma once

#include "varnex3/core/Rows.h"

namespace varnex3 {

VARNEX_MODULE(modGeneral, "Writing one indented line of XML.");

VARNEX_FUNCTION(modGeneral, Text, Indent, (std::int32_t level),
                "That many TAB characters; none for 0 and below. A level above 32767 raises Overflow (6).");

VARNEX_FUNCTION(
    modGeneral, Text, FormatElement,
    (TextView name, TextView value, std::int16_t level, bool tagOnly, bool include, bool selfClose),
    "One line of XML at a level, ended with CR LF: nothing when include is False; the start tag alone when tagOnly is "
    "True (an end tag when the name begins with a slash), the value ignored; an empty-element tag when selfClose is "
    "True; else start tag, value and end tag. The value is not escaped.");

VARNEX_MODULE_END(modGeneral);

// The markup of the first element a path leads to, as a text; the empty text when there is none.
Variant GetNodeXML(const xml::Node& node, TextView path);

// The typed value of the first element a path leads to: its text; Empty when there is none.
Variant GetNodeValue(const xml::Node& node, TextView path);

} // namespace varnex3
