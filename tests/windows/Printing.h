// How failing checks show texts: as UTF-8 between quotes.
#pragma once

#include <doctest/doctest.h>

#include "tests/windows/Automation.h"

template <>
struct doctest::StringMaker<std::wstring>
{
    static String convert(const std::wstring& text) { return ('"' + varnex3::tests::ToUtf8(text) + '"').c_str(); }
};
