// The workshop's database through the driver, against a server that speaks its protocol.
#include "varnex3/services/modDBAccess.h"

#include <thread>

#include "tests/Printing.h"
#include "tests/services/DatabaseServers.h"
#include "varnex3/services/DatabaseConnection.h"
#include "varnex3/services/ProcedureCall.h"
#include "varnex3/services/ProcedureParameter.h"

using namespace varnex3;
using namespace std::chrono_literals;
using tests::Called;
using tests::RaisedBy;
using tests::TdsDatabase;

namespace {

// The number, the lID as the call left it, and the description: "30010 -1 Locked.".
std::string Failure(TextView procedure, TextView texts = {})
{
    std::int32_t lID = -1;
    try {
        DBExecSP(procedure, texts, lID, false, false);
    } catch (const Error& error) {
        CHECK(error.Source() == u"modDBAccess.DBExecSP");
        return std::to_string(error.Number()) + " " + std::to_string(lID) + " " + ToUtf8(error.Description());
    }
    return "none";
}

// What a procedure was sent for its inputs.
std::string Sent(const TdsDatabase& database, TextView procedure, TextView texts)
{
    CHECK(Called(procedure, texts).lID == 42);
    return database.server.LastInputs();
}

Text Cell(const Called& called, TextView column)
{
    REQUIRE(called.rowSet);
    return ToText(called.rowSet->Field(column));
}

} // namespace

// Row sets and outcomes

TEST_CASE("A reference set has its rows, and the one that the filter names")
{
    const TdsDatabase database;
    auto set = GetReferenceSet(u"REPAIRMODELTYPE", u"");
    REQUIRE(set->Count() == 3);
    set->Find(u"Code = 'cp'");
    CHECK(ToText(set->Field(u"Description")) == u"Allocated");
    CHECK(GetReferenceSet(u"REPAIRMODELTYPE", u"T")->Count() == 1);
    CHECK(database.server.LastInputs() == "nvarchar(15)=\"REPAIRMODELTYPE\" nvarchar(1)=\"T\"");
}

TEST_CASE("A reference set that is not there is open and has no rows")
{
    const TdsDatabase database;
    const auto set = GetReferenceSet(u"NOSUCHSET", u"");
    CHECK(set->IsOpen());
    CHECK(set->EndOfRows());
}

TEST_CASE("A row set with rows gives the identifier; one without leaves it")
{
    const TdsDatabase database;
    CHECK(Called(u"rowSet").lID == 42);
    CHECK(Called(u"rowSetNullID").lID == 0);
    CHECK(Called(u"rowSetTextID").lID == 42);
    CHECK(Failure(u"rowSetLargeID") == "6 -1 '2147483648' is outside the range of a 32-bit integer");
    const Called empty(u"emptyRowSet");
    CHECK(empty.rowSet->IsOpen());
    CHECK(empty.lID == -1);
    CHECK(Called(u"emptyRowSetWithoutID").lID == -1);
}

TEST_CASE("With a row set a negative @ErrNo is not looked at")
{
    const TdsDatabase database;
    CHECK(Called(u"rowSetFails").lID == 42);
}

TEST_CASE("Without a row set @ErrNo decides: negative fails and leaves the identifier, others give it")
{
    const TdsDatabase database;
    const Called done(u"noRowSet");
    CHECK_FALSE(done.rowSet->IsOpen());
    CHECK(done.lID == 42);
    CHECK(Called(u"noRowSetNullID").lID == 0);
    CHECK(Called(u"noRowSetPositive").lID == 42);
    CHECK(Called(u"noRowSetNullErrNo").lID == 42);
    CHECK(Called(u"noRowSetReturnsStatus").lID == 42); // the status is no @ErrNo
    CHECK(Failure(u"noRowSetFails") == "30010 -1 The job is locked by O'Brien.");
    CHECK(Failure(u"noRowSetFailsWithNullText") == "30010 -1 Application-defined or object-defined error");
}

