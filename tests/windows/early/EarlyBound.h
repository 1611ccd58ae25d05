// An early-bound host: it knows the component by the header that was made from its IDL, and by nothing else.
#pragma once

#include "tests/windows/Automation.h"

#include <Varnex3.h>

namespace varnex3::tests {

// A new object of a class, by its class id.
template <class I>
Ptr<I> New(REFCLSID id)
{
    Ptr<I> object;
    CoCreateInstance(id, nullptr, CLSCTX_INPROC_SERVER, __uuidof(I), object.OutVoid());
    return object;
}

inline Ptr<_VersionDef> NewVersion() { return New<_VersionDef>(CLSID_VersionDef); }
inline Ptr<_SourceDef> NewSource() { return New<_SourceDef>(CLSID_SourceDef); }
inline Ptr<_InsurerDetailDef> NewDetails() { return New<_InsurerDetailDef>(CLSID_InsurerDetailDef); }
inline Ptr<_ClaimHeaderDef> NewClaim() { return New<_ClaimHeaderDef>(CLSID_ClaimHeaderDef); }
inline Ptr<_CustomerDef> NewCustomer() { return New<_CustomerDef>(CLSID_CustomerDef); }
inline Ptr<_PersonalNameDef> NewName() { return New<_PersonalNameDef>(CLSID_PersonalNameDef); }
inline Ptr<_MessageDef> NewMessage() { return New<_MessageDef>(CLSID_MessageDef); }
inline Ptr<_Xalo_Messages> NewList() { return New<_Xalo_Messages>(CLSID_Xalo_Messages); }

// The text that a getter gives.
template <class I>
std::wstring TextOf(const Ptr<I>& object, HRESULT (STDMETHODCALLTYPE I::*getter)(BSTR*))
{
    Bstr text;
    const HRESULT status = (object.get()->*getter)(text.Out());
    return SUCCEEDED(status) ? text.Text() : L"failed: " + std::to_wstring(status);
}

} // namespace varnex3::tests
