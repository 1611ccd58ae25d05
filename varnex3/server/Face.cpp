#include "varnex3/server/Face.h"

#include <ocidl.h>

#include "varnex3/server/Dispatch.h"
#include "varnex3/server/Module.h"
#include "varnex3/server/TypeLibrary.h"

namespace varnex3::server {

namespace {

Face& FaceOf(Port* port) { return Face::Of(*port->record); }

HRESULT STDMETHODCALLTYPE InterfaceSupportsErrorInfo(Port* self, REFIID iid) noexcept
{
    return iid == FaceOf(self).Class().interfaceId ? S_OK : S_FALSE;
}

HRESULT STDMETHODCALLTYPE GetClassInfo(Port* self, ITypeInfo** result) noexcept
{
    return FindTypeInfo(FaceOf(self).Class().classId, result);
}

struct SupportErrorInfoFunctions : UnknownFunctions
{
    decltype(&InterfaceSupportsErrorInfo) interfaceSupportsErrorInfo = &InterfaceSupportsErrorInfo;
};
constexpr SupportErrorInfoFunctions kSupportErrorInfo{};

struct ProvideClassInfoFunctions : UnknownFunctions
{
    decltype(&GetClassInfo) getClassInfo = &GetClassInfo;
};
constexpr ProvideClassInfoFunctions kProvideClassInfo{};

} // namespace

Face::Face(Record& record)
    : coclass(CoclassOf(record)),
      dispatch{coclass.vtable, &record},
      supportErrorInfo{&kSupportErrorInfo, &record},
      provideClassInfo{&kProvideClassInfo, &record}
{
    Module::AddUse();
}

Face::~Face() { Module::EndUse(); }

Face& Face::Of(Record& record)
{
    if (!record.Attached())
        record.Attached() = std::make_unique<Face>(record);
    return static_cast<Face&>(*record.Attached());
}

Port* Face::PortFor(const Ref<Record>& record)
{
    if (!record)
        return nullptr;
    Port* const port = &Of(*record).dispatch;
    record->AddRef();
    return port;
}

Port* Face::Find(REFIID iid)
{
    if (iid == IID_IUnknown || iid == IID_IDispatch || iid == coclass.interfaceId)
        return &dispatch;
    if (iid == IID_ISupportErrorInfo)
        return &supportErrorInfo;
    return iid == IID_IProvideClassInfo ? &provideClassInfo : nullptr;
}

Record* RecordBehind(const void* object)
{
    const auto* const port = static_cast<const Port*>(object);
    const auto* const functions = static_cast<const UnknownFunctions*>(port->vtable);
    return functions->queryInterface == &QueryInterface ? port->record : nullptr;
}

HRESULT STDMETHODCALLTYPE QueryInterface(Port* self, REFIID iid, void** result) noexcept
{
    if (!result)
        return E_POINTER;
    *result = FaceOf(self).Find(iid);
    if (!*result)
        return E_NOINTERFACE;
    self->record->AddRef();
    return S_OK;
}

ULONG STDMETHODCALLTYPE AddRef(Port* self) noexcept { return static_cast<ULONG>(self->record->AddRef()); }

ULONG STDMETHODCALLTYPE Release(Port* self) noexcept { return static_cast<ULONG>(self->record->Release()); }

} // namespace varnex3::server
