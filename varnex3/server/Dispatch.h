// IDispatch, for all classes: plain functions over a class's operations. A late-bound call brings its arguments to the
// slot's types and calls the slot, so that it does what an early-bound call does.
#pragma once

#include <windows.h>

#include <oleauto.h>

#include "varnex3/server/Face.h"

namespace varnex3::server {

HRESULT STDMETHODCALLTYPE GetTypeInfoCount(Port* self, UINT* count) noexcept;
HRESULT STDMETHODCALLTYPE GetTypeInfo(Port* self, UINT index, LCID, ITypeInfo** result) noexcept;

// The first name is a member's, the others those of its parameters; letter case does not count.
HRESULT STDMETHODCALLTYPE GetIDsOfNames(Port* self, REFIID reserved, LPOLESTR* names, UINT count, LCID,
                                        DISPID* ids) noexcept;

// Arguments are converted as Conversions.h says; what does not convert raises its error (13, 6) with the member as its
// source. What is no value at all, such as an array or Null, is DISP_E_TYPEMISMATCH.
HRESULT STDMETHODCALLTYPE Invoke(Port* self, DISPID id, REFIID reserved, LCID, WORD flags, DISPPARAMS* given,
                                 VARIANT* result, EXCEPINFO* exception, UINT* wrongArgument) noexcept;

// The seven functions that every vtable of a class begins with.
struct DispatchFunctions : UnknownFunctions
{
    decltype(&GetTypeInfoCount) getTypeInfoCount = &GetTypeInfoCount;
    decltype(&GetTypeInfo) getTypeInfo = &GetTypeInfo;
    decltype(&GetIDsOfNames) getIDsOfNames = &GetIDsOfNames;
    decltype(&Invoke) invoke = &Invoke;
};

} // namespace varnex3::server
