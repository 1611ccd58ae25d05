#include "varnex3/server/Registration.h"

#include <string>
#include <vector>

#include "varnex3/server/ClassesKey.h"
#include "varnex3/server/Coclass.h"
#include "varnex3/server/Module.h"
#include "varnex3/server/TypeLibraryFile.h"

namespace varnex3::server {

namespace {

std::wstring Wide(Name name) { return {name.begin(), name.end()}; }

// The name that hosts create a class by, whatever the version.
std::wstring ProgIdOf(const Coclass& coclass) { return L"Varnex3." + Wide(coclass.info->name); }

std::wstring KeyOf(const Coclass& coclass) { return L"CLSID\\" + ToText(coclass.classId); }

struct RegistryValue
{
    std::wstring path;
    const wchar_t* name;
    std::wstring value;
};

std::vector<RegistryValue> ValuesOf(const Coclass& coclass, const TypeLibraryFile& library)
{
    const std::wstring doc = Wide(coclass.info->doc);
    const std::wstring id = ToText(coclass.classId);
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
            {key + L"\\TypeLib", nullptr, ToText(library.Id())},
            {key + L"\\Version", nullptr, library.Version()},
            {key + L"\\Programmable", nullptr, L""}};
}

LSTATUS WriteClasses(const ClassesKey& key, const TypeLibraryFile& library)
{
    LSTATUS status = key.Status();
    for (const Coclass& coclass : Coclasses())
        for (const RegistryValue& value : ValuesOf(coclass, library))
            if (status == ERROR_SUCCESS)
                status = key.Write(value.path, value.name, value.value);
    return status;
}

// A class's names are shared by both bitnesses, its identifier is not.
LSTATUS DeleteClass(const ClassesKey& key, const Coclass& coclass, const TypeLibraryFile& library)
{
    LSTATUS status = key.Delete(KeyOf(coclass));
    if (key.IsOtherwiseThere(KeyOf(coclass)))
        return status;
    for (const std::wstring& path : {ProgIdOf(coclass), ProgIdOf(coclass) + L"." + library.Major()})
        if (status == ERROR_SUCCESS)
            status = key.Delete(path);
    return status;
}

LSTATUS DeleteClasses(const ClassesKey& key, const TypeLibraryFile& library)
{
    LSTATUS status = key.Status();
    for (const Coclass& coclass : Coclasses())
        if (status == ERROR_SUCCESS)
            status = DeleteClass(key, coclass, library);
    return status;
}

HRESULT RegisterAll(Scope scope)
{
    const TypeLibraryFile library(Module::Path());
    if (FAILED(library.Status()))
        return library.Status();
    const LSTATUS written = WriteClasses(ClassesKey(scope), library);
    return written == ERROR_SUCCESS ? library.Register(scope) : HRESULT_FROM_WIN32(written);
}

// With the library of one bitness the system may take the interfaces, which both share: the other's are written again.
void RegisterOther(const ClassesKey& key, const TypeLibraryFile& library, Scope scope)
{
    const std::optional<std::wstring> path = key.Read(library.OtherKey());
    if (!path)
        return;
    const TypeLibraryFile other(*path);
    if (SUCCEEDED(other.Status()))
        other.Register(scope);
}

// The ways in which systems say that there was no such library.
bool IsNotRegistered(HRESULT status)
{
    return status == TYPE_E_REGISTRYACCESS || status == TYPE_E_LIBNOTREGISTERED || status == E_INVALIDARG;
}

HRESULT UnregisterAll(Scope scope)
{
    const TypeLibraryFile library(Module::Path());
    if (FAILED(library.Status()))
        return library.Status();
    const ClassesKey key(scope);
    const LSTATUS deleted = DeleteClasses(key, library);
    const HRESULT unregistered = library.Unregister(scope);
    RegisterOther(key, library, scope);
    if (deleted != ERROR_SUCCESS)
        return HRESULT_FROM_WIN32(deleted);
    return IsNotRegistered(unregistered) ? S_OK : unregistered;
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
