"""sp_sproc_columns: the parameters of procedures, as SQL Server tells them to ODBC drivers.

What it tells was read in documents, not compared with a real server. Dates and times are told by their ODBC 3 codes,
so that every type code that a caller may meet is met.
"""

from __future__ import annotations

import re
from typing import Dict, List, NamedTuple, Optional, Sequence, Tuple

from tds_procedures import PROCEDURES
from tds_steps import Parameter, Procedure
from tds_types import CHARACTER, LONG, MAX, NATIONAL, SqlType
from tds_values import Value, text_of

DATABASE = "CrvSql"
COLUMNS = (
    ("PROCEDURE_QUALIFIER", "nvarchar(128)"),
    ("PROCEDURE_OWNER", "nvarchar(128)"),
    ("PROCEDURE_NAME", "nvarchar(134)"),
    ("COLUMN_NAME", "nvarchar(128)"),
    ("COLUMN_TYPE", "smallint"),
    ("DATA_TYPE", "smallint"),
    ("TYPE_NAME", "nvarchar(128)"),
    ("PRECISION", "int"),
    ("LENGTH", "int"),
    ("SCALE", "smallint"),
    ("RADIX", "smallint"),
    ("NULLABLE", "smallint"),
    ("REMARKS", "varchar(254)"),
    ("COLUMN_DEF", "nvarchar(4000)"),
    ("SQL_DATA_TYPE", "smallint"),
    ("SQL_DATETIME_SUB", "smallint"),
    ("CHAR_OCTET_LENGTH", "int"),
    ("ORDINAL_POSITION", "int"),
    ("IS_NULLABLE", "varchar(254)"),
    ("SS_DATA_TYPE", "tinyint"),
)
INPUT, INPUT_OUTPUT, RETURN_VALUE = 1, 2, 5
LONGEST = 0x7FFFFFFF


class Facts(NamedTuple):
    """What is told of a type: 0 as precision and length stands for what the declaration says."""

    code: int
    precision: int = 0
    length: int = 0
    scale: Optional[int] = None
    radix: Optional[int] = None


FACTS: Dict[str, Facts] = {
    "bit": Facts(-7, 1, 1),
    "tinyint": Facts(-6, 3, 1, 0, 10),
    "smallint": Facts(5, 5, 2, 0, 10),
    "int": Facts(4, 10, 4, 0, 10),
    "bigint": Facts(-5, 19, 8, 0, 10),
    "real": Facts(7, 24, 4, None, 2),
    "float": Facts(6, 53, 8, None, 2),
    "numeric": Facts(2, radix=10),
    "decimal": Facts(3, radix=10),
    "money": Facts(3, 19, 21, 4, 10),
    "smallmoney": Facts(3, 10, 12, 4, 10),
    "datetime": Facts(93, 23, 16, 3),
    "smalldatetime": Facts(93, 16, 16, 0),
    "datetime2": Facts(93, 27, 54, 7),
    "date": Facts(91, 10, 6),
    "time": Facts(92, 12, 10, 3),
    "char": Facts(1),
    "varchar": Facts(12),
    "text": Facts(-1),
    "nchar": Facts(-8),
    "nvarchar": Facts(-9),
    "ntext": Facts(-10),
    "binary": Facts(-2),
    "varbinary": Facts(-3),
    "image": Facts(-4),
    "uniqueidentifier": Facts(-11, 36, 16),
    "sql_variant": Facts(-150, 8000, 8000),
    "xml": Facts(-152, LONGEST // 2, LONGEST),
}


def precision_and_length(type_: SqlType) -> Tuple[int, int]:
    facts = FACTS[type_.name]
    if facts.precision:
        return facts.precision, facts.length
    if type_.name in {"decimal", "numeric"}:
        return type_.precision, type_.precision + 2
    if type_.size == MAX or type_.name in LONG:
        return (LONGEST // 2 if type_.name in NATIONAL else LONGEST), LONGEST
    return type_.declared_size(), type_.size


def parameter_row(procedure: Procedure, position: int, parameter: Parameter, direction: int) -> List[Value]:
    type_ = parameter.type
    facts = FACTS[type_.name]
    precision, length = precision_and_length(type_)
    if parameter.reported_size is not None:
        precision = length = parameter.reported_size
    is_exact = type_.name in {"decimal", "numeric"}
    is_moment = facts.code in {91, 92, 93}
    is_text = type_.name in CHARACTER | NATIONAL
    return [
        DATABASE,
        procedure.owner,
        procedure.name + ";1",
        parameter.name,
        direction,
        facts.code,
        type_.name,
        precision,
        length,
        type_.scale if is_exact else facts.scale,
        facts.radix,
        0 if direction == RETURN_VALUE else 1,
        None,
        None,
        9 if is_moment else facts.code,
        facts.code - 90 if is_moment else None,
        length if is_text else None,
        position,
        "NO" if direction == RETURN_VALUE else "YES",
        None,
    ]


def rows_of(procedure: Procedure) -> List[List[Value]]:
    status = Parameter("@RETURN_VALUE", SqlType("int", 4))
    rows = [parameter_row(procedure, 0, status, RETURN_VALUE)]
    for position, parameter in enumerate(procedure.parameters, start=1):
        direction = INPUT_OUTPUT if parameter.is_output else INPUT
        rows.append(parameter_row(procedure, position, parameter, direction))
    return rows


def like(pattern: str) -> re.Pattern[str]:
    """The regular expression of a LIKE pattern."""
    pieces = re.findall(r"\[[^]]+\]|.", pattern, re.DOTALL)
    forms = {"%": ".*", "_": "."}
    translated = (forms.get(p, p if len(p) > 1 else re.escape(p)) for p in pieces)
    return re.compile("".join(translated), re.IGNORECASE | re.DOTALL)


def matches(pattern: Value, name: str) -> bool:
    return pattern is None or like(text_of(pattern)).fullmatch(name) is not None


def procedure_columns(name: Value, owner: Value, column: Value) -> Sequence[Sequence[Value]]:
    """The answer, in the order in which the server gives it; a null pattern matches every name."""
    found = [p for p in PROCEDURES if matches(name, p.name) and matches(owner, p.owner)]
    in_order = sorted(found, key=lambda procedure: (procedure.owner, procedure.name.lower()))
    rows = [row for procedure in in_order for row in rows_of(procedure)]
    return [row for row in rows if matches(column, text_of(row[3]))]
