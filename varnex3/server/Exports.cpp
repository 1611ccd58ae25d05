// What the system and regsvr32 call.
#include <windows.h>

#include "varnex3/server/ClassFactory.h"
#include "varnex3/server/Module.h"
#include "varnex3/server/Registration.h"
#include "varnex3/server/TypeLibrary.h"

using namespace varnex3;
using namespace varnex3::server;

namespace __gnu_cxx {

void __freeres(); // of libstdc++, declared in no header: frees the memory that it sets aside for exceptions

} // namespace __gnu_cxx

BOOL WINAPI DllMain(HINSTANCE, DWORD reason, LPVOID processEnds)
{
    const bool isLoaded = reason == DLL_PROCESS_ATTACH;
    if (const auto version = isLoaded ? Module::Version() : std::nullopt)
        RunningVersion() = *version;
    if (reason == DLL_PROCESS_DETACH && !processEnds)
        __gnu_cxx::__freeres();
    return TRUE;
}

STDAPI DllGetClassObject(REFCLSID classId, REFIID iid, LPVOID* result)
{
    if (!result)
        return E_POINTER;
    *result = nullptr;
    try {
        const Coclass* const coclass = FindCoclass(classId);
        return coclass ? FindFactory(*coclass, iid, result) : CLASS_E_CLASSNOTAVAILABLE;
    } catch (...) {
        return E_OUTOFMEMORY;
    }
}

STDAPI DllCanUnloadNow()
{
    if (Module::IsUsed())
        return S_FALSE;
    ReleaseTypeLibrary();
    return S_OK;
}

STDAPI DllRegisterServer() { return Register(Scope::Machine); }
STDAPI DllUnregisterServer() { return Unregister(Scope::Machine); }

// regsvr32 /n /i:user registers for the user alone, which takes no administrator.
STDAPI DllInstall(BOOL isInstalled, LPCWSTR words)
{
    if (!words || lstrcmpiW(words, L"user") != 0)
        return E_INVALIDARG;
    return isInstalled ? Register(Scope::User) : Unregister(Scope::User);
}
