#include "varnex3/server/Dispatch.h"

#include <algorithm>

#include "varnex3/server/Errors.h"
#include "varnex3/server/LateCall.h"
#include "varnex3/server/TypeLibrary.h"

namespace varnex3::server {

namespace {

const Coclass& ClassOf(Port* port) { return Face::Of(*port->record).Class(); }

bool IsSame(Name name, LPCOLESTR given)
{
    for (const char c : name)
        if (ToLower(static_cast<char16_t>(c)) != ToLower(static_cast<char16_t>(*given++)))
            return false;
    return *given == 0;
}

template <class Named>
DISPID PlaceOf(std::span<const Named> all, LPCOLESTR name)
{
    const auto found = std::ranges::find_if(all, [&](const Named& one) { return IsSame(one.name, name); });
    return found == all.end() ? DISPID_UNKNOWN : static_cast<DISPID>(found - all.begin());
}

// What a host may say to reach a slot. A property that is stored has one way in: Let and Set both take it, and the
// value decides; hosts that read a property as if they called it mean the same.
WORD FlagsFor(Access access)
{
    switch (access) {
    case Access::Call:
        return DISPATCH_METHOD;
    case Access::Get:
        return DISPATCH_METHOD | DISPATCH_PROPERTYGET;
    case Access::Put:
    case Access::PutReference:
        break;
    }
    return DISPATCH_PROPERTYPUT | DISPATCH_PROPERTYPUTREF;
}

const Operation* FindOperation(const Coclass& coclass, DISPID id, WORD flags)
{
    const auto found = std::ranges::find_if(coclass.operations, [&](const Operation& operation) {
        return operation.dispid == id && (flags & FlagsFor(operation.access)) != 0;
    });
    return found == coclass.operations.end() ? nullptr : &*found;
}

} // namespace

HRESULT STDMETHODCALLTYPE GetTypeInfoCount(Port*, UINT* count) noexcept
{
    if (!count)
        return E_POINTER;
    *count = 1;
    return S_OK;
}

HRESULT STDMETHODCALLTYPE GetTypeInfo(Port* self, UINT index, LCID, ITypeInfo** result) noexcept
{
    if (!result)
        return E_POINTER;
    *result = nullptr;
    return index == 0 ? FindTypeInfo(ClassOf(self).interfaceId, result) : DISP_E_BADINDEX;
}

HRESULT STDMETHODCALLTYPE GetIDsOfNames(Port* self, REFIID reserved, LPOLESTR* names, UINT count, LCID,
                                        DISPID* ids) noexcept
{
    if (reserved != IID_NULL)
        return DISP_E_UNKNOWNINTERFACE;
    if (!names || !ids || count == 0)
        return E_INVALIDARG;
    const std::span<const Member> members = ClassOf(self).info->members;
    const DISPID place = PlaceOf(members, names[0]);
    const bool isKnown = place != DISPID_UNKNOWN;
    ids[0] = isKnown ? place + 1 : DISPID_UNKNOWN;
    for (UINT i = 1; i < count; ++i)
        ids[i] = isKnown ? PlaceOf(members[static_cast<std::size_t>(place)].Parameters(), names[i]) : DISPID_UNKNOWN;
    return std::ranges::count(ids, ids + count, DISPID_UNKNOWN) == 0 ? S_OK : DISP_E_UNKNOWNNAME;
}

HRESULT STDMETHODCALLTYPE Invoke(Port* self, DISPID id, REFIID reserved, LCID, WORD flags, DISPPARAMS* given,
                                 VARIANT* result, EXCEPINFO* exception, UINT* wrongArgument) noexcept
{
    if (reserved != IID_NULL)
        return DISP_E_UNKNOWNINTERFACE;
    if (!given)
        return E_INVALIDARG;
    const Coclass& coclass = ClassOf(self);
    const Operation* const operation = FindOperation(coclass, id, flags);
    if (!operation)
        return DISP_E_MEMBERNOTFOUND;
    try {
        LateCall call(*operation, *given);
        if (const HRESULT status = call.Prepare(wrongArgument); FAILED(status))
            return status;
        if (const HRESULT status = call.Make(self); FAILED(status))
            return Told(status, exception);
        return call.Finish(result);
    } catch (...) {
        return Told(Raised(coclass.info->name, operation->member->name), exception);
    }
}

} // namespace varnex3::server
