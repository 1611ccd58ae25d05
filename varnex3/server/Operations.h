// The vtable of a class as plain data: what stands in which slot, and by which dispatch id it is called.
//
// The IDL, the listing of the interface and late-bound calls are made from it.
#pragma once

#include <vector>

#include "varnex3/core/Interface.h"

namespace varnex3::server {

enum class Access : std::uint8_t
{
    Call,
    Get,
    Put,         // of a value
    PutReference // of a record
};

// One slot.
struct Operation
{
    const Member* member = nullptr;
    Access access = Access::Call;
    int dispid = 0; // the place of the member in its class, from 1
    int slot = 0;   // from 0, those of IDispatch included
};

// The first slot of a class's own, behind the seven of IDispatch.
inline constexpr int kFirstSlot = 7;

// The slots of a class in their order: one for a method, one for a readable property, a second one for a writable one.
std::vector<Operation> OperationsOf(const ClassInfo& info);

} // namespace varnex3::server
