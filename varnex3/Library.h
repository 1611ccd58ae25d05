// Every public class and module of the library: what the faces offer.
#pragma once

#include <span>
#include <vector>

#include "varnex3/core/Interface.h"

namespace varnex3 {

// The classes and modules in the order of the documentation.
std::span<const ClassInfo* const> Classes();

// The class or module of this name (letter case counts), or null.
const ClassInfo* FindClass(Name name);

// Every enumeration that a member of a class uses, each once, in the order of first use.
const std::vector<const EnumInfo*>& Enumerations();

} // namespace varnex3