TEST_CASE("A procedure without @ID, @ErrNo or @ErrMsg fails where they are read")
{
    const TdsDatabase database;
    CHECK(Failure(u"rowSetWithoutID") == "3265 -1 rowSetWithoutID has no parameter '@ID'");
    CHECK(Failure(u"noRowSetWithoutID") == "3265 -1 noRowSetWithoutID has no parameter '@ID'");
    CHECK(Failure(u"noRowSetWithoutErrNo") == "3265 -1 noRowSetWithoutErrNo has no parameter '@ErrNo'");
    CHECK(Failure(u"noRowSetFailsWithoutErrMsg") == "3265 -1 noRowSetFailsWithoutErrMsg has no parameter '@ErrMsg'");
}

TEST_CASE("The first row set counts, behind messages and counts of rows too")
{
    const TdsDatabase database;
    for (const TextView procedure : {u"twoRowSets", u"rowCountFirst", u"printFirst"}) {
        const Called called(procedure);
        REQUIRE(called.rowSet->Count() == 1);
        CHECK(Cell(called, u"Code") == u"A");
    }
    CHECK(Called(u"printOnly").lID == 42);
}

TEST_CASE("An error of the server is raised with its words and numbers, before rows and behind them")
{
    const TdsDatabase database;
    CHECK(Failure(u"errorOnly") == "3146 -1 No such set. (42000, 50000)");
    CHECK(Failure(u"errorBeforeRows") == "3146 -1 Before the rows. (42000, 50000)");
    CHECK(Failure(u"errorAfterRows") == "3146 -1 After the rows. (42000, 50000)");
    CHECK(Failure(u"errorThatEnds") == "3146 -1 Thrown. (42000, 50000)");
    CHECK(Failure(u"noSuchProcedure") == "3146 -1 Could not find stored procedure 'noSuchProcedure'. (42000, 2812)");
    CHECK(Called(u"rowSet").lID == 42); // and the connection is of use
    CHECK(database.server.Count("login") == 1);
}

TEST_CASE("Every type of a column has its value; null is Empty")
{
    const TdsDatabase database;
    Called called(u"rowSetOfTypes");
    RowSet& rows = *called.rowSet;
    CHECK(rows.Field(u"Tiny") == Variant(std::int16_t{255}));
    CHECK(rows.Field(u"Small") == Variant(std::int16_t{-32768}));
    CHECK(rows.Field(u"Whole") == Variant(std::numeric_limits<std::int32_t>::min()));
    CHECK(rows.Field(u"Big") == Variant(4611686018427387904.0));
    CHECK(rows.Field(u"Flag") == Variant(true));
    CHECK(rows.Field(u"Single") == Variant(1.5));
    CHECK(rows.Field(u"Double") == Variant(-0.1));
    CHECK(rows.Field(u"Exact") == Variant(-1234.56));
    CHECK(rows.Field(u"Amount") == Variant(99.95));
    CHECK(rows.Field(u"Moment") == Variant(*DateFrom(CivilDate{2004, 3, 15, 14, 5, 9})));
    CHECK(rows.Field(u"Day") == Variant(Date{0}));
    CHECK(ToText(rows.Field(u"Hour")) == u"1899-12-30 14:05:09");
    CHECK(ToText(rows.Field(u"Precise")) == u"2004-03-15 14:05:09");
    CHECK(rows.Field(u"Fixed") == Variant(Text(u"ab   ")));
    CHECK(rows.Field(u"Varying") == Variant(Text(u"5 €")));
    CHECK(rows.Field(u"Long") == Variant(Text(10000, u'x')));
    CHECK(rows.Field(u"Wide") == Variant(Text(u"\U0001f697 €")));
    CHECK(std::get<Text>(rows.Field(u"LongWide")).size() == 10000);
    CHECK(std::get<Text>(rows.Field(u"LongWide")).ends_with(u"\U0001f697\U0001f697"));
    CHECK(ToText(rows.Field(u"Identity")) == u"00112233-4455-6677-8899-AABBCCDDEEFF");
    rows.MoveNext();
    for (const Text& column : rows.Columns())
        CHECK(IsEmpty(rows.Field(column)));
}

