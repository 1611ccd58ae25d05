#include "varnex3/server/Module.h"

#include <atomic>
#include <cstring>

// Made by the linker: the module's first byte.
extern "C" IMAGE_DOS_HEADER __ImageBase;

namespace varnex3::server {

namespace {

constinit std::atomic<long> uses = 0;

} // namespace

HINSTANCE Module::Handle() { return reinterpret_cast<HINSTANCE>(&__ImageBase); }

// The resource is a header of three words, the text "VS_VERSION_INFO" with its zero, and at the next multiple of four
// the numbers.
std::optional<LibraryVersion> Module::Version() noexcept
{
    constexpr std::size_t kNumbers = 40;
    const HRSRC resource = FindResourceW(Handle(), MAKEINTRESOURCEW(VS_VERSION_INFO), RT_VERSION);
    if (!resource || SizeofResource(Handle(), resource) < kNumbers + sizeof(VS_FIXEDFILEINFO))
        return std::nullopt;
    const auto* const bytes = static_cast<const char*>(LockResource(LoadResource(Handle(), resource)));
    VS_FIXEDFILEINFO info{};
    std::memcpy(&info, bytes + kNumbers, sizeof info);
    if (info.dwSignature != VS_FFI_SIGNATURE)
        return std::nullopt;
    return LibraryVersion{static_cast<std::int16_t>(HIWORD(info.dwFileVersionMS)),
                          static_cast<std::int16_t>(LOWORD(info.dwFileVersionMS))};
}

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
