// The branch of the registry where classes stand.
#pragma once

#include <optional>
#include <string>
#include <windows.h>

#include "varnex3/server/Registration.h"

namespace varnex3::server {

// Open as long as it lives. What of it was made for the component alone ends with it.
class ClassesKey
{
public:
    explicit ClassesKey(Scope scope);
    ~ClassesKey();
    ClassesKey(const ClassesKey&) = delete;
    ClassesKey& operator=(const ClassesKey&) = delete;

    // Whether it could be opened.
    LSTATUS Status() const { return status; }

    // The keys on the way to it are made, too. No name is the key's own value.
    LSTATUS Write(const std::wstring& path, const wchar_t* name, const std::wstring& value) const;

    // With everything under it. One that is not there is as good as deleted.
    LSTATUS Delete(const std::wstring& path) const;

    // The text that is a key's own value; nothing when it has none.
    std::optional<std::wstring> Read(const std::wstring& path) const;

    // Whether it is there for programs of the other bitness.
    bool IsOtherwiseThere(const std::wstring& path) const;

private:
    HKEY hive;
    HKEY key = nullptr;
    LSTATUS status;
};

} // namespace varnex3::server
