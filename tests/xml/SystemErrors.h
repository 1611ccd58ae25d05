// What the system refuses.
#pragma once

#include <system_error>

namespace varnex3::tests {

// The number of <cerrno> that an action fails with; 0 when it does not.
template <class Action>
int ErrorOf(Action action)
{
    try {
        action();
    } catch (const std::system_error& error) {
        return error.code().value();
    }
    return 0;
}

} // namespace varnex3::tests
