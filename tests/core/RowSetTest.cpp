// Rows that a database answered with, and how codes are looked up in them.
#include "varnex3/core/RowSet.h"

#include "tests/Printing.h"

using namespace varnex3;
using tests::RaisedBy;

namespace {

RowSet RepairModels(RowSet::Form form = RowSet::Form::ReadOnly)
{
    return {{u"Code", u"Description"},
            {{Text(u"A"), Text(u"Assessed")}, {Text(u"CP"), Text(u"Allocated")}, {Empty, Text(u"Unknown")}},
            form};
}

Text Found(RowSet set, TextView criterion)
{
    set.Find(criterion);
    return set.EndOfRows() ? u"none" : ToText(set.Field(u"Description"));
}

} // namespace

TEST_CASE("A code is found in any letter case, from the current row on")
{
    CHECK(Found(RepairModels(), u"Code = 'CP'") == u"Allocated");
    CHECK(Found(RepairModels(), u"Code = 'cp'") == u"Allocated");
    CHECK(Found(RepairModels(), u" cODE='a' ") == u"Assessed");
    CHECK(Found(RepairModels(), u"Code = 'X'") == u"none");
    RowSet set = RepairModels();
    set.MoveNext();
    CHECK(Found(set, u"Code = 'A'") == u"none");
    CHECK(Found(set, u"Code = 'CP'") == u"Allocated");
}

TEST_CASE("A null equals nothing, not even the empty text")
{
    CHECK(Found(RepairModels(), u"Code = ''") == u"none");
    CHECK(Found({{u"Code", u"Description"}, {{Text(), Text(u"Empty")}}}, u"Code = ''") == u"Empty");
}

TEST_CASE("A criterion of another form is 3001, a value with an apostrophe too")
{
    for (const TextView criterion : {u"Code = 'O'Brien'", u"Code = '''", u"Code = 'a''b'", u"Code = A", u"Code", u"",
                                     u" = 'A'", u"Code = '", u"Code > 'A'"})
        CHECK(RaisedBy([&] { RepairModels().Find(criterion); }) == "3001 RowSet.Find");
}

TEST_CASE("A column that is not there is 3265")
{
    CHECK(RaisedBy([] { RepairModels().Find(u"Colour = 'A'"); }) == "3265 RowSet.Find");
    CHECK(RaisedBy([] { RepairModels().Field(u"Colour"); }) == "3265 RowSet.Field");
}

TEST_CASE("A set that was never opened is searched in vain, whatever the criterion")
{
    RowSet set;
    set.MoveFirst();
    set.Find(u"Code = 'O'Brien'");
    CHECK_FALSE(set.IsOpen());
    CHECK(set.EndOfRows());
    CHECK(set.Count() == 0);
}

TEST_CASE("An open set without rows is at its end, and a malformed criterion is one there, too")
{
    RowSet set({u"Code"}, {});
    CHECK(set.IsOpen());
    CHECK(set.EndOfRows());
    CHECK(RaisedBy([&] { set.Find(u"Code = '''"); }) == "3001 RowSet.Find");
}

TEST_CASE("Behind the last row there is no current row")
{
    RowSet set = RepairModels();
    for (int i = 0; i < 3; ++i)
        set.MoveNext();
    CHECK(set.EndOfRows());
    CHECK(RaisedBy([&] { set.MoveNext(); }) == "3021 RowSet.MoveNext");
    CHECK(RaisedBy([&] { set.Field(u"Code"); }) == "3021 RowSet.Field");
    set.MoveFirst();
    CHECK(std::get<Text>(set.Field(u"code")) == u"A");
}

TEST_CASE("An updatable set keeps what is changed, row by row; another one is not changed")
{
    RowSet set = RepairModels(RowSet::Form::Updatable);
    set.MoveNext();
    CHECK_FALSE(set.IsChanged());
    set.SetField(u"description", Text(u"Other"));
    CHECK(set.IsChanged());
    CHECK(std::get<Text>(set.Field(u"Description")) == u"Other");
    set.MoveFirst();
    CHECK_FALSE(set.IsChanged());
    CHECK(RaisedBy([] { RepairModels().SetField(u"Code", Empty); }) == "3251 RowSet.SetField");
}
