// Enumerations that describe themselves: constants, values and words in one place.
//
//     VARNEX_ENUM(CustomerTypeEnum, "Whether a customer is a person or a company.",
//                 (Personal, 0, "A person."),
//                 (Company, 1, "A company."));
#pragma once

#include "varnex3/core/Interface.h"

// Applies a macro to each of up to a few hundred arguments.
#define VARNEX_EXPAND(...) VARNEX_EXPAND_3(VARNEX_EXPAND_3(VARNEX_EXPAND_3(VARNEX_EXPAND_3(__VA_ARGS__))))
#define VARNEX_EXPAND_3(...) VARNEX_EXPAND_2(VARNEX_EXPAND_2(VARNEX_EXPAND_2(VARNEX_EXPAND_2(__VA_ARGS__))))
#define VARNEX_EXPAND_2(...) VARNEX_EXPAND_1(VARNEX_EXPAND_1(VARNEX_EXPAND_1(VARNEX_EXPAND_1(__VA_ARGS__))))
#define VARNEX_EXPAND_1(...) __VA_ARGS__
#define VARNEX_PARENTHESES ()
#define VARNEX_FOR_EACH(macro, ...) __VA_OPT__(VARNEX_EXPAND(VARNEX_FOR_EACH_STEP(macro, __VA_ARGS__)))
#define VARNEX_FOR_EACH_STEP(macro, first, ...)                                                                        \
    macro first __VA_OPT__(VARNEX_FOR_EACH_AGAIN VARNEX_PARENTHESES(macro, __VA_ARGS__))
#define VARNEX_FOR_EACH_AGAIN() VARNEX_FOR_EACH_STEP

#define VARNEX_ENUM_CONSTANT(constant, number, doc) constant = number,
#define VARNEX_ENUM_ROW(constant, number, doc) ::varnex3::Enumerator{#constant, number, doc},

#define VARNEX_ENUM(Name_, doc, ...)                                                                                   \
    enum class Name_ : std::int32_t                                                                                    \
    {                                                                                                                  \
        VARNEX_FOR_EACH(VARNEX_ENUM_CONSTANT, __VA_ARGS__)                                                             \
    };                                                                                                                 \
    inline constexpr ::varnex3::Enumerator Name_##Values[] = {VARNEX_FOR_EACH(VARNEX_ENUM_ROW, __VA_ARGS__)};          \
    inline constexpr ::varnex3::EnumInfo Name_##Info{#Name_, doc, Name_##Values};                                      \
    constexpr const ::varnex3::EnumInfo& EnumerationOf(Name_) { return Name_##Info; }                                  \
    static_assert(true)
