#include "varnex3/server/ClassesKey.h"

namespace varnex3::server {

namespace {

constexpr const wchar_t* kPath = L"Software\\Classes";

void DeleteIfEmpty(HKEY parent, const wchar_t* path)
{
    HKEY key = nullptr;
    if (RegOpenKeyExW(parent, path, 0, KEY_READ, &key) != ERROR_SUCCESS)
        return;
    DWORD keys = 0;
    DWORD values = 0;
    const LSTATUS asked = RegQueryInfoKeyW(key, nullptr, nullptr, nullptr, &keys, nullptr, nullptr, &values, nullptr,
                                           nullptr, nullptr, nullptr);
    RegCloseKey(key);
    if (asked == ERROR_SUCCESS && keys == 0 && values == 0)
        RegDeleteKeyW(parent, path);
}

} // namespace

ClassesKey::ClassesKey(Scope scope)
    : hive(scope == Scope::User ? HKEY_CURRENT_USER : HKEY_LOCAL_MACHINE),
      status(RegCreateKeyExW(hive, kPath, 0, nullptr, 0, KEY_READ | KEY_WRITE, nullptr, &key, nullptr))
{}

ClassesKey::~ClassesKey()
{
    if (!key)
        return;
    DeleteIfEmpty(key, L"CLSID");
    RegCloseKey(key);
    DeleteIfEmpty(hive, kPath);
}

LSTATUS ClassesKey::Write(const std::wstring& path, const wchar_t* name, const std::wstring& value) const
{
    const auto bytes = static_cast<DWORD>((value.size() + 1) * sizeof(wchar_t));
    return RegSetKeyValueW(key, path.c_str(), name, REG_SZ, value.c_str(), bytes);
}

LSTATUS ClassesKey::Delete(const std::wstring& path) const
{
    const LSTATUS deleted = RegDeleteTreeW(key, path.c_str());
    return deleted == ERROR_FILE_NOT_FOUND ? ERROR_SUCCESS : deleted;
}

std::optional<std::wstring> ClassesKey::Read(const std::wstring& path) const
{
    DWORD bytes = 0;
    if (RegGetValueW(key, path.c_str(), nullptr, RRF_RT_REG_SZ, nullptr, nullptr, &bytes) != ERROR_SUCCESS)
        return std::nullopt;
    std::wstring value(bytes / sizeof(wchar_t), L'\0');
    if (RegGetValueW(key, path.c_str(), nullptr, RRF_RT_REG_SZ, nullptr, value.data(), &bytes) != ERROR_SUCCESS)
        return std::nullopt;
    value.resize(value.find(L'\0'));
    return value;
}

bool ClassesKey::IsOtherwiseThere(const std::wstring& path) const
{
    const REGSAM otherView = sizeof(void*) == 8 ? KEY_WOW64_32KEY : KEY_WOW64_64KEY;
    const std::wstring whole = std::wstring(kPath) + L"\\" + path; // the views part on the way from the hive
    HKEY found = nullptr;
    if (RegOpenKeyExW(hive, whole.c_str(), 0, KEY_READ | otherView, &found) != ERROR_SUCCESS)
        return false;
    RegCloseKey(found);
    return true;
}

} // namespace varnex3::server
