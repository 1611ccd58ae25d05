"""The stored procedures of the test server, one for every situation that a caller can meet."""

from __future__ import annotations

import uuid
from datetime import date, datetime, time
from decimal import Decimal
from typing import Dict, Optional, Sequence

from tds_steps import (
    CloseIdleConnections,
    Delay,
    HangUp,
    Procedure,
    Return,
    RowCount,
    Rows,
    Set,
    Step,
    always,
    gives,
    may_take,
    printed,
    raised,
    takes,
)
from tds_values import Value, text_of

Values = Dict[str, Value]

ID, ERR_NO, ERR_MSG = gives("@ID", "int"), gives("@ErrNo", "int"), gives("@ErrMsg", "varchar(255)")
OUTPUTS = (ID, ERR_NO, ERR_MSG)
NAME_AND_FILTER = (takes("@Name", "varchar(50)"), takes("@Filter", "varchar(50)"))

CODES = (("Code", "varchar(20)"), ("Description", "nvarchar(255)"))
ASSESSED = ("A", "Assessed")
TENDERING = ("T", "Tendering")
REFERENCE_SETS = {
    "REPAIRMODELTYPE": (ASSESSED, ("CP", "Allocated"), TENDERING),
    "ERRORSEVERITY": (("E", "Error"), ("F", "Fatal"), ("I", "Information"), ("W", "Warning")),
}
OTHER_COLUMNS = (("Id", "int"), ("Label", "varchar(9)"))
TAKEN = (("Code", "varchar(20)"), ("Description", "nvarchar(max)"))
ONE_ROW = Rows(CODES, [ASSESSED])
NO_ROWS = Rows(CODES, [])


def outcome(identifier: Value, number: Value = 0, text: Optional[str] = None) -> Set:
    return Set({"@ID": identifier, "@ErrNo": number, "@ErrMsg": text})


def succeed() -> Set:
    return outcome(42)


def reference_set(values: Values) -> Sequence[Step]:
    """The rows of a set, or the one whose code is the filter; letter case does not matter, as in the server."""
    name, code = text_of(values["@Name"]).upper(), text_of(values["@Filter"]).upper()
    rows = [row for row in REFERENCE_SETS.get(name, ()) if code in ("", row[0].upper())]
    return [Rows(CODES, rows), outcome(0)]


def what_was_taken(values: Values) -> Sequence[Step]:
    """One row an input parameter: its name, and its value as text, after the conversion to the declared type."""
    outputs = {parameter.name for parameter in OUTPUTS}
    taken = [(name, None if value is None else text_of(value)) for name, value in values.items() if name not in outputs]
    return [Rows(TAKEN, taken), succeed()]


def wait(values: Values) -> Sequence[Step]:
    return [Delay(float(text_of(values["@Seconds"] or 0))), ONE_ROW, succeed()]


def many_rows(values: Values) -> Sequence[Step]:
    count = int(text_of(values["@Count"] or 0))
    return [Rows(CODES, [(f"C{number}", f"Description {number}") for number in range(count)]), succeed()]


TYPED_COLUMNS = (
    ("Tiny", "tinyint"),
    ("Small", "smallint"),
    ("Whole", "int"),
    ("Big", "bigint"),
    ("Flag", "bit"),
    ("Single", "real"),
    ("Double", "float"),
    ("Exact", "decimal(9,2)"),
    ("Amount", "money"),
    ("Moment", "datetime"),
    ("Minute", "smalldatetime"),
    ("Day", "date"),
    ("Hour", "time(3)"),
    ("Precise", "datetime2(7)"),
    ("Fixed", "char(5)"),
    ("Varying", "varchar(20)"),
    ("Long", "varchar(max)"),
    ("Wide", "nvarchar(20)"),
    ("LongWide", "nvarchar(max)"),
    ("Bytes", "varbinary(8)"),
    ("Identity", "uniqueidentifier"),
)
MOMENT = datetime(2004, 3, 15, 14, 5, 9)
TYPED_ROW = (
    255,
    -32768,
    -2147483648,
    2**62,
    True,
    1.5,
    -0.1,
    Decimal("-1234.56"),
    Decimal("99.95"),
    MOMENT,
    MOMENT.replace(second=0),
    date(1899, 12, 30),
    time(14, 5, 9, 120_000),
    MOMENT.replace(microsecond=123_456),
    "ab",
    "5 €",
    "x" * 10_000,
    "\U0001f697 €",
    "\U0001f697" * 5000,
    b"\0\xff",
    uuid.UUID("00112233-4455-6677-8899-aabbccddeeff"),
)
DIFFICULT = (
    ("QUOTES", "O'Brien's \"Body\" & <Paint>"),
    ("EURO", "5 €"),
    ("EMOJI", "\U0001f697 towed"),
    ("UMLAUT", "Müller"),
    ("BLANKS", "  two before, two after  "),
    ("LINES", "first\r\nsecond\tand a tab"),
    ("EMPTY", ""),
    ("NULL", None),
)

