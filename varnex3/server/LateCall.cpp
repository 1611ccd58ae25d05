#include "varnex3/server/LateCall.h"

#include <algorithm>

#include "varnex3/core/Conversions.h"

namespace varnex3::server {

namespace {

bool IsPut(const Operation& operation)
{
    return operation.access == Access::Put || operation.access == Access::PutReference;
}

// Where the content of a variant stands, of whatever type it is.
void* ContentOf(VARIANT& variant) { return &V_BYREF(&variant); }

VARIANT Omitted()
{
    VARIANT omitted{};
    V_VT(&omitted) = VT_ERROR;
    V_ERROR(&omitted) = DISP_E_PARAMNOTFOUND;
    return omitted;
}

bool IsOmitted(const VARIANT& argument)
{
    return V_VT(&argument) == VT_ERROR && V_ERROR(&argument) == DISP_E_PARAMNOTFOUND;
}

bool FitsAsItIs(const VARIANT& argument, VARTYPE type)
{
    return V_VT(&argument) == type || type == VT_VARIANT || (type == VT_DISPATCH && V_VT(&argument) == VT_UNKNOWN);
}

// The value that a property is to have.
Parameter ValueParameterOf(const Member& property)
{
    Parameter value;
    value.type = property.type;
    return value;
}

Variant InitialOf(const Parameter& parameter)
{
    return parameter.initial.empty() ? Empty : Variant(ToText(parameter.initial));
}

// A script's null is no record.
std::optional<Variant> ValueFor(const Parameter& parameter, const VARIANT& argument)
{
    if (parameter.type.kind == Kind::Object && V_VT(&argument) == VT_NULL)
        return Ref<Record>();
    return ValueOf(argument);
}

} // namespace

LateCall::LateCall(const Operation& operation_, const DISPPARAMS& host_)
    : operation(operation_), host(host_), count(operation.member->parameterCount + (IsPut(operation) ? 1 : 0))
{}

// The value that a property is to have stands behind its indexes.
Parameter LateCall::ParameterAt(std::size_t place) const
{
    const Member& member = *operation.member;
    return place < member.parameterCount ? member.parameterSlots[place] : ValueParameterOf(member);
}

// Hosts give named arguments first, then the others in reverse order. The value of a property has a name of its own.
HRESULT LateCall::PutInPlaces(UINT& wrong)
{
    if (host.cArgs > count || host.cNamedArgs > host.cArgs)
        return DISP_E_BADPARAMCOUNT;
    for (UINT i = 0; i < host.cArgs; ++i) {
        const DISPID name = i < host.cNamedArgs ? host.rgdispidNamedArgs[i] : static_cast<DISPID>(host.cArgs - 1 - i);
        const std::size_t place =
            name == DISPID_PROPERTYPUT && IsPut(operation) ? count - 1 : static_cast<std::size_t>(name);
        wrong = i;
        if (place >= count)
            return DISP_E_PARAMNOTFOUND;
        if (given[place])
            return DISP_E_BADPARAMCOUNT;
        given[place] = &host.rgvarg[i];
    }
    return S_OK;
}

HRESULT LateCall::Prepare(UINT* wrongArgument)
{
    UINT wrong = 0;
    HRESULT status = PutInPlaces(wrong);
    for (std::size_t i = 0; i < count && SUCCEEDED(status); ++i) {
        if (given[i])
            wrong = static_cast<UINT>(given[i] - host.rgvarg);
        status = Take(i);
    }
    if (wrongArgument && FAILED(status))
        *wrongArgument = wrong;
    return status;
}

// What has the slot's type already is passed as it is; anything else is converted.
HRESULT LateCall::Take(std::size_t place)
{
    const Parameter parameter = ParameterAt(place);
    const VARIANT argument = given[place] ? Dereferenced(*given[place]) : Omitted();
    const bool isOmitted = IsOmitted(argument);
    if (isOmitted && !parameter.isOptional)
        return DISP_E_PARAMNOTOPTIONAL;
    if (isOmitted)
        given[place] = nullptr; // also when the host's own variable says so

    const VARTYPE type = VarTypeOf(parameter.type.kind);
    types[place] = type;
    passed[place] = argument;
    if (!isOmitted && !parameter.isByReference && FitsAsItIs(argument, type))
        return S_OK;

    const std::optional<Variant> value = isOmitted ? InitialOf(parameter) : ValueFor(parameter, argument);
    if (!value)
        return DISP_E_TYPEMISMATCH;
    converted[place] = OwnedVariant(ToHost(*value, parameter.type));
    passed[place] = converted[place];
    if (parameter.isByReference)
        PassReference(place, type, converted[place]);
    return S_OK;
}

void LateCall::PassReference(std::size_t place, VARTYPE type, VARIANT& variable)
{
    types[place] = static_cast<VARTYPE>(type | VT_BYREF);
    V_VT(&passed[place]) = types[place];
    V_BYREF(&passed[place]) = type == VT_VARIANT ? &variable : ContentOf(variable);
}

HRESULT LateCall::Make(Port* port)
{
    const VARTYPE resultType = IsPut(operation) ? VARTYPE{VT_VOID} : VarTypeOf(operation.member->type.kind);
    const bool hasResult = resultType != VT_VOID;
    if (hasResult) {
        PassReference(count, resultType, answer);
        V_VT(&answer) = resultType == VT_VARIANT ? VARTYPE{VT_EMPTY} : resultType;
    }
    std::array<VARIANTARG*, kMostArguments + 1> arguments{};
    std::ranges::transform(passed, arguments.begin(), [](VARIANTARG& argument) { return &argument; });
    const ULONG_PTR offset = static_cast<ULONG_PTR>(operation.slot) * sizeof(void*);
    const auto size = static_cast<UINT>(count + (hasResult ? 1 : 0));
    VARIANT status{};
    const HRESULT called =
        DispCallFunc(port, offset, CC_STDCALL, VT_ERROR, size, types.data(), arguments.data(), &status);
    return FAILED(called) ? called : V_ERROR(&status);
}

HRESULT LateCall::Finish(VARIANT* result)
{
    for (std::size_t i = 0; i < operation.member->parameterCount; ++i) {
        const bool isStored = operation.member->parameterSlots[i].isOutput && given[i] && V_ISBYREF(given[i]);
        const HRESULT status = isStored ? StoreIn(*given[i], converted[i]) : S_OK;
        if (FAILED(status))
            return status;
    }
    if (result)
        *result = answer.Give();
    return S_OK;
}

} // namespace varnex3::server
