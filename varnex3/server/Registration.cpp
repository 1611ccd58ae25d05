#include "varnex3/server/Registration.h"

#include <string>
#include <vector>

#include "varnex3/server/Coclass.h"
#include "varnex3/server/Module.h"
#include "varnex3/server/TypeLibrary.h"

extern "C" { // in the system's library, but in no header of mingw-w64
HRESULT WINAPI RegisterTypeLibForUser(ITypeLib* library, OLECHAR* path, OLECHAR* helpFolder);
HRESULT WINAPI UnRegisterTypeLibForUser(REFGUID id, WORD major, WORD minor, LCID locale, SYSKIND system);
}

namespace varnex3::server {

namespace {

// The type library of the component's file. Its identifier and version are those that are registered.
class Library
{
public:
    Library()
    {
        status = LoadTypeLibrary(&library);
        if (SUCCEEDED(status))
            status = library->GetLibAttr(&attributes);
    }
    ~Library()
    {
        if (attributes)
            library->ReleaseTLibAttr(attributes);
        if (library)
            library->Release();
    }
    Library(const Library&) = delete;
    Library& operator=(const Library&) = delete;

    HRESULT Status() const { return status; }
    GUID Id() const { return attributes->guid; }
    std::wstring Major() const { return std::to_wstring(attributes->wMajorVerNum); }
    std::wstring Version() const { return Major() + L"." + std::to_wstring(attributes->wMinorVerNum); }

    HRESULT Register(Scope scope) const
    {
        std::wstring path = Module::Path();
        return scope == Scope::User ? RegisterTypeLibForUser(library, path.data(), nullptr)
                                    : RegisterTypeLib(library, path.data(), nullptr);
    }
    HRESULT Unregister(Scope scope) const
    {
        const auto unregister = scope == Scope::User ? UnRegisterTypeLibForUser : UnRegisterTypeLib;
        return unregister(attributes->guid, attributes->wMajorVerNum, attributes->wMinorVerNum, attributes->lcid,
                          attributes->syskind);
    }

private:
    ITypeLib* library = nullptr;
    TLIBATTR* attributes = nullptr;
    HRESULT status = S_OK;
};

// The branch of the registry where classes stand.
class ClassesKey
{
public:
    explicit ClassesKey(Scope scope)
    {
        const HKEY hive = scope == Scope::User ? HKEY_CURRENT_USER : HKEY_LOCAL_MACHINE;
        status =
            RegCreateKeyExW(hive, L"Software\\Classes", 0, nullptr, 0, KEY_READ | KEY_WRITE, nullptr, &key, nullptr);
    }
    ~ClassesKey()
    {
        if (key)
            RegCloseKey(key);
    }
    ClassesKey(const ClassesKey&) = delete;
    ClassesKey& operator=(const ClassesKey&) = delete;

    LSTATUS Status() const { return status; }

    // The keys on the way to it are made, too. The empty name is the key's own value.
    LSTATUS Write(const std::wstring& path, const wchar_t* name, const std::wstring& value) const
    {
        const auto bytes = static_cast<DWORD>((value.size() + 1) * sizeof(wchar_t));
        return RegSetKeyValueW(key, path.c_str(), name, REG_SZ, value.c_str(), bytes);
    }

    // With everything under it. One that is not there is as good as deleted.
    LSTATUS Delete(const std::wstring& path) const
    {
        const LSTATUS deleted = RegDeleteTreeW(key, path.c_str());
        return deleted == ERROR_FILE_NOT_FOUND ? ERROR_SUCCESS : deleted;
    }

