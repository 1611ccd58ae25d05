#include "ProgressBar.h"

#include <algorithm>
#include <string>

namespace varnex3::tool {

namespace {

using namespace std::chrono_literals;

constexpr auto kPatience = 250ms;
constexpr auto kInterval = 100ms;
constexpr const char* kEraseLine = "\r\x1b[K";

} // namespace

ProgressBar::ProgressBar(Terminal& terminal_, std::size_t total_)
    : terminal(terminal_), total(total_), nextDrawing(Clock::now() + kPatience)
{}

ProgressBar::~ProgressBar()
{
    if (isShown)
        terminal.Stream() << kEraseLine << std::flush;
}

void ProgressBar::Step()
{
    ++done;
    if (!terminal.IsTerminal() || Clock::now() < nextDrawing)
        return;
    Draw();
    nextDrawing = Clock::now() + kInterval;
}

void ProgressBar::Draw()
{
    const std::string numbers = " " + std::to_string(done) + " of " + std::to_string(total) + " files";
    const std::size_t width = std::min<std::size_t>(terminal.Width() - 1, 80); // a full line would wrap
    if (numbers.size() + 3 > width)
        return;
    const std::size_t room = width - numbers.size() - 2;
    const std::size_t filled = room * done / total;
    terminal.Stream() << kEraseLine << '[' << std::string(filled, '#') << std::string(room - filled, '.') << ']'
                      << numbers << std::flush;
    isShown = true;
}

} // namespace varnex3::tool
