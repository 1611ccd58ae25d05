#include "Terminal.h"

#include <algorithm>
#include <cstdlib>
#include <sys/ioctl.h>
#include <unistd.h>

#include "DisplayText.h"

namespace varnex3::tool {

namespace {

std::string_view Environment(const char* variable)
{
    const char* const value = std::getenv(variable);
    return value ? value : "";
}

bool AllowsColours()
{
    const bool isRefused = std::getenv("NO_COLOR") != nullptr;
    return !isRefused && Environment("TERM") != "dumb";
}

std::string_view CodeOf(Style style)
{
    switch (style) {
    case Style::Heading:
        return "\x1b[1m";
    case Style::Faint:
        return "\x1b[2m";
    case Style::Good:
        return "\x1b[32m";
    case Style::Bad:
        return "\x1b[31m";
    case Style::Plain:
        break;
    }
    return {};
}

std::string_view WithoutTrailingBlanks(std::string_view text) { return text.substr(0, text.find_last_not_of(' ') + 1); }

} // namespace

Terminal::Terminal(std::ostream& stream_, int descriptor_)
    : stream(stream_),
      descriptor(descriptor_),
      isTerminal(isatty(descriptor) == 1),
      hasColours(isTerminal && AllowsColours())
{}

std::size_t Terminal::Width() const
{
    constexpr std::size_t kUsual = 80;
    constexpr std::size_t kLeast = 20; // nobody reads anything in less
    winsize size{};
    const bool isKnown = isTerminal && ioctl(descriptor, TIOCGWINSZ, &size) == 0 && size.ws_col > 0;
    return isKnown ? std::max<std::size_t>(size.ws_col, kLeast) : kUsual;
}

std::string Terminal::Styled(Style style, std::string_view text) const
{
    if (!hasColours || style == Style::Plain || text.empty())
        return std::string(text);
    return std::string(CodeOf(style)).append(text).append("\x1b[0m");
}

void Terminal::Line(std::string_view text) { stream << WithoutTrailingBlanks(text) << '\n'; }

void Terminal::Paragraph(std::string_view text, std::size_t indentOfFurtherLines)
{
    const std::size_t width = Width();
    const std::string first = Wrapped(text, width).front();
    Line(first);
    text.remove_prefix(first.size());
    text.remove_prefix(std::min(text.find_first_not_of(' '), text.size()));
    if (text.empty())
        return;
    const std::size_t indent = std::min(indentOfFurtherLines, width / 2);
    for (const std::string& line : Wrapped(text, width - indent))
        Line(std::string(indent, ' ') + line);
}

} // namespace varnex3::tool