PROCEDURES = (
    Procedure("getVarnexReferenceSet", (*NAME_AND_FILTER, *OUTPUTS), reference_set),
    # Every declared type
    Procedure("takeNothing", OUTPUTS, what_was_taken),
    Procedure("takeNumberAndText", (takes("@Number", "int"), takes("@Text", "varchar(2)"), *OUTPUTS), what_was_taken),
    Procedure(
        "takeIntegers",
        (
            takes("@Tiny", "tinyint"),
            takes("@Small", "smallint"),
            takes("@Int", "int"),
            takes("@Big", "bigint"),
            *OUTPUTS,
        ),
        what_was_taken,
    ),
    Procedure(
        "takeFractions",
        (
            takes("@Real", "real"),
            takes("@Float", "float"),
            takes("@Decimal", "decimal(9,2)"),
            takes("@Numeric", "numeric(18,4)"),
            takes("@Money", "money"),
            takes("@SmallMoney", "smallmoney"),
            *OUTPUTS,
        ),
        what_was_taken,
    ),
    Procedure(
        "takeMoments",
        (
            takes("@DateTime", "datetime"),
            takes("@SmallDateTime", "smalldatetime"),
            takes("@Date", "date"),
            takes("@Time", "time(3)"),
            takes("@DateTime2", "datetime2(7)"),
            *OUTPUTS,
        ),
        what_was_taken,
    ),
    Procedure("takeText", (takes("@Text", "nvarchar(max)"), *OUTPUTS), what_was_taken),
    Procedure("takeBit", (takes("@Bit", "bit"), *OUTPUTS), what_was_taken),
    Procedure(
        "takeTexts",
        (
            takes("@Char", "char(3)"),
            takes("@VarChar", "varchar(2)"),
            takes("@Max", "varchar(max)"),
            takes("@MaxAsZero", "varchar(max)", reported_size=0),  # as some drivers tell it
            takes("@Text", "text"),
            *OUTPUTS,
        ),
        what_was_taken,
    ),
    Procedure(
        "takeOthers",
        (
            takes("@NChar", "nchar(3)"),
            takes("@NVarChar", "nvarchar(2)"),
            takes("@NMax", "nvarchar(max)"),
            takes("@NText", "ntext"),
            takes("@Identity", "uniqueidentifier"),
            takes("@Variant", "sql_variant"),
            takes("@Xml", "xml"),
            takes("@Bytes", "varbinary(8)"),
            *OUTPUTS,
        ),
        what_was_taken,
    ),
    # Parameter lists
    Procedure(
        "mixedOrder",
        (ID, takes("@First", "varchar(10)"), ERR_NO, takes("@Second", "int"), ERR_MSG, takes("@Third", "varchar(10)")),
        what_was_taken,
    ),
    Procedure(
        "optionalInput",
        (takes("@Required", "varchar(10)"), may_take("@Optional", "varchar(10)", "none"), *OUTPUTS),
        what_was_taken,
    ),
    Procedure("get_Pattern", (takes("@Underscore", "int"), *OUTPUTS), what_was_taken),  # its name as a pattern
    Procedure("getXPattern", (takes("@Letter", "int"), *OUTPUTS), what_was_taken),  # gives this one, too
    Procedure("ownedTwice", (takes("@ByDbo", "int"), *OUTPUTS), what_was_taken),
    Procedure("ownedTwice", (takes("@ByGuest", "varchar(9)"), *OUTPUTS), what_was_taken, owner="guest"),
    # No row set
    Procedure("noRowSet", OUTPUTS, always(succeed())),
    Procedure("noRowSetNullID", OUTPUTS, always(outcome(None))),
    Procedure("noRowSetFails", OUTPUTS, always(outcome(42, -5, "The job is locked by O'Brien."))),
    Procedure("noRowSetFailsWithNullText", OUTPUTS, always(outcome(42, -5, None))),
    Procedure("noRowSetPositive", OUTPUTS, always(outcome(42, 7, "Two rows were merged."))),
    Procedure("noRowSetNullErrNo", OUTPUTS, always(outcome(42, None))),
    Procedure("noRowSetReturnsStatus", OUTPUTS, always(succeed(), Return(-6))),
    Procedure("noRowSetWithoutID", (ERR_NO, ERR_MSG), always(Set({"@ErrNo": 0}))),
    Procedure("noRowSetWithoutErrNo", (ID, ERR_MSG), always(Set({"@ID": 42}))),
    Procedure("noRowSetFailsWithoutErrMsg", (ID, ERR_NO), always(Set({"@ID": 42, "@ErrNo": -5}))),
    # A row set
    Procedure("emptyRowSet", OUTPUTS, always(NO_ROWS, succeed())),
    Procedure("emptyRowSetWithoutID", (ERR_NO, ERR_MSG), always(NO_ROWS, Set({"@ErrNo": 0}))),
    Procedure("rowSet", OUTPUTS, always(ONE_ROW, succeed())),
    Procedure("rowSetNullID", OUTPUTS, always(ONE_ROW, outcome(None))),
    Procedure("rowSetLargeID", (gives("@ID", "bigint"), ERR_NO, ERR_MSG), always(ONE_ROW, outcome(2**31))),
    Procedure("rowSetTextID", (gives("@ID", "varchar(20)"), ERR_NO, ERR_MSG), always(ONE_ROW, outcome("42"))),
    Procedure("rowSetFails", OUTPUTS, always(ONE_ROW, outcome(42, -5, "The job is locked."))),
    Procedure("rowSetWithoutID", (ERR_NO, ERR_MSG), always(ONE_ROW, Set({"@ErrNo": 0}))),
    Procedure("rowSetOtherColumns", OUTPUTS, always(Rows(OTHER_COLUMNS, [(1, "One")]), succeed())),
    Procedure("rowSetOfTypes", OUTPUTS, always(Rows(TYPED_COLUMNS, [TYPED_ROW, [None] * len(TYPED_ROW)]), succeed())),
    Procedure("rowSetDifficult", OUTPUTS, always(Rows(CODES, DIFFICULT), succeed())),
    Procedure("manyRows", (takes("@Count", "int"), *OUTPUTS), many_rows),
    Procedure("twoRowSets", OUTPUTS, always(ONE_ROW, Rows(CODES, [TENDERING]), succeed())),
    Procedure("rowCountFirst", OUTPUTS, always(RowCount(3), ONE_ROW, succeed())),
    # Messages and errors
    Procedure("printFirst", OUTPUTS, always(printed("Looking it up."), ONE_ROW, succeed())),
    Procedure("printOnly", OUTPUTS, always(printed("Nothing to do."), succeed())),
    Procedure("errorOnly", OUTPUTS, always(raised("No such set."), Return(1))),
    Procedure("errorBeforeRows", OUTPUTS, always(raised("Before the rows."), ONE_ROW, succeed())),
    Procedure("errorAfterRows", OUTPUTS, always(ONE_ROW, raised("After the rows."), succeed())),
    Procedure("errorThatEnds", OUTPUTS, always(ONE_ROW, raised("Thrown.", ends=True))),
    # Time and broken connections
    Procedure("delay", (takes("@Seconds", "float"), *OUTPUTS), wait),
    Procedure("hangUpBefore", OUTPUTS, always(HangUp())),
    Procedure("hangUpDuring", OUTPUTS, always(Rows(CODES, [ASSESSED], cut_short=True), HangUp())),
    Procedure("hangUpAfter", OUTPUTS, always(ONE_ROW, succeed(), HangUp(after_answer=True))),
    Procedure("closeIdleConnections", OUTPUTS, always(CloseIdleConnections(), succeed())),
)


def called(name: str) -> Optional[Procedure]:
    """The procedure that a call names: `name`, `dbo.name`, `CrvSql..name` or `[dbo].[name]`, in any letter case."""
    parts = [part.strip("[]\"").lower() for part in name.split(";")[0].split(".")]
    owner = parts[-2] if len(parts) > 1 and parts[-2] else "dbo"
    return next((p for p in PROCEDURES if p.name.lower() == parts[-1] and p.owner == owner), None)
