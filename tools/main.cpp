// The program varnex3: reads Xalo messages for people and for scripts.
#include <cerrno>
#include <csignal>
#include <iostream>
#include <string>
#include <system_error>
#include <unistd.h>

#include "CommandLine.h"

using namespace varnex3::tool;

int main(int argumentCount, char** arguments)
{
    // A reader that has seen enough ends us quietly, even where our parent ignores the signal.
    static_cast<void>(std::signal(SIGPIPE, SIG_DFL));
    std::ios::sync_with_stdio(false);

    Terminal out(std::cout, STDOUT_FILENO);
    Terminal errors(std::cerr, STDERR_FILENO);
    Status status = Run(argumentCount, arguments, {out, errors});

    errno = 0;
    if (!std::cout.flush()) {
        const std::string reason = errno != 0 ? ": " + std::generic_category().message(errno) : "";
        errors.Line("varnex3: the output cannot be written" + reason);
        status = Status::CouldNotRun;
    }
    return static_cast<int>(status);
}
