// The component as a listing for people: a line for each slot, constant and identifier that hosts are bound to.
#pragma once

#include "varnex3/server/idl/Description.h"

namespace varnex3::server::idl {

std::string ToListing(const Library& library);

// A function of a module, as the listing of modules has it: "EscapeXML(text: text): text".
std::string Signature(const std::string& name, const std::vector<Argument>& arguments, const ValueType& type);

// Every help string, a line each behind the name of what it is about. Constants have none in a type library by widl.
std::string ToHelpStrings(const Library& library);

} // namespace varnex3::server::idl
