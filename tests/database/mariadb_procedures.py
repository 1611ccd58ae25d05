#!/usr/bin/env python3
"""Writes the stored procedures of the TDS test server as SQL for MariaDB, to run the same tests on a real engine.

What MariaDB has no words for is left out: procedures that hang up, messages that are no errors, row counts before rows,
row sets of SQL Server's own types, a second owner. The reference set is left out, too: its SQL is the sample's.
"""

from __future__ import annotations

import re
import uuid
from datetime import date, datetime, time
from typing import Dict, List, Optional

from tds_procedures import NO_ROWS, PROCEDURES, TYPED_COLUMNS, many_rows, reference_set, wait, what_was_taken
from tds_steps import Message, Parameter, Procedure, Return, Rows, Set, Step
from tds_types import EXACT, MAX, SqlType
from tds_values import Value

TYPES: Dict[str, str] = {
    "tinyint": "tinyint unsigned",
    "bit": "bit(1)",
    "real": "float",
    "float": "double",
    "money": "decimal(19,4)",
    "smallmoney": "decimal(10,4)",
    "datetime": "datetime(3)",
    "smalldatetime": "datetime",
    "datetime2": "datetime(6)",
    "time": "time(3)",
    "text": "longtext",
    "ntext": "longtext",
    "image": "longblob",
    "uniqueidentifier": "char(36)",
    "sql_variant": "longtext",
    "xml": "longtext",
}
MANY_ROWS = (
    "WITH RECURSIVE Numbers (N) AS (SELECT 0 UNION ALL SELECT N + 1 FROM Numbers WHERE N + 1 < `@Count`)\n"
    "SELECT CONCAT('C', N) AS Code, CONCAT('Description ', N) AS Description FROM Numbers WHERE N < `@Count`"
)
ESCAPES = str.maketrans({"\\": r"\\", "'": "''", "\r": r"\r", "\n": r"\n"})
SUCCESS = "SET `@ID` = 42, `@ErrNo` = 0"


def literal(value: Value) -> str:
    if value is None:
        return "NULL"
    if isinstance(value, bytes):
        return f"x'{value.hex()}'"
    if isinstance(value, (str, date, datetime, time, uuid.UUID)):
        return "'" + str(value).translate(ESCAPES) + "'"
    if isinstance(value, bool):
        return str(int(value))
    return repr(value) if isinstance(value, float) else str(value)


def type_of(type_: SqlType) -> str:
    if type_.size == MAX:
        return "longtext"
    if type_.name in EXACT:
        return f"decimal({type_.precision},{type_.scale})"
    if type_.name in TYPES:
        return TYPES[type_.name]
    name = type_.name.removeprefix("n") if type_.name in {"nchar", "nvarchar"} else type_.name
    return f"{name}({type_.declared_size()})" if re.search("char|binary", name) else name


def declaration(parameter: Parameter) -> str:
    direction = "OUT" if parameter.is_output else "IN"
    return f"{direction} `{parameter.name}` {type_of(parameter.type)}"


def select(columns: List[str], values: List[str]) -> str:
    return "SELECT " + ", ".join(f"{value} AS {name}" for name, value in zip(columns, values))


def row_set(step: Rows) -> str:
    names = [name for name, _ in step.columns]
    if not step.rows:
        return select(names, ["''"] * len(names)) + " FROM DUAL WHERE FALSE"
    return " UNION ALL ".join(select(names, [literal(value) for value in row]) for row in step.rows)


def statement(step: Step) -> Optional[str]:
    """One statement, or nothing when MariaDB has none for it."""
    if isinstance(step, Rows) and step.columns is not TYPED_COLUMNS and not step.cut_short:
        return row_set(step)
    if isinstance(step, Set):
        return "SET " + ", ".join(f"`{name}` = {literal(value)}" for name, value in step.values.items())
    if isinstance(step, Message) and step.severity:
        return f"SIGNAL SQLSTATE '45000' SET MESSAGE_TEXT = {literal(step.text)}, MYSQL_ERRNO = 30000"
    return None


def taken(procedure: Procedure) -> str:
    """A row an input parameter, in their order."""
    inputs = [parameter.name for parameter in procedure.parameters if not parameter.is_output]
    texts = [f"CONVERT(`{name}`, char) AS Description, {place} AS Place" for place, name in enumerate(inputs)]
    rows = " UNION ALL ".join(f"SELECT '{name}' AS Code, {text}" for name, text in zip(inputs, texts))
    return f"SELECT Code, Description FROM ({rows}) AS Taken ORDER BY Place" if inputs else row_set(NO_ROWS)


def body(procedure: Procedure) -> List[Optional[str]]:
    if procedure.behaviour is what_was_taken:
        return [taken(procedure), SUCCESS]
    if procedure.behaviour is many_rows:
        return [MANY_ROWS, SUCCESS]
    if procedure.behaviour is wait:
        return ["DO SLEEP(`@Seconds`)", "SELECT 'A' AS Code, 'Assessed' AS Description", SUCCESS]
    return [statement(step) for step in procedure.behaviour({}) if not isinstance(step, Return)]


def is_left_out(procedure: Procedure) -> bool:
    return procedure.behaviour is reference_set or procedure.owner != "dbo"


def script() -> str:
    pieces = ["DELIMITER //"]
    for procedure in PROCEDURES:
        if is_left_out(procedure):
            continue
        statements = body(procedure)
        if None in statements:
            continue
        parameters = ", ".join(declaration(parameter) for parameter in procedure.parameters)
        lines = ";\n".join(line for line in statements if line is not None)
        pieces.append(f"CREATE PROCEDURE `{procedure.name}` ({parameters})\nBEGIN\n{lines};\nEND //")
    return "\n".join([*pieces, "DELIMITER ;", ""])


if __name__ == "__main__":
    print(script())
