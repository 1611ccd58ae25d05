#include "varnex3/core/RareText.h"

#include "tests/Printing.h"

using namespace varnex3;

TEST_CASE("RareText: empty at first, then what was set last, the empty text too")
{
    RareText text;
    CHECK(text.Held().empty());
    text = Text(u"a comment that takes more room than a short text");
    CHECK(text.Held() == u"a comment that takes more room than a short text");
    text = TextView(u"short");
    CHECK(text.Held() == u"short");
    text = Text();
    CHECK(text.Held().empty());
}

TEST_CASE("RareText: takes a text that is its own")
{
    RareText text;
    text = Text(u"one of its own");
    text = text.Held();
    CHECK(text.Held() == u"one of its own");
    text += TextView(text);
    CHECK(text.Held() == u"one of its ownone of its own");
}

TEST_CASE("WordText: a word until a text is set, and again after that")
{
    WordText text;
    CHECK(text.Copy().empty());
    text.Become(u"Repair");
    CHECK(text.Copy() == u"Repair");
    text = Text(u"what a host set");
    CHECK(text.Copy() == u"what a host set");
    text.Become(u"Misc");
    CHECK(text.Copy() == u"Misc");
}

TEST_CASE("WordText: the empty text takes the place of a word")
{
    WordText text;
    text.Become(u"Repair");
    text = Text();
    CHECK(text.Copy().empty());
}
