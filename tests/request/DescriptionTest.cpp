// The descriptions of codes, which request and quote find in a reference set.
#include "tests/Printing.h"
#include "tests/request/ReferenceSets.h"
#include "varnex3/quote/QuoteDetailsDef.h"
#include "varnex3/request/RequestDetailsDef.h"

using namespace varnex3;
using tests::GivenReferenceSets;
using tests::RaisedBy;
using tests::RepairModels;

namespace {

std::shared_ptr<RowSet> Models(TextView /*first*/, TextView /*second*/) { return RepairModels(); }

// The description that request and quote, which must agree, show for a code.
Text Described(TextView code)
{
    const auto request = New<RequestDetailsDef>();
    const auto quote = New<QuoteDetailsDef>();
    request->RequestType(Text(code));
    quote->QuoteType(Text(code));
    CHECK(request->RequestTypeDesciption() == quote->QuoteTypeString());
    return quote->QuoteTypeString();
}

} // namespace

TEST_CASE("A new record loads the repair models, once, and its getters load nothing")
{
    std::vector<Text> asked;
    const GivenReferenceSets given([&](TextView first, TextView second) {
        asked.push_back(Text(first) + u"," + Text(second));
        return RepairModels();
    });
    const auto request = New<RequestDetailsDef>();
    CHECK(asked == std::vector<Text>{u"REPAIRMODELTYPE,"});
    const auto quote = New<QuoteDetailsDef>();
    CHECK(asked == std::vector<Text>{u"REPAIRMODELTYPE,", u"REPAIRMODELTYPE,"});
    request->RequestTypeDesciption();
    quote->QuoteTypeString();
    CHECK(asked.size() == 2);
}

TEST_CASE("A code has the description of its row in the reference set; another code has none")
{
    const GivenReferenceSets given(Models);
    CHECK(Described(u"A") == u"Assessing");
    CHECK(Described(u"CP") == u"Allocated");
    CHECK(Described(u"T") == u"Tendering");
    CHECK(Described(u"X") == u"");
    CHECK(Described(u"") == u"");
    CHECK(Described(u"A ") == u"");
}

TEST_CASE("A code is found in any letter case, the first row first; a null description is the empty text")
{
    const GivenReferenceSets given(Models);
    CHECK(Described(u"cp") == u"Allocated");
    CHECK(Described(u"t") == u"Tendering");
    CHECK(Described(u"N") == u"");
}

TEST_CASE("Every search begins at the first row again")
{
    const GivenReferenceSets given(Models);
    const auto quote = New<QuoteDetailsDef>();
    for (const TextView code : {u"T", u"A", u"X", u"A"}) {
        quote->QuoteType(Text(code));
        CHECK(quote->QuoteTypeString() == (code == u"T" ? u"Tendering" : code == u"A" ? u"Assessing" : u""));
    }
}

TEST_CASE("The description comes from the set, whatever the setter of the kind stands for")
{
    const GivenReferenceSets given([](TextView, TextView) {
        return std::make_shared<RowSet>(std::vector<Text>{u"code", u"DESCRIPTION"},
                                        std::vector<RowSet::Row>{{Text(u"A"), Text(u"from the set")}});
    });
    const auto request = New<RequestDetailsDef>();
    request->RequestTypeID(RequestTypeEnum::RequestAssessed);
    CHECK(request->RequestTypeDesciption() == u"from the set");
    request->RequestTypeID(RequestTypeEnum::RequestAllocated);
    CHECK(request->RequestTypeDesciption() == u"");
}

TEST_CASE("A record keeps the set that it loaded, whatever the database has later; each has one of its own")
{
    Ref<QuoteDetailsDef> before;
    {
        const GivenReferenceSets given(Models);
        before = New<QuoteDetailsDef>();
    }
    const auto after = New<QuoteDetailsDef>();
    before->QuoteType(u"T");
    after->QuoteType(u"T");
    CHECK(before->QuoteTypeString() == u"Tendering");
    CHECK(after->QuoteTypeString() == u"");
}

TEST_CASE("A code with an apostrophe cannot be searched for: 3001; in a set that was never opened nothing is searched")
{
    const auto without = New<RequestDetailsDef>();
    without->RequestType(u"O'Brien");
    CHECK(without->RequestTypeDesciption() == u"");
    const GivenReferenceSets given(Models);
    const auto request = New<RequestDetailsDef>();
    request->RequestType(u"O'Brien");
    CHECK(RaisedBy([&] { request->RequestTypeDesciption(); }) == "3001 RowSet.Find");
    const auto quote = New<QuoteDetailsDef>();
    quote->QuoteType(u"'");
    CHECK(RaisedBy([&] { quote->QuoteTypeString(); }) == "3001 RowSet.Find");
}

TEST_CASE("A set without the columns is refused where they are read: 3265")
{
    const GivenReferenceSets given([](TextView, TextView) {
        return std::make_shared<RowSet>(std::vector<Text>{u"Code"}, std::vector<RowSet::Row>{{Text(u"A")}});
    });
    const auto quote = New<QuoteDetailsDef>();
    CHECK(quote->QuoteTypeString() == u"");
    quote->QuoteType(u"A");
    CHECK(RaisedBy([&] { quote->QuoteTypeString(); }) == "3265 RowSet.Field");
}

TEST_CASE("What the database refuses is raised when the record is made")
{
    const GivenReferenceSets given([](TextView, TextView) -> std::shared_ptr<RowSet> {
        Raise(ErrorNumber{30010}, "modDBAccess.DBExecSP", u"No such set.");
    });
    CHECK(RaisedBy([] { New<RequestDetailsDef>(); }) == "30010 modDBAccess.DBExecSP");
    CHECK(RaisedBy([] { New<QuoteDetailsDef>(); }) == "30010 modDBAccess.DBExecSP");
}
