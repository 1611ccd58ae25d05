// A file with a type library in it, and that library in the registry.
#pragma once

#include <string>
#include <windows.h>

#include <oleauto.h>

#include "varnex3/server/Registration.h"

namespace varnex3::server {

class TypeLibraryFile
{
public:
    explicit TypeLibraryFile(std::wstring path_);
    ~TypeLibraryFile();
    TypeLibraryFile(const TypeLibraryFile&) = delete;
    TypeLibraryFile& operator=(const TypeLibraryFile&) = delete;

    // Whether it could be loaded; that is the precondition of the rest.
    HRESULT Status() const { return status; }

    GUID Id() const { return attributes->guid; }
    std::wstring Major() const { return std::to_wstring(attributes->wMajorVerNum); }
    std::wstring Version() const { return Major() + L"." + std::to_wstring(attributes->wMinorVerNum); }

    HRESULT Register(Scope scope) const;
    HRESULT Unregister(Scope scope) const;

    // The key, below that of all classes, whose value is the file with the library for the other bitness.
    std::wstring OtherKey() const;

private:
    std::wstring path;
    ITypeLib* library = nullptr;
    TLIBATTR* attributes = nullptr;
    HRESULT status;
};

// With braces, as the registry has it.
std::wstring ToText(const GUID& id);

} // namespace varnex3::server
