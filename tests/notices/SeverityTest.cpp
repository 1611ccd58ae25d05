// The severity of an error in words, which an error detail finds in a reference set when it is read.
#include "tests/Printing.h"
#include "tests/request/ReferenceSets.h"
#include "varnex3/notices/Xalo_Error.h"

using namespace varnex3;
using tests::GivenReferenceSets;
using tests::RaisedBy;

namespace {

std::shared_ptr<RowSet> Severities(TextView /*first*/, TextView /*second*/)
{
    const auto row = [](TextView code, const Variant& description) { return RowSet::Row{Text(code), description}; };
    return std::make_shared<RowSet>(std::vector<Text>{u"Code", u"Description"},
                                    std::vector<RowSet::Row>{row(u"W", Text(u"Warning")), row(u"E", Text(u"Error")),
                                                             row(u"e", Text(u"never found")), row(u"N", Empty)});
}

Text Detail(TextView severity, TextView inside = {})
{
    return u"<ErrorDetails><Severity>" + Text(severity) + u"</Severity>" + Text(inside) + u"</ErrorDetails>";
}

// The description that reading a severity leaves, where there was one before.
Text Described(TextView severity)
{
    const auto item = New<ErrorDetailsItem>();
    item->SeverityDescription(u"before");
    item->ParseXML(Detail(severity));
    return item->SeverityDescription();
}

} // namespace

TEST_CASE("A new error detail loads the severities, once; a message and a list without details load nothing")
{
    std::vector<Text> asked;
    const GivenReferenceSets given([&](TextView first, TextView second) {
        asked.push_back(Text(first) + u"," + Text(second));
        return Severities(first, second);
    });
    const auto message = New<Xalo_Error>();
    message->Serialise();
    CHECK(asked.empty());
    const auto item = message->ErrorDetailsField()->Add();
    CHECK(asked == std::vector<Text>{u"ERRORSEVERITY,"});
    item->ParseXML(Detail(u"E"));
    item->ParseXML(Detail(u"W"));
    item->SeverityDescription();
    message->Serialise();
    CHECK(asked.size() == 1);
}

TEST_CASE("A severity that is read has the description of its row; another leaves the description as it was")
{
    const GivenReferenceSets given(Severities);
    CHECK(Described(u"E") == u"Error");
    CHECK(Described(u"W") == u"Warning");
    CHECK(Described(u"X") == u"before");
    CHECK(Described(u"") == u"before");
    CHECK(Described(u"E ") == u"before");
}

TEST_CASE("A severity is found in any letter case, the first row first; a null description is the empty text")
{
    const GivenReferenceSets given(Severities);
    CHECK(Described(u"w") == u"Warning");
    CHECK(Described(u"e") == u"Error");
    CHECK(Described(u"N") == u"");
}

TEST_CASE("An empty severity is looked up, too: it may be a code of the set")
{
    const GivenReferenceSets given([](TextView, TextView) {
        return std::make_shared<RowSet>(std::vector<Text>{u"Code", u"Description"},
                                        std::vector<RowSet::Row>{{Text(u""), Text(u"None")}});
    });
    CHECK(Described(u"") == u"None");
}

TEST_CASE("Every search begins at the first row again")
{
    const GivenReferenceSets given(Severities);
    const auto item = New<ErrorDetailsItem>();
    for (const TextView severity : {u"E", u"W", u"X", u"W"}) {
        item->ParseXML(Detail(severity));
        CHECK(item->SeverityDescription() == (severity == u"E" ? u"Error" : u"Warning"));
    }
}

TEST_CASE("Only reading looks a severity up; the description is never written")
{
    const GivenReferenceSets given(Severities);
    const auto item = New<ErrorDetailsItem>();
    item->Severity(u"E");
    CHECK(item->SeverityDescription() == u"");
    CHECK(item->ParseXML(Detail(u"E")) == u"\t<ErrorDetails>\r\n\t\t<Severity>E</Severity>\r\n\t</ErrorDetails>\r\n");
    CHECK(item->SeverityDescription() == u"Error");
    item->Severity(u"W");
    CHECK(item->SeverityDescription() == u"Error");
}

