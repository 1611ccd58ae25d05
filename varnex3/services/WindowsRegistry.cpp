// The registry of Windows, through its ANSI functions.
#include <windows.h>

#include "varnex3/services/Registry.h"

namespace varnex3 {

namespace {

HKEY HandleOf(RegistryRoot root) { return root == RegistryRoot::LocalMachine ? HKEY_LOCAL_MACHINE : HKEY_CURRENT_USER; }

HKEY HandleOf(RegistryKey key) { return reinterpret_cast<HKEY>(key); }

RegistryKey KeyOf(HKEY handle) { return static_cast<RegistryKey>(reinterpret_cast<std::uintptr_t>(handle)); }

RegistryStatus StatusOf(LSTATUS error) { return static_cast<RegistryStatus>(error); }

class WindowsRegistry final : public Registry
{
public:
    RegistryStatus Open(RegistryRoot root, const std::string& path, RegistryKey& key) override
    {
        HKEY handle = nullptr;
        const LSTATUS error = RegOpenKeyExA(HandleOf(root), path.c_str(), 0, KEY_ALL_ACCESS, &handle);
        key = KeyOf(error == ERROR_SUCCESS ? handle : nullptr);
        return StatusOf(error);
    }

    RegistryStatus Create(RegistryRoot root, const std::string& path, RegistryKey& key) override
    {
        char noClass[] = "";
        HKEY handle = nullptr;
        const LSTATUS error = RegCreateKeyExA(HandleOf(root), path.c_str(), 0, noClass, REG_OPTION_NON_VOLATILE,
                                              KEY_ALL_ACCESS, nullptr, &handle, nullptr);
        key = KeyOf(error == ERROR_SUCCESS ? handle : nullptr);
        return StatusOf(error);
    }

    QueriedValue Query(RegistryKey key, const std::string& name, std::span<char> buffer) override
    {
        DWORD type = REG_NONE;
        auto length = static_cast<DWORD>(buffer.size());
        const LSTATUS error = RegQueryValueExA(HandleOf(key), name.c_str(), nullptr, &type,
                                               reinterpret_cast<BYTE*>(buffer.data()), &length);
        return {StatusOf(error), static_cast<RegistryType>(type), length};
    }

    RegistryStatus Set(RegistryKey key, const std::string& name, RegistryType type, std::string_view data) override
    {
        return StatusOf(RegSetValueExA(HandleOf(key), name.c_str(), 0, static_cast<DWORD>(type),
                                       reinterpret_cast<const BYTE*>(data.data()), static_cast<DWORD>(data.size())));
    }

    RegistryStatus Delete(RegistryRoot root, const std::string& path) override
    {
        return StatusOf(RegDeleteKeyA(HandleOf(root), path.c_str()));
    }

    RegistryStatus Close(RegistryKey key) override { return StatusOf(RegCloseKey(HandleOf(key))); }
};

} // namespace

Registry& SystemRegistry()
{
    static WindowsRegistry registry;
    return registry;
}

std::string ToCodePage(TextView text)
{
    const auto* const wide = reinterpret_cast<const wchar_t*>(text.data()); // 16 bits on Windows
    const auto count = static_cast<int>(text.size());
    const int length = WideCharToMultiByte(CP_ACP, 0, wide, count, nullptr, 0, nullptr, nullptr);
    std::string bytes(static_cast<std::size_t>(length), '\0');
    WideCharToMultiByte(CP_ACP, 0, wide, count, bytes.data(), length, nullptr, nullptr);
    return bytes;
}

Text FromCodePage(std::string_view bytes)
{
    const auto count = static_cast<int>(bytes.size());
    const int length = MultiByteToWideChar(CP_ACP, 0, bytes.data(), count, nullptr, 0);
    Text text(static_cast<std::size_t>(length), u'\0');
    MultiByteToWideChar(CP_ACP, 0, bytes.data(), count, reinterpret_cast<wchar_t*>(text.data()), length);
    return text;
}

} // namespace varnex3
