// A value whose type is known only when the program runs.
#pragma once

#include <cstdint>
#include <variant>

#include "varnex3/core/Date.h"
#include "varnex3/core/Record.h"
#include "varnex3/core/Text.h"

namespace varnex3 {

// Nothing at all: what an absent element yields. It converts to "", 0, the zero date and False.
using EmptyValue = std::monostate;

using Variant = std::variant<EmptyValue, Text, double, std::int32_t, std::int16_t, bool, Date, Ref<Record>>;

inline const Variant Empty{};

inline bool IsEmpty(const Variant& value) { return std::holds_alternative<EmptyValue>(value); }

} // namespace varnex3
