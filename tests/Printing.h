// How failing checks show texts and variants: as UTF-8 between quotes, with TAB and line ends visible.
#pragma once

#include <doctest/doctest.h>

#include <string>

#include "varnex3/core/Conversions.h"
#include "varnex3/core/Error.h"

namespace varnex3::tests {

inline std::string Visible(TextView text)
{
    std::string shown = "\"";
    for (const char c : ToUtf8(text)) {
        if (c == '\t')
            shown += "\\t";
        else if (c == '\r')
            shown += "\\r";
        else if (c == '\n')
            shown += "\\n";
        else
            shown += c;
    }
    return shown + "\"";
}

// "13 ClaimHeaderDef.ReinstatementNo", or "none": what an action raises.
template <class Action>
std::string RaisedBy(Action action)
{
    try {
        action();
        return "none";
    } catch (const Error& error) {
        return error.Source().empty() ? std::to_string(error.Number())
                                      : std::to_string(error.Number()) + " " + ToUtf8(error.Source());
    }
}

} // namespace varnex3::tests

template <>
struct doctest::StringMaker<varnex3::Text>
{
    static String convert(const varnex3::Text& text) { return varnex3::tests::Visible(text).c_str(); }
};
template <>
struct doctest::StringMaker<varnex3::Date>
{
    static String convert(varnex3::Date date) { return toString(date.serial); }
};
