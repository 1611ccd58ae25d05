// Messages that are written and read again: what comes back, and what a change loses on the way.
#pragma once

#include <initializer_list>
#include <string>

#include "tests/Printing.h"
#include "tests/RecordGenerator.h"

namespace varnex3::tests {

template <class Message>
Text WrittenAgain(const Text& text)
{
    return ToText(New<Message>()->ParseXML(text));
}

// The first line in which two texts differ, as both have it.
inline std::string Difference(TextView a, TextView b)
{
    std::size_t start = 0;
    for (std::size_t i = 0; i < a.size() && i < b.size() && a[i] == b[i]; ++i)
        if (a[i] == u'\n')
            start = i + 1;
    const auto line = [&](TextView text) { return text.substr(start, text.find(u'\n', start) - start); };
    return Visible(line(a)) + " came back as " + Visible(line(b));
}

template <class Message>
void CheckRoundTrip(const Message& message)
{
    const Text first = message.Serialise();
    const Text second = WrittenAgain<Message>(first);
    if (first != second)
        FAIL(Difference(first, second));
}

// Ten thousand messages, made by a function from a seed, are read and written again as the same text.
template <class Message>
void CheckRoundTrips(Ref<Message> (*generated)(unsigned seed))
{
    constexpr unsigned kMessages = 10000;
    for (unsigned seed = 0; seed < kMessages; ++seed) {
        CAPTURE(seed);
        CheckRoundTrip(*generated(seed));
    }
}

// Some of them, one behind the other: to see what comes up among them.
template <class Message>
Text SomeOf(Ref<Message> (*generated)(unsigned seed))
{
    Text all;
    for (unsigned seed = 0; seed < 200; ++seed)
        all += generated(seed)->Serialise();
    return all;
}

inline void CheckElements(const Text& all, std::initializer_list<const char*> elements)
{
    for (const char* const element : elements) {
        CAPTURE(element);
        CHECK(all.find(u"<" + ToUtf16(element) + u">") != Text::npos);
    }
}

// The text of a message, and what that text becomes when it is read and written again.
struct Trip
{
    Text first;
    Text second;

    bool Keeps(TextView line) const { return first.find(line) != Text::npos && second.find(line) != Text::npos; }
    bool Loses(TextView line) const { return first.find(line) != Text::npos && second.find(line) == Text::npos; }
};

template <class Message>
Trip TripOf(const Message& message)
{
    const Text first = message.Serialise();
    return {first, WrittenAgain<Message>(first)};
}

} // namespace varnex3::tests
