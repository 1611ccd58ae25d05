#include "varnex3/server/TypeLibrary.h"

#include <utility>

#include "varnex3/server/Errors.h"
#include "varnex3/server/Module.h"

namespace varnex3::server {

namespace {

class Lock
{
public:
    explicit Lock(SRWLOCK& lock_) : lock(lock_) { AcquireSRWLockExclusive(&lock); }
    ~Lock() { ReleaseSRWLockExclusive(&lock); }
    Lock(const Lock&) = delete;
    Lock& operator=(const Lock&) = delete;

private:
    SRWLOCK& lock;
};

SRWLOCK heldLock = SRWLOCK_INIT;
ITypeLib* held = nullptr;

HRESULT Load() noexcept
{
    try {
        return LoadTypeLibEx(Module::Path().c_str(), REGKIND_NONE, &held);
    } catch (...) {
        return E_OUTOFMEMORY;
    }
}

} // namespace

HRESULT FindTypeInfo(REFGUID id, ITypeInfo** result) noexcept
{
    if (!result)
        return E_POINTER;
    *result = nullptr;
    const Lock lock(heldLock);
    const HRESULT status = held ? S_OK : Load();
    return FAILED(status) ? status : held->GetTypeInfoOfGuid(id, result);
}

void ReleaseTypeLibrary() noexcept
{
    const Lock lock(heldLock);
    if (ITypeLib* const library = std::exchange(held, nullptr))
        library->Release();
}

} // namespace varnex3::server