TEST_CASE("Texts come as they are")
{
    const TdsDatabase database;
    const Called called(u"rowSetDifficult");
    const auto description = [&](TextView code) {
        called.rowSet->MoveFirst();
        called.rowSet->Find(u"Code = '" + Text(code) + u"'");
        return called.rowSet->Field(u"Description");
    };
    CHECK(description(u"QUOTES") == Variant(Text(u"O'Brien's \"Body\" & <Paint>")));
    CHECK(description(u"EURO") == Variant(Text(u"5 €")));
    CHECK(description(u"EMOJI") == Variant(Text(u"\U0001f697 towed")));
    CHECK(description(u"BLANKS") == Variant(Text(u"  two before, two after  ")));
    CHECK(description(u"LINES") == Variant(Text(u"first\r\nsecond\tand a tab")));
    CHECK(description(u"EMPTY") == Variant(Text()));
    CHECK(description(u"NULL") == Empty);
}

TEST_CASE("Ten thousand rows come whole; a set with other columns has those")
{
    const TdsDatabase database;
    const Called called(u"manyRows", u"10000");
    CHECK(called.rowSet->Count() == 10000);
    called.rowSet->Find(u"Code = 'C9999'");
    CHECK(Cell(called, u"Description") == u"Description 9999");
    const Called other(u"rowSetOtherColumns");
    CHECK(RaisedBy([&] { other.rowSet->Find(u"Code = '1'"); }) == "3265 RowSet.Find");
}

TEST_CASE("A row set outlives the connection; the updatable form takes changes and sends none")
{
    const TdsDatabase database;
    const Called called(u"rowSet", u"", false, true);
    CHECK(called.rowSet->IsUpdatable());
    CHECK_FALSE(Called(u"rowSet", u"", true).rowSet->IsUpdatable());
    called.rowSet->SetField(u"Description", Text(u"Changed"));
    CHECK(Cell(called, u"Description") == u"Changed");
    CHECK(database.server.Count("rpc") == 4); // two lists and two calls
}

// What is sent

TEST_CASE("Values are converted by the declared type: 12 and AB of 12 and ABC")
{
    const TdsDatabase database;
    CHECK(Sent(database, u"takeNumberAndText", u"12\tABC") == "int(4)=12 nvarchar(2)=\"AB\"");
    CHECK(Sent(database, u"takeNumberAndText", u"many\t") == "int(4)=0 nvarchar(1)=\"\"");
}

TEST_CASE("Integers, fractions and Booleans travel as such")
{
    const TdsDatabase database;
    CHECK(Sent(database, u"takeIntegers", u"1.5\t-2\tx\t2147483647")
          == "int(4)=2 int(4)=-2 int(4)=0 int(4)=2147483647");
    CHECK(Sent(database, u"takeFractions", u"1.5\t-0.1\t3.14\tx\t99.95\t1e2")
          == "float(8)=1.5 float(8)=-0.1 float(8)=3.14 float(8)=0.0 float(8)=99.95 float(8)=100.0");
    CHECK(Sent(database, u"takeBit", u"True") == "bit(1)=true");
}

TEST_CASE("Dates travel in the form that no language of a server reads otherwise, early ones too")
{
    const TdsDatabase database;
    CHECK(Sent(database, u"takeMoments", u"2004-03-15\t2004-03-15 14:05\t0100-01-01\t2004-03-15T14:05:09\t9999-12-31")
          == "nvarchar(19)=\"2004-03-15T00:00:00\" nvarchar(19)=\"2004-03-15T14:05:00\" "
             "nvarchar(19)=\"0100-01-01T00:00:00\" nvarchar(19)=\"2004-03-15T14:05:09\" "
             "nvarchar(19)=\"9999-12-31T00:00:00\"");
}

