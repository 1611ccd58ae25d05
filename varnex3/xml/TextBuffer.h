// The text a document is parsed in: its own copy, followed by the zeros that Scan.h wants.
#pragma once

#include <algorithm>
#include <cstddef>
#include <limits>
#include <memory>
#include <new>
#include <string_view>

#include "varnex3/xml/Scan.h"

namespace varnex3::xml {

template <class Char>
class TextBuffer
{
public:
    TextBuffer() = default;

    // Room for a text that is yet to be written into Data().
    explicit TextBuffer(std::size_t length) : characters(Allocate(length)), size(length) { Terminate(); }
    explicit TextBuffer(std::basic_string_view<Char> text) : TextBuffer(text.size())
    {
        std::copy(text.begin(), text.end(), characters.get());
    }

    Char* Data() { return characters.get(); }
    const Char* Data() const { return characters.get(); }
    std::size_t Size() const { return size; }
    std::basic_string_view<Char> View() const { return {characters.get(), size}; }

    // Gives up what is behind the first `length` characters.
    void Shorten(std::size_t length)
    {
        size = length;
        Terminate();
    }

private:
    static Char* Allocate(std::size_t length)
    {
        if (length > std::numeric_limits<std::ptrdiff_t>::max() / sizeof(Char) - padding)
            throw std::bad_alloc();
        return new Char[length + padding];
    }

    void Terminate() { std::fill_n(characters.get() + size, padding, Char{}); }

    std::unique_ptr<Char[]> characters;
    std::size_t size = 0;
};

} // namespace varnex3::xml
