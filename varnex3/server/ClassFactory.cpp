#include "varnex3/server/ClassFactory.h"

#include "varnex3/server/Errors.h"
#include "varnex3/server/Face.h"
#include "varnex3/server/Module.h"

namespace varnex3::server {

namespace {

// References to it are uses of the component; it has no count of its own.
struct ClassFactory
{
    const void* vtable = nullptr;
    const Coclass* coclass = nullptr;
};

ULONG STDMETHODCALLTYPE AddRef(ClassFactory*) noexcept
{
    Module::AddUse();
    return 2;
}

ULONG STDMETHODCALLTYPE Release(ClassFactory*) noexcept
{
    Module::EndUse();
    return 1;
}

HRESULT STDMETHODCALLTYPE QueryInterface(ClassFactory* self, REFIID iid, void** result) noexcept
{
    if (!result)
        return E_POINTER;
    const bool isKnown = iid == IID_IUnknown || iid == IID_IClassFactory;
    *result = isKnown ? self : nullptr;
    if (!isKnown)
        return E_NOINTERFACE;
    AddRef(self);
    return S_OK;
}

HRESULT STDMETHODCALLTYPE CreateInstance(ClassFactory* self, IUnknown* outer, REFIID iid, void** result) noexcept
{
    if (!result)
        return E_POINTER;
    *result = nullptr;
    if (outer)
        return CLASS_E_NOAGGREGATION;
    const ClassInfo& info = *self->coclass->info;
    try {
        Port* const port = Face::PortFor(info.create());
        const HRESULT status = QueryInterface(port, iid, result);
        Release(port);
        return status;
    } catch (...) {
        return Raised(info.name, "New");
    }
}

HRESULT STDMETHODCALLTYPE LockServer(ClassFactory*, BOOL isLocked) noexcept
{
    if (isLocked)
        Module::AddUse();
    else
        Module::EndUse();
    return S_OK;
}

struct ClassFactoryFunctions
{
    HRESULT(STDMETHODCALLTYPE* queryInterface)(ClassFactory*, REFIID, void**) noexcept = &QueryInterface;
    ULONG(STDMETHODCALLTYPE* addRef)(ClassFactory*) noexcept = &AddRef;
    ULONG(STDMETHODCALLTYPE* release)(ClassFactory*) noexcept = &Release;
    decltype(&CreateInstance) createInstance = &CreateInstance;
    decltype(&LockServer) lockServer = &LockServer;
};
constexpr ClassFactoryFunctions kClassFactory{};

std::vector<ClassFactory> MakeFactories()
{
    std::vector<ClassFactory> factories;
    for (const Coclass& coclass : Coclasses())
        factories.push_back({&kClassFactory, &coclass});
    return factories;
}

} // namespace

HRESULT FindFactory(const Coclass& coclass, REFIID iid, void** result)
{
    static std::vector<ClassFactory> factories = MakeFactories();
    return QueryInterface(&factories[static_cast<std::size_t>(&coclass - Coclasses().data())], iid, result);
}

} // namespace varnex3::server
