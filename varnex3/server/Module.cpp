#include "varnex3/server/Module.h"

#include <atomic>

// Made by the linker: the module's first byte.
extern "C" IMAGE_DOS_HEADER __ImageBase;

namespace varnex3::server {

namespace {

constinit std::atomic<long> uses = 0;

} // namespace

HINSTANCE Module::Handle() { return reinterpret_cast<HINSTANCE>(&__ImageBase); }

std::wstring Module::Path()
{
    std::wstring path(MAX_PATH, L'\0');
    for (;;) {
        const DWORD length = GetModuleFileNameW(Handle(), path.data(), static_cast<DWORD>(path.size()));
        if (length < path.size()) {
            path.resize(length);
            return path;
        }
        path.resize(2 * path.size()); // cut: a longer path than fits
    }
}

void Module::AddUse() noexcept { ++uses; }
void Module::EndUse() noexcept { --uses; }
bool Module::IsUsed() noexcept { return uses != 0; }

} // namespace varnex3::server
