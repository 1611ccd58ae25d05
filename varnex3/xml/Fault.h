// A fault as the parser notes it, and as it is reported.
#pragma once

#include <string_view>

#include "varnex3/xml/ParseError.h"

namespace varnex3::xml {

// Two names in a sentence are "%1" and "%2"; "%c" is the character at the fault.
template <class Char>
struct Fault
{
    ErrorCode code = ErrorCode::None;
    const Char* at = nullptr;
    const char* sentence = "";
    std::basic_string_view<Char> first = {};
    std::basic_string_view<Char> second = {};
};

// The report, with the fault's line and column counted from the start of the text.
template <class Char>
ParseError Report(const Fault<Char>& fault, std::basic_string_view<Char> text);

} // namespace varnex3::xml
