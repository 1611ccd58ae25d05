// How far a long run has come, for the person who waits at a terminal.
#pragma once

#include <chrono>
#include <cstddef>

#include "Terminal.h"

namespace varnex3::tool {

// Nothing is shown unless the stream is a terminal and the run takes longer than a quarter of a second; the bar is
// gone again at the end.
class ProgressBar
{
public:
    ProgressBar(Terminal& terminal, std::size_t total);
    ~ProgressBar();
    ProgressBar(const ProgressBar&) = delete;
    ProgressBar& operator=(const ProgressBar&) = delete;

    // One more is done.
    void Step();

private:
    using Clock = std::chrono::steady_clock;

    void Draw();

    Terminal& terminal;
    std::size_t total;
    std::size_t done = 0;
    Clock::time_point nextDrawing;
    bool isShown = false;
};

} // namespace varnex3::tool