TEST_CASE("What is no date sends no value")
{
    const TdsDatabase database;
    CHECK(Sent(database, u"takeMoments", u"soon\t\t2004-02-30\t12\t0099-01-01")
          == "nvarchar(1)=null nvarchar(1)=null nvarchar(1)=null nvarchar(1)=null nvarchar(1)=null");
}

TEST_CASE("Texts are cut to the declared size, unlimited ones and those of other types go whole")
{
    const TdsDatabase database;
    const Text lengthy(10000, u'€');
    CHECK(Sent(database, u"takeTexts", u"abcd\tabcd\tabcd\tabcd\tabcd")
          == "nvarchar(3)=\"abc\" nvarchar(2)=\"ab\" nvarchar(4)=\"abcd\" nvarchar(4)=\"abcd\" nvarchar(4)=\"abcd\"");
    const Called called(u"takeTexts", u"a\tb\t" + lengthy + u"\td\te");
    called.rowSet->Find(u"Code = '@Max'");
    CHECK(Cell(called, u"Description") == lengthy);
    CHECK(Sent(database, u"takeOthers", u"abcd\tO'Br\t€\t\U0001f697\t00112233-4455-6677-8899-aabbccddeeff\tv\t<x/>\tb")
          == "nvarchar(4)=\"abcd\" nvarchar(4)=\"O'Br\" nvarchar(1)=\"€\" nvarchar(2)=\"\U0001f697\" "
             "nvarchar(36)=\"00112233-4455-6677-8899-aabbccddeeff\" nvarchar(1)=\"v\" nvarchar(4)=\"<x/>\" "
             "nvarchar(1)=\"b\"");
}

TEST_CASE("Texts go to inputs only, in the server's order; those left over are ignored, inputs left over have no value")
{
    const TdsDatabase database;
    CHECK(Sent(database, u"mixedOrder", u"one\t2\tthree") == "nvarchar(3)=\"one\" int(4)=2 nvarchar(5)=\"three\"");
    CHECK(Sent(database, u"takeNumberAndText", u"1\ta\tb\tc") == "int(4)=1 nvarchar(1)=\"a\"");
    CHECK(Sent(database, u"takeNumberAndText", u"1") == "int(4)=1 nvarchar(1)=null");
    CHECK(Sent(database, u"takeNumberAndText", u"") == "nvarchar(1)=null nvarchar(1)=null");
    CHECK(Sent(database, u"takeNumberAndText", u"\ta") == "int(4)=0 nvarchar(1)=\"a\"");
    CHECK(Called(u"takeNothing", u"1\t2").rowSet->IsOpen());
}

TEST_CASE(
    "A text of 2 GB is cut where the size is declared, and refused where it is not: the server has no room for it")
{
    const TdsDatabase database;
    Text texts(kLongestText + 1, u'x');
    texts[1] = u'\t';
    texts[0] = u'7';
    texts += u"yy";
    CHECK(Sent(database, u"takeNumberAndText", texts) == "int(4)=7 nvarchar(2)=\"xx\"");
    texts[1] = u'x';
    CHECK(Failure(u"takeText", texts)
          == "6 -1 takeText: @Text: '" + std::string("7") + std::string(59, 'x')
                 + "...' has 1073741826 characters, more than the 1073741823 of a database's longest text");
    CHECK(Called(u"rowSet").lID == 42); // and the connection is of use
    CHECK(database.server.Count("login") == 1);
}

TEST_CASE("What does not convert is raised before the call, and names procedure, parameter and value")
{
    const TdsDatabase database;
    CHECK(Failure(u"takeNumberAndText", u"32768\ta")
          == "6 -1 takeNumberAndText: @Number: '32768' is outside the range of a 16-bit integer");
    CHECK(Failure(u"takeBit", u"yes") == "13 -1 takeBit: @Bit: 'yes' is not a Boolean");
    CHECK(database.server.Count("rpc") == 2); // the lists of parameters
}

