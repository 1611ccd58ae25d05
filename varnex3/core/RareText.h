// Texts of a record that seldom are what somebody gave: until then they take little room and are not copied.
#pragma once

#include <memory>
#include <utility>

#include "varnex3/core/Text.h"

namespace varnex3 {

// A text that most records leave empty.
class RareText
{
public:
    RareText& operator=(Text value)
    {
        if (text)
            *text = std::move(value);
        else if (!value.empty())
            text = std::make_unique<Text>(std::move(value));
        return *this;
    }
    RareText& operator=(TextView value) { return *this = Text(value); }
    RareText& operator+=(TextView more) { return *this = Held() + Text(more); }

    const Text& Held() const { return text ? *text : nothing; }
    operator TextView() const { return Held(); }

private:
    inline static const Text nothing;

    std::unique_ptr<Text> text;
};

// A text that is one of the library's own words until somebody sets another.
class WordText
{
public:
    // The word is a literal: it is not copied.
    void Become(const char16_t* literal) { word = literal; }

    WordText& operator=(Text value)
    {
        given = std::move(value);
        word = nullptr;
        return *this;
    }

    Text Copy() const { return word ? Text(word) : given.Held(); }

private:
    const char16_t* word = nullptr;
    RareText given;
};

} // namespace varnex3
