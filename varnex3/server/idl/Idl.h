// The component as IDL.
#pragma once

#include "varnex3/server/idl/Description.h"

namespace varnex3::server::idl {

// From which the compiler of type libraries makes the type library.
std::string ToIdl(const Library& library);

// From which it makes the header for C and C++. A class may have the name of a constant (Xalo_Quote): what a compiler
// of IDL writes for a class would not compile then.
std::string ToHeaderIdl(const Library& library);

} // namespace varnex3::server::idl
