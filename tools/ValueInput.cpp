#include "ValueInput.h"

#include <iostream>
#include <termios.h>
#include <unistd.h>

#include "varnex3/core/Error.h"

namespace varnex3::tool {

namespace {

// A terminal that does not show what is typed, as long as this lives.
class NoEcho
{
public:
    explicit NoEcho(bool isWanted) : isChanged(isWanted && tcgetattr(STDIN_FILENO, &before) == 0)
    {
        if (!isChanged)
            return;
        termios silent = before;
        silent.c_lflag &= ~static_cast<tcflag_t>(ECHO);
        tcsetattr(STDIN_FILENO, TCSAFLUSH, &silent);
    }

    ~NoEcho()
    {
        if (isChanged)
            tcsetattr(STDIN_FILENO, TCSAFLUSH, &before);
    }

    NoEcho(const NoEcho&) = delete;
    NoEcho& operator=(const NoEcho&) = delete;

private:
    termios before{};
    bool isChanged;
};

} // namespace

std::string ReadValue(bool isSecret, Terminal& prompt)
{
    const bool isTyped = isatty(STDIN_FILENO) == 1;
    const NoEcho noEcho(isTyped && isSecret);
    if (isTyped)
        prompt.Stream() << "Value: " << std::flush;
    std::string value;
    const bool isRead = static_cast<bool>(std::getline(std::cin, value));
    if (isTyped && isSecret)
        prompt.Line(); // the one that was typed does not show
    if (!isRead)
        Raise(ErrorNumber::InvalidArgument, "settings set", u"no value was given");
    return value;
}

} // namespace varnex3::tool
