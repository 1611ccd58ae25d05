// Texts that are written on one line.
#pragma once

#include "varnex3/core/Text.h"

namespace varnex3 {

// The text with a blank for each CR LF and for each LF; a CR alone stays. OnOneLine(u"a\r\nb\nc") is u"a b c".
Text OnOneLine(TextView text);

} // namespace varnex3