TEST_CASE("A name is no pattern, may name its owner, and is found in any letter case")
{
    const TdsDatabase database;
    CHECK(Sent(database, u"get_Pattern", u"1") == "int(4)=1");
    CHECK(Called(u"GETVARNEXREFERENCESET", u"REPAIRMODELTYPE\t").rowSet->Count() == 3);
    CHECK(Sent(database, u"ownedTwice", u"1") == "int(4)=1");
    CHECK(Sent(database, u"[guest].[ownedTwice]", u"1") == "nvarchar(1)=\"1\"");
    CHECK(Sent(database, u"CrvSql..ownedTwice", u"1") == "int(4)=1");
}

TEST_CASE("A parameter's value is Empty for null and for no parameter")
{
    CHECK(IsEmpty(DBParamValue(nullptr)));
    ProcedureParameter parameter;
    CHECK(IsEmpty(DBParamValue(&parameter)));
    parameter.value = std::int32_t{7};
    CHECK(DBParamValue(&parameter) == Variant(std::int32_t{7}));
}

// The connection

TEST_CASE("The driver logs in as sa to the database of the settings, by the protocol that is pinned")
{
    const TdsDatabase database;
    CHECK(DBConnect());
    const nlohmann::json login = database.server.Logged("login").back();
    CHECK(login.at("user") == "sa");
    CHECK(login.at("database") == "CrvSql");
    CHECK(login.at("tds").get<std::string>().starts_with("7.3"));
    CHECK(login.at("password_right") == true);
}

TEST_CASE("One connection serves all calls; bReconnect makes another one, of the settings as they are then")
{
    const TdsDatabase database;
    Called(u"rowSet");
    Called(u"rowSet");
    CHECK(DBIsConnected());
    CHECK(database.server.Count("login") == 1);
    database.folder.Use({{"ServerName", "127.0.0.1," + std::to_string(database.server.Port())},
                         {"SAPwd", "x"},
                         {"DatabaseName", "Other"}});
    Called(u"rowSet");
    CHECK(database.server.Count("login") == 1);
    Called(u"rowSet", u"", true);
    CHECK(database.server.Logged("login").back().at("database") == "Other");
}

TEST_CASE("A password may have what separates settings")
{
    for (const char* password : {"a;b={c", "a}b", "{a", " a=b", "\xC3\xA9\xE2\x82\xAC"}) {
        const TdsDatabase database({"--password", password});
        database.folder.UsePort(database.server.Port(), password);
        CAPTURE(password);
        CHECK(DBConnect());
    }
}

TEST_CASE("A wrong password is no connection, raises nothing and is told nowhere")
{
    const TdsDatabase database;
    database.folder.UsePort(database.server.Port(), "hunter2");
    CHECK_FALSE(DBConnect());
    CHECK(Called(u"rowSet").rowSet == nullptr);
    CHECK_FALSE(GetReferenceSet(u"REPAIRMODELTYPE", u"")->IsOpen());
    REQUIRE(LastConnectFailure());
    CHECK(LastConnectFailure()->reason.find(u"Login failed") != Text::npos);
    CHECK(LastConnectFailure()->reason.find(u"hunter2") == Text::npos);
}

TEST_CASE("Each thread has a connection of its own")
{
    const TdsDatabase database;
    std::vector<std::thread> threads;
    std::atomic<int> good = 0;
    for (int i = 0; i < 4; ++i)
        threads.emplace_back([&] {
            for (int call = 0; call < 25; ++call)
                good += GetReferenceSet(u"REPAIRMODELTYPE", u"")->Count() == 3 ? 1 : 0;
        });
    for (std::thread& thread : threads)
        thread.join();
    CHECK(good == 100);
    CHECK(database.server.Count("login") == 4);
}

TEST_CASE("Connections come and go without a trace")
{
    const TdsDatabase database;
    const auto descriptors = [] {
        const std::filesystem::directory_iterator open("/proc/self/fd");
        return std::distance(begin(open), end(open));
    };
    Called(u"rowSet", u"", true);
    const auto before = descriptors();
    for (int i = 0; i < 100; ++i)
        Called(u"rowSet", u"", true);
    CHECK(descriptors() == before);
    CHECK(database.server.Count("login") == 101);
}
