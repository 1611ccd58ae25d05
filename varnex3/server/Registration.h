// The component in the registry: its classes by identifier and by name, and its type library.
#pragma once

#include <windows.h>

namespace varnex3::server {

enum class Scope
{
    Machine, // for all users, which takes an administrator
    User
};

// Registers all or nothing: what fails leaves no trace.
HRESULT Register(Scope scope) noexcept;

// Leaves the registry as it was before, but for what the component of the other bitness needs, when that is registered
// too.
HRESULT Unregister(Scope scope) noexcept;

} // namespace varnex3::server
