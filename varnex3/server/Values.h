// Texts, variants and errors as automation passes them, to and from the library's own values.
#pragma once

#include <optional>
#include <windows.h>

#include <oleauto.h>

#include "varnex3/core/Interface.h"

namespace varnex3::server {

// A variant that frees what it holds.
class OwnedVariant : public VARIANT
{
public:
    OwnedVariant() : VARIANT{} {}
    explicit OwnedVariant(const VARIANT& taken) : VARIANT(taken) {}
    OwnedVariant(OwnedVariant&& other) noexcept : VARIANT(other.Give()) {}
    OwnedVariant& operator=(OwnedVariant&& other) noexcept
    {
        VariantClear(this);
        static_cast<VARIANT&>(*this) = other.Give();
        return *this;
    }
    ~OwnedVariant()
    {
        if (V_VT(this) != VT_EMPTY)
            VariantClear(this);
    }

    // What it holds, which is the receiver's from now on.
    VARIANT Give() { return std::exchange(static_cast<VARIANT&>(*this), VARIANT{}); }
};

// The characters of a host's text, where they are. A null one is the empty text.
inline TextView ViewOf(BSTR text) { return {reinterpret_cast<const char16_t*>(text), SysStringLen(text)}; }

// A text for a host, who frees it.
BSTR ToBstr(TextView text);

// The type of variant that a value of a kind travels in.
VARTYPE VarTypeOf(Kind kind);

// What a variant by reference leads to, not owned; any other variant as it is.
VARIANT Dereferenced(const VARIANT& given);

// The value of a variant. Nothing for what is no value to the library: Null, arrays, structures, and objects that are
// neither records nor have a default property with a value. Numbers of all widths are taken; no locale plays a part.
std::optional<Variant> ValueOf(const VARIANT& given);

// A value for a host, who clears it.
VARIANT ToHost(const Variant& value);

// A value brought to a type by the rules of Conversions.h, for a host, who clears it.
VARIANT ToHost(const Variant& value, const Type& type);

// Stores a value in the variable that a variant by reference leads to, converted to the variable's type.
HRESULT StoreIn(const VARIANT& variable, const VARIANT& value);

} // namespace varnex3::server
