// One late-bound call: a host's arguments are put in their places, brought to the types of a slot, and the slot is
// called.
#pragma once

#include <array>

#include "varnex3/server/Face.h"
#include "varnex3/server/Values.h"

namespace varnex3::server {

class LateCall
{
public:
    LateCall(const Operation& operation_, const DISPPARAMS& host_);

    // Gives what IDispatch wants of a call that cannot be made; the place of the argument that is to blame is stored
    // where wrongArgument points to, unless that is null. Raises what the conversions raise.
    HRESULT Prepare(UINT* wrongArgument);

    // Gives what the slot gives. Precondition of both: what was to be done before has succeeded.
    HRESULT Make(Port* port);

    // Stores the results in the host's variables, and what the slot returned in result, unless that is null.
    HRESULT Finish(VARIANT* result);

private:
    static constexpr std::size_t kMostArguments = Member::kMaxParameters + 1; // the indexes of a property and its value

    Parameter ParameterAt(std::size_t place) const;
    HRESULT PutInPlaces(UINT& wrong);
    HRESULT Take(std::size_t place);
    void PassReference(std::size_t place, VARTYPE type, VARIANT& variable);

    const Operation& operation;
    const DISPPARAMS& host;
    const std::size_t count;                               // of the slot's arguments, the result aside
    std::array<const VARIANTARG*, kMostArguments> given{}; // the host's, in the slot's order; null: omitted
    std::array<OwnedVariant, kMostArguments> converted;    // what had to be made of them
    OwnedVariant answer;                                   // the result
    std::array<VARIANTARG, kMostArguments + 1> passed{};   // what the slot gets, the place of the result last
    std::array<VARTYPE, kMostArguments + 1> types{};
};

} // namespace varnex3::server