    // Whether it is there for programs of the other bitness.
    bool IsOtherwiseThere(const std::wstring& path) const
    {
        const REGSAM otherView = sizeof(void*) == 8 ? KEY_WOW64_32KEY : KEY_WOW64_64KEY;
        HKEY found = nullptr;
        if (RegOpenKeyExW(key, path.c_str(), 0, KEY_READ | otherView, &found) != ERROR_SUCCESS)
            return false;
        RegCloseKey(found);
        return true;
    }

private:
    HKEY key = nullptr;
    LSTATUS status = ERROR_SUCCESS;
};

std::wstring Wide(Name name) { return {name.begin(), name.end()}; }

std::wstring Wide(const GUID& id)
{
    wchar_t text[39] = L"";
    StringFromGUID2(id, text, 39);
    return text;
}

// The name that hosts create a class by, whatever the version.
std::wstring ProgIdOf(const Coclass& coclass) { return L"Varnex3." + Wide(coclass.info->name); }

std::wstring KeyOf(const Coclass& coclass) { return L"CLSID\\" + Wide(coclass.classId); }

struct RegistryValue
{
    std::wstring path;
    const wchar_t* name;
    std::wstring value;
};

std::vector<RegistryValue> ValuesOf(const Coclass& coclass, const Library& library)
{
    const std::wstring doc = Wide(coclass.info->doc);
    const std::wstring id = Wide(coclass.classId);
    const std::wstring key = KeyOf(coclass);
    const std::wstring progId = ProgIdOf(coclass);
    const std::wstring versionedProgId = progId + L"." + library.Major();
    return {{progId, nullptr, doc},
            {progId + L"\\CLSID", nullptr, id},
            {progId + L"\\CurVer", nullptr, versionedProgId},
            {versionedProgId, nullptr, doc},
            {versionedProgId + L"\\CLSID", nullptr, id},
            {key, nullptr, doc},
            {key + L"\\InprocServer32", nullptr, Module::Path()},
            {key + L"\\InprocServer32", L"ThreadingModel", L"Apartment"},
            {key + L"\\ProgID", nullptr, versionedProgId},
            {key + L"\\VersionIndependentProgID", nullptr, progId},
            {key + L"\\TypeLib", nullptr, Wide(library.Id())},
            {key + L"\\Version", nullptr, library.Version()},
            {key + L"\\Programmable", nullptr, L""}};
}

LSTATUS WriteClasses(const ClassesKey& key, const Library& library)
{
    LSTATUS status = key.Status();
    for (const Coclass& coclass : Coclasses())
        for (const RegistryValue& value : ValuesOf(coclass, library))
            if (status == ERROR_SUCCESS)
                status = key.Write(value.path, value.name, value.value);
    return status;
}

// A class's names are shared by both bitnesses, its identifier is not.
LSTATUS DeleteClass(const ClassesKey& key, const Coclass& coclass, const Library& library)
{
    LSTATUS status = key.Delete(KeyOf(coclass));
    if (key.IsOtherwiseThere(KeyOf(coclass)))
        return status;
    for (const std::wstring& path : {ProgIdOf(coclass), ProgIdOf(coclass) + L"." + library.Major()})
        if (status == ERROR_SUCCESS)
            status = key.Delete(path);
    return status;
}

LSTATUS DeleteClasses(const ClassesKey& key, const Library& library)
{
    LSTATUS status = key.Status();
    for (const Coclass& coclass : Coclasses())
        if (status == ERROR_SUCCESS)
            status = DeleteClass(key, coclass, library);
    return status;
}

HRESULT RegisterAll(Scope scope)
{
    const Library library;
    if (FAILED(library.Status()))
        return library.Status();
    const LSTATUS written = WriteClasses(ClassesKey(scope), library);
    return written == ERROR_SUCCESS ? library.Register(scope) : HRESULT_FROM_WIN32(written);
}

HRESULT UnregisterAll(Scope scope)
{
    const Library library;
    if (FAILED(library.Status()))
        return library.Status();
    const LSTATUS deleted = DeleteClasses(ClassesKey(scope), library);
    const HRESULT unregistered = library.Unregister(scope);
    if (deleted != ERROR_SUCCESS)
        return HRESULT_FROM_WIN32(deleted);
    return unregistered == TYPE_E_REGISTRYACCESS ? S_OK : unregistered; // it was not registered
}

template <class Action>
HRESULT Guarded(Action action) noexcept
{
    try {
        return action();
    } catch (...) {
        return E_OUTOFMEMORY;
    }
}

} // namespace

HRESULT Register(Scope scope) noexcept
{
    const HRESULT status = Guarded([&] { return RegisterAll(scope); });
    if (FAILED(status))
        Unregister(scope);
    return status;
}

HRESULT Unregister(Scope scope) noexcept
{
    return Guarded([&] { return UnregisterAll(scope); });
}

} // namespace varnex3::server
