// Facts as a person reads them: a title, then names and values; what has no value is left out.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

#include "Terminal.h"
#include "varnex3/core/Date.h"
#include "varnex3/core/Error.h"
#include "varnex3/core/Text.h"

namespace varnex3::tool {

class FactSheet
{
public:
    explicit FactSheet(Terminal& terminal_) : terminal(terminal_) {}

    // Begins a part. Its title is printed with the first thing that follows in it.
    void Part(std::string_view title_) { title = title_; }

    void Fact(std::string_view name, TextView value);
    void Fact(std::string_view name, Date value);
    // "yes", or nothing.
    void Flag(std::string_view name, bool isSo);
    // An amount, or nothing when it is 0.
    void Amount(std::string_view name, double amount);
    // The same, but 0 is told, too.
    void Total(std::string_view name, double amount);
    // Each value on a line of its own.
    void List(std::string_view name, const std::vector<Text>& values);
    // Why not everything could be read.
    void Failure(const Error& error);

    // For what prints itself in this part.
    Terminal& Begin();

private:
    void Print(std::string_view name, std::string_view value);

    Terminal& terminal;
    std::string_view title;
};

} // namespace varnex3::tool
