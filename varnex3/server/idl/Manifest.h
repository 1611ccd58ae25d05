// The manifest by which a host uses the component without registration: every class, interface and the type library.
#pragma once

#include "varnex3/server/idl/Description.h"

namespace varnex3::server::idl {

// `architecture` is x86 or amd64. The assembly is not called as the DLL is: Windows would look for it inside the DLL.
std::string ToManifest(const Library& library, std::string_view architecture, std::string_view version);

} // namespace varnex3::server::idl