TEST_CASE("A detail keeps the set that it loaded, whatever the database has later; each has one of its own")
{
    Ref<ErrorDetailsItem> before;
    {
        const GivenReferenceSets given(Severities);
        before = New<ErrorDetailsItem>();
    }
    const auto after = New<ErrorDetailsItem>();
    before->ParseXML(Detail(u"E"));
    after->ParseXML(Detail(u"E"));
    CHECK(before->SeverityDescription() == u"Error");
    CHECK(after->SeverityDescription() == u"");
}

TEST_CASE("A severity with an apostrophe raises 3001: it was read, its kinds were not, and no detail behind it")
{
    const GivenReferenceSets given(Severities);
    const auto message = New<Xalo_Error>();
    const Text envelope = u"<Source><OrgType/><AppVersion/><AppName/><TimeStamp>2004-05-06</TimeStamp></Source>"
                          u"<Destination><OrgType/></Destination><Insurer><UnderwriterName/></Insurer>"
                          u"<Repairer><RepairerID/><RepairerName/></Repairer><QuoteNo>Q1</QuoteNo>";
    const Text kind = u"<MiscellaneousError><Description>x</Description></MiscellaneousError>";
    const Text text = u"<Xalo_Error>" + envelope + Detail(u"W", kind) + Detail(u"O'Neill", kind) + Detail(u"E", kind)
                      + u"</Xalo_Error>";
    CHECK(RaisedBy([&] { message->ParseXML(text); }) == "3001 RowSet.Find");
    CHECK(message->QuoteNoField() == u"Q1");
    CHECK(message->ErrorDetailsField()->Count() == 2);
    CHECK(message->ErrorDetailsField()->ErrorItems(0)->ErrorType() == XaloErrorType::Xalo_MiscellaneousError);
    const auto stopped = message->ErrorDetailsField()->ErrorItems(1);
    CHECK(stopped->Severity() == u"O'Neill");
    CHECK(stopped->ErrorType() == XaloErrorType{});
    CHECK(stopped->MiscellaneousError()->Description() == u"");
}

TEST_CASE("In a set that was never opened nothing is searched, and nothing raised")
{
    CHECK(Described(u"O'Neill") == u"before");
    CHECK(Described(u"E") == u"before");
}

TEST_CASE(
    "A set without the column of codes is refused when it is searched, without the descriptions when a row is found")
{
    const auto setOf = [](TextView column) {
        return [column](TextView, TextView) {
            return std::make_shared<RowSet>(std::vector<Text>{Text(column)}, std::vector<RowSet::Row>{{Text(u"E")}});
        };
    };
    {
        const GivenReferenceSets given(setOf(u"Code"));
        CHECK(Described(u"W") == u"before");
        CHECK(RaisedBy([] { Described(u"E"); }) == "3265 RowSet.Field");
    }
    const GivenReferenceSets given(setOf(u"Description"));
    CHECK(RaisedBy([] { Described(u"E"); }) == "3265 RowSet.Find");
}

TEST_CASE("What the database refuses is raised when a detail is made: none is added")
{
    const GivenReferenceSets given([](TextView, TextView) -> std::shared_ptr<RowSet> {
        Raise(ErrorNumber{30010}, "modDBAccess.DBExecSP", u"No such set.");
    });
    const auto details = New<ErrorDetailsDef>();
    CHECK(RaisedBy([&] { details->Add(); }) == "30010 modDBAccess.DBExecSP");
    CHECK(RaisedBy([&] { details->ParseXML(Detail(u"E")); }) == "30010 modDBAccess.DBExecSP");
    CHECK(details->Count() == 0);
}
