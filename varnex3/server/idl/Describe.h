// The component as its classes' rows describe it.
#pragma once

#include <span>

#include "varnex3/server/idl/Description.h"

namespace varnex3::server::idl {

// Every class (modules are none of the component's) and every enumeration of the library. Raises ClashingNames when two
// public names differ in the case of letters alone.
Library Describe();

// The same, of the classes and enumerations given.
Library Describe(std::span<const ClassInfo* const> classes, std::span<const EnumInfo* const> enumerations);

// Of a member's type and parameters alone; modules are listed by them, too.
ValueType DescribeType(const Type& type);
std::vector<Argument> DescribeParameters(const Member& member);

} // namespace varnex3::server::idl
