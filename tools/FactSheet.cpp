#include "FactSheet.h"

#include "DisplayText.h"
#include "RecordTree.h"
#include "varnex3/core/Conversions.h"

namespace varnex3::tool {

Terminal& FactSheet::Begin()
{
    if (title.empty())
        return terminal;
    terminal.Line();
    terminal.Line(terminal.Styled(Style::Heading, Cut(title, terminal.Width())));
    title = {};
    return terminal;
}

void FactSheet::Print(std::string_view name, std::string_view value) { PrintField(Begin(), 1, name, value); }

void FactSheet::Fact(std::string_view name, TextView value)
{
    if (IsSet(value))
        Print(name, Printable(value));
}

void FactSheet::Fact(std::string_view name, Date value)
{
    if (IsSet(value))
        Print(name, Printable(ToText(Variant(value))));
}

void FactSheet::Flag(std::string_view name, bool isSo)
{
    if (isSo)
        Print(name, "yes");
}

void FactSheet::Amount(std::string_view name, double amount)
{
    if (amount != 0)
        Total(name, amount);
}

void FactSheet::Total(std::string_view name, double amount) { Print(name, Printable(FormatAmount(amount))); }

void FactSheet::List(std::string_view name, const std::vector<Text>& values)
{
    for (const Text& value : values) {
        Print(name, Printable(value));
        name = {};
    }
}

void FactSheet::Failure(const Error& error)
{
    Begin();
    for (const std::string& line : Wrapped(Printable(ToUtf16(error.what())), terminal.Width() - 2))
        terminal.Line("  " + terminal.Styled(Style::Bad, line));
}

} // namespace varnex3::tool
