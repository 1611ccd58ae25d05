// The component as a loaded module: where it is, which version it is, and whether somebody still uses it.
#pragma once

#include <optional>
#include <string>
#include <windows.h>

#include "varnex3/core/VersionDef.h"

namespace varnex3::server {

class Module
{
public:
    static HINSTANCE Handle();

    // The numbers of the version resource; nothing when there is none.
    static std::optional<LibraryVersion> Version() noexcept;

    // The full path of the component's file, of whatever length.
    static std::wstring Path();

    // The component stays loaded while there are uses: records that hosts hold, class factories and their locks.
    static void AddUse() noexcept;
    static void EndUse() noexcept;
    static bool IsUsed() noexcept;
};

} // namespace varnex3::server
