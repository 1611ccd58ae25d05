// The component as IDL, from which the compiler of type libraries makes the type library and the C++ header.
#pragma once

#include "varnex3/server/idl/Description.h"

namespace varnex3::server::idl {

std::string ToIdl(const Library& library);

} // namespace varnex3::server::idl
