#include "SourceExcerpt.h"

#include <algorithm>
#include <vector>

#include "DisplayText.h"
#include "FileText.h"
#include "varnex3/xml/Characters.h"

namespace varnex3::tool {

namespace {

// A line from 1; CR LF, CR and LF each end one.
TextView LineOf(TextView text, std::uint32_t number)
{
    constexpr TextView kLineEnds = u"\r\n";
    for (std::uint32_t line = 1; line < number; ++line) {
        const std::size_t end = text.find_first_of(kLineEnds);
        if (end == TextView::npos)
            return {};
        text.remove_prefix(end + (text.substr(end, 2) == kLineEnds ? 2 : 1));
    }
    return text.substr(0, text.find_first_of(kLineEnds));
}

// Each character of a line as it is shown.
std::vector<std::string> ShownCharacters(TextView line)
{
    std::vector<std::string> shown;
    const char16_t* const end = line.data() + line.size();
    for (const char16_t* p = line.data(); p < end;) {
        const std::size_t length = std::max(xml::DecodePoint(p, end).length, std::uint32_t{1});
        shown.push_back(*p == u'\t' ? " " : Printable(TextView(p, length)));
        p += length;
    }
    return shown;
}

} // namespace

SourceExcerpt ExcerptAt(std::string_view bytes, const xml::ParseError& place, std::size_t width)
{
    const Text text = DecodeFileText(bytes);
    const std::vector<std::string> line = ShownCharacters(LineOf(text, place.line));
    const std::size_t target = std::min<std::size_t>(place.column - 1, line.size());

    // As much before the place as two thirds of the width hold, then as much behind it as there is room for.
    const std::size_t roomBefore = width * 2 / 3;
    std::size_t first = target;
    SourceExcerpt excerpt;
    while (first > 0 && excerpt.caret + DisplayWidth(line[first - 1]) <= roomBefore)
        excerpt.caret += DisplayWidth(line[--first]);
    if (first > 0) {
        excerpt.text = "…";
        ++excerpt.caret;
    }
    for (std::size_t i = first; i < line.size() && DisplayWidth(excerpt.text) <= width; ++i)
        excerpt.text += line[i];
    excerpt.text = Cut(excerpt.text, width);
    return excerpt;
}

} // namespace varnex3::tool
