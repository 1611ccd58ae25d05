// The type library in the component's resources, for hosts that ask an object what it is.
#pragma once

#include <windows.h>

#include <oleauto.h>

namespace varnex3::server {

// The description of a class or an interface. The library stays loaded for the next call.
HRESULT FindTypeInfo(REFGUID id, ITypeInfo** result) noexcept;

// Lets go of the library, before the component may be unloaded.
void ReleaseTypeLibrary() noexcept;

} // namespace varnex3::server
