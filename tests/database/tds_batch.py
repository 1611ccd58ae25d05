"""What the test server understands of SQL: SET and USE, SELECT of literals, EXEC with literals."""

from __future__ import annotations

import dataclasses
import re
from decimal import Decimal
from typing import List, Sequence, Tuple, Union

from tds_protocol import DEFAULT_VALUE, Argument, Call
from tds_types import SqlType, declared
from tds_values import Value

WORD = re.compile(
    r"(?P<text>N?'(?:[^']|'')*')|(?P<number>-?\d+(?:\.\d+)?)"
    r"|(?P<name>[@#\w.$]+|\[[^]]*\](?:\.+\[?\w+\]?)*)|(?P<mark>[=,;])"
)
COMMENT = re.compile(r"--[^\n]*|/\*.*?\*/", re.DOTALL)
IGNORED = {"set", "use"}


class SyntaxFault(Exception):
    """SQL that is not understood."""


@dataclasses.dataclass(frozen=True)
class Selected:
    columns: Sequence[Tuple[str, SqlType]]
    row: Sequence[Value]


Statement = Union[Call, Selected, None]  # None: there is nothing to do


def words_of(sql: str) -> List[str]:
    bare = COMMENT.sub(" ", sql)
    words: List[str] = []
    position = 0
    for found in WORD.finditer(bare):
        refuse_any(bare[position : found.start()])
        words.append(found[0])
        position = found.end()
    refuse_any(bare[position:])
    return words


def refuse_any(between: str) -> None:
    if between.strip():
        raise SyntaxFault(between.strip())


def typed(word: str) -> Tuple[SqlType, Value]:
    if word.startswith(("'", "N'")):
        text = word[word.index("'") + 1 : -1].replace("''", "'")
        name = "nvarchar" if word.startswith("N") else "varchar"
        return declared(f"{name}({max(len(text), 1)})"), text
    if word.lower() == "null":
        return declared("int"), None
    if re.fullmatch(r"-?\d+", word):
        return declared("int" if -(2**31) <= int(word) < 2**31 else "bigint"), int(word)
    if re.fullmatch(r"-?\d+\.\d+", word):
        return declared(f"numeric(38,{len(word.split('.')[1])})"), Decimal(word)
    raise SyntaxFault(word)


def split_at_commas(words: Sequence[str]) -> List[List[str]]:
    parts: List[List[str]] = [[]]
    for word in words:
        if word == ",":
            parts.append([])
        else:
            parts[-1].append(word)
    return parts


def selected(words: Sequence[str]) -> Selected:
    """SELECT 1, 'x' AS Name, Other = N'y'."""
    columns: List[Tuple[str, SqlType]] = []
    row: List[Value] = []
    for part in split_at_commas(words):
        name = ""
        if len(part) == 3 and part[1] == "=":
            name, part = part[0], part[2:]
        elif len(part) == 3 and part[1].lower() == "as":
            name, part = part[2], part[:1]
        if len(part) != 1:
            raise SyntaxFault(" ".join(part))
        type_, value = typed(part[0])
        columns.append((name.strip("[]"), type_))
        row.append(value)
    return Selected(columns, row)


def argument(words: List[str]) -> Argument:
    """A value, or DEFAULT, named or not. A batch has no variables, so what an OUTPUT parameter gives is lost."""
    name = ""
    if len(words) == 3 and words[1] == "=":
        name, words = words[0], words[2:]
    if len(words) != 1:
        raise SyntaxFault(" ".join(words))
    if words[0].lower() == "default":
        return Argument(name, DEFAULT_VALUE, declared("int"), None)
    type_, value = typed(words[0])
    return Argument(name, 0, type_, value)


def executed(words: List[str]) -> Call:
    if len(words) > 2 and words[1] == "=":
        words = words[2:]
    arguments = [argument(part) for part in split_at_commas(words[1:])] if len(words) > 1 else []
    return Call(words[0], arguments)


def statement(words: List[str]) -> Statement:
    verb = words[0].lower()
    if verb in IGNORED:
        return None
    if verb == "select":
        return selected(words[1:])
    if verb in {"exec", "execute"} and len(words) > 1:
        return executed(words[1:])
    raise SyntaxFault(words[0])


def statements(sql: str) -> List[Statement]:
    """The statements of a batch: one, or several with a semicolon or the word SET, USE, EXEC or SELECT between them."""
    found: List[List[str]] = [[]]
    for word in words_of(sql):
        starts = word.lower() in IGNORED | {"exec", "execute", "select"}
        if word == ";" or (starts and found[-1]):
            found.append([])
        if word != ";":
            found[-1].append(word)
    return [statement(words) for words in found if words]
