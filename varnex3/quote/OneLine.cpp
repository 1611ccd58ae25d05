#include "varnex3/quote/OneLine.h"

namespace varnex3 {

Text OnOneLine(TextView text)
{
    Text line;
    line.reserve(text.size());
    for (const char16_t c : text) {
        if (c != u'\n') {
            line += c;
            continue;
        }
        if (line.ends_with(u'\r'))
            line.pop_back();
        line += u' ';
    }
    return line;
}

} // namespace varnex3
