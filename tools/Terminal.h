// A stream that people may be looking at: how wide it is, and whether it takes colours.
#pragma once

#include <cstddef>
#include <ostream>
#include <string>
#include <string_view>

namespace varnex3::tool {

enum class Style
{
    Plain,
    Heading,
    Faint,
    Good,
    Bad
};

class Terminal
{
public:
    Terminal(std::ostream& stream, int descriptor);

    bool IsTerminal() const { return isTerminal; }

    // In columns, at least 20; 80 when the stream is no terminal, or does not say.
    std::size_t Width() const;

    // A text in a style; as it is unless the stream is a terminal and NO_COLOR is unset.
    std::string Styled(Style style, std::string_view text) const;

    // A line, without the blanks at its end.
    void Line(std::string_view text = {});

    // A text wrapped to the width; lines after the first are indented.
    void Paragraph(std::string_view text, std::size_t indentOfFurtherLines = 0);

    std::ostream& Stream() { return stream; }

private:
    std::ostream& stream;
    int descriptor;
    bool isTerminal;
    bool hasColours;
};

// The two streams of a program.
struct Console
{
    Terminal& out;
    Terminal& errors;
};

} // namespace varnex3::tool
