// The classes of the component, as hosts create them: one for every class of PublicClasses.h.
#pragma once

#include <span>
#include <vector>
#include <windows.h>

#include "varnex3/PublicClasses.h"
#include "varnex3/server/Operations.h"

namespace varnex3::server {

struct Coclass
{
    const ClassInfo* info = nullptr;
    const void* vtable = nullptr; // of the interface that is named after the class
    GUID classId{};
    GUID interfaceId{};
    std::vector<Operation> operations; // its slots
};

// Made at first use; they stay where they are.
const std::vector<Coclass>& Coclasses();

const Coclass& CoclassOf(const Record& record);

// Null when there is no class of this identifier.
const Coclass* FindCoclass(REFCLSID classId);

// The vtables of one folder's classes, in the order of the list. Each folder has a source file that makes them
// (CoreClasses.cpp), so that they are compiled side by side.
struct ClassVtable
{
    const ClassInfo& (*info)();
    const void* vtable;
};
template <class... C>
std::span<const ClassVtable> VtablesOf(ClassList<C...>);

} // namespace varnex3::server
