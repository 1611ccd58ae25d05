// Loads every document of the W3C suite and compares the outcome with the catalogue's verdict.
//
// Documents with an internal subset are refused by intention, whatever the catalogue says: for them the rule is that
// the refusal gives that reason, and that no other document is refused with it. Every other difference from the
// catalogue stands in deviations.txt, and what stands there must be true.
#include <doctest/doctest.h>

#include <set>

#include "Suite.h"
#include "varnex3/xml/Document.h"
#include "varnex3/xml/Files.h"
#include "varnex3/xml/Unicode.h"

using namespace varnex3::xml;
using namespace varnex3::xml::conformance;

namespace {

// How many documents were judged, and by what.
struct Tally
{
    int wellFormed = 0;
    int notWellFormed = 0;
    int either = 0;
    int refusedForSubset = 0;
    int deviating = 0;
};

std::string Describe(const Case& test, const ParseError& error)
{
    if (!error)
        return test.id + ": loaded";
    return test.id + ": refused with code " + std::to_string(static_cast<int>(error.code)) + ", line "
           + std::to_string(error.line) + ": " + ToUtf8(error.reason);
}

bool Agrees(Verdict verdict, bool isLoaded)
{
    return verdict == Verdict::Either || isLoaded == (verdict == Verdict::WellFormed);
}

void Count(Tally& tally, Verdict verdict)
{
    ++(verdict == Verdict::WellFormed      ? tally.wellFormed
       : verdict == Verdict::NotWellFormed ? tally.notWellFormed
                                           : tally.either);
}

class Judge
{
public:
    void Hear(const Case& test)
    {
        Document document;
        const std::string bytes = ReadFile(ToUtf16(test.path));
        const bool isLoaded = document.LoadBytes(bytes);
        const std::string outcome = Describe(test, document.Error());
        INFO(outcome);

        CHECK_MESSAGE(isLoaded == !document.Error(), "what was returned and the error tell the same");
        HearSubset(document, HasInternalSubset(bytes));
        HearVerdict(test, document.Error());
    }

    void Close()
    {
        for (const auto& entry : listed)
            CHECK_MESSAGE(seen.contains(entry.first), entry.first, " is listed in deviations.txt and does not deviate");
    }

    const Tally& Judged() const { return tally; }

private:
    void HearSubset(const Document& document, bool hasSubset)
    {
        CHECK_MESSAGE((hasSubset || document.Error().code != ErrorCode::InternalSubset), "there is no internal subset");
        CHECK_MESSAGE((!hasSubset || document.Error()), "an internal subset is never loaded");
    }

    void HearVerdict(const Case& test, const ParseError& error)
    {
        if (error.code == ErrorCode::InternalSubset)
            ++tally.refusedForSubset;
        else if (Agrees(test.verdict, !error))
            Count(tally, test.verdict);
        else
            HearDeviation(test, static_cast<int>(error.code));
    }

    void HearDeviation(const Case& test, int code)
    {
        ++tally.deviating;
        seen.insert(test.id);
        const auto found = listed.find(test.id);
        if (found == listed.end())
            FAIL_CHECK("the catalogue has another verdict, and deviations.txt does not say why");
        else
            CHECK_MESSAGE(found->second.code == code, "deviations.txt names another code");
    }

    std::map<std::string, Deviation> listed = ReadDeviations();
    std::set<std::string> seen;
    Tally tally;
};

} // namespace

TEST_CASE("every W3C document has the outcome its catalogue says, or one that deviations.txt justifies")
{
    Judge judge;
    const std::vector<Case> cases = ReadCatalogue();
    for (const Case& test : cases)
        judge.Hear(test);
    judge.Close();

    const Tally& tally = judge.Judged();
    MESSAGE(cases.size(), " documents judged: ", tally.wellFormed, " loaded and ", tally.notWellFormed,
            " refused as the catalogue says, ", tally.either, " with either outcome allowed, ", tally.refusedForSubset,
            " refused for their internal subset, ", tally.deviating, " deviating as listed");
    CHECK(cases.size() == 2002); // a shorter catalogue would pass with less said
}

TEST_CASE("a W3C document that loads is written as a text that loads to the same document")
{
    for (const Case& test : ReadCatalogue()) {
        CAPTURE(test.id);
        Document document, again;
        if (!document.LoadFile(ToUtf16(test.path)))
            continue;
        CHECK(again.LoadText(document.Xml()));
        CHECK(again.Xml() == document.Xml());
    }
}

TEST_CASE("the search for an internal subset sees brackets of a DOCTYPE only")
{
    CHECK(HasInternalSubset("<?xml version='1.0'?><!-- [ --><!DOCTYPE a [<!ENTITY b 'c'>]><a/>"));
    CHECK(HasInternalSubset("<!DOCTYPE a SYSTEM 'b>c' [ ]><a/>"));
    CHECK(HasInternalSubset(std::string_view("\xFF\xFE<\0!\0D\0O\0C\0T\0Y\0P\0E\0 \0a\0[\0]\0>\0", 28)));
    CHECK_FALSE(HasInternalSubset("<!DOCTYPE a SYSTEM '[x]'><a>[</a>"));
    CHECK_FALSE(HasInternalSubset("<!-- <!DOCTYPE a [ ]> --><a/>"));
    CHECK_FALSE(HasInternalSubset("<a><!DOCTYPE a [ ]></a>"));
}
