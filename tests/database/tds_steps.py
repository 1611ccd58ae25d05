"""What a stored procedure of the test server is made of: its parameters, and the steps that it takes when called."""

from __future__ import annotations

import dataclasses
from typing import Callable, Dict, Mapping, Optional, Sequence, Tuple, Union

from tds_types import SqlType, declared
from tds_values import Value


@dataclasses.dataclass(frozen=True)
class Parameter:
    name: str
    type: SqlType
    is_output: bool = False
    default: Value = None
    has_default: bool = False
    reported_size: Optional[int] = None  # what the parameter list tells, where it is not the usual


def takes(name: str, declaration: str, reported_size: Optional[int] = None) -> Parameter:
    return Parameter(name, declared(declaration), reported_size=reported_size)


def may_take(name: str, declaration: str, default: Value) -> Parameter:
    return Parameter(name, declared(declaration), default=default, has_default=True)


def gives(name: str, declaration: str) -> Parameter:
    return Parameter(name, declared(declaration), is_output=True)


Columns = Sequence[Tuple[str, str]]  # name and declaration


@dataclasses.dataclass(frozen=True)
class Rows:
    """A row set; cut short, it breaks off after its last row without saying that it is complete."""

    columns: Columns
    rows: Sequence[Sequence[Value]]
    cut_short: bool = False


@dataclasses.dataclass(frozen=True)
class RowCount:
    """What an UPDATE without SET NOCOUNT ON leaves."""

    count: int


@dataclasses.dataclass(frozen=True)
class Message:
    """A message of the server: PRINT, RAISERROR, or with `ends` an error that ends the procedure, like THROW."""

    text: str
    number: int = 0
    severity: int = 0
    ends: bool = False


def printed(text: str) -> Message:
    return Message(text)


def raised(text: str, ends: bool = False) -> Message:
    return Message(text, 50000, 16, ends)


@dataclasses.dataclass(frozen=True)
class Delay:
    seconds: float


@dataclasses.dataclass(frozen=True)
class HangUp:
    """Closes the connection at once, or when the answer is complete."""

    after_answer: bool = False


@dataclasses.dataclass(frozen=True)
class CloseIdleConnections:
    """Closes every connection but the caller's."""


@dataclasses.dataclass(frozen=True)
class Return:
    status: int


@dataclasses.dataclass(frozen=True)
class Set:
    """Gives output parameters their values; those never set are null."""

    values: Mapping[str, Value]


Step = Union[Rows, RowCount, Message, Delay, HangUp, CloseIdleConnections, Return, Set]
Behaviour = Callable[[Dict[str, Value]], Sequence[Step]]  # from the values of the parameters to the steps


def always(*steps: Step) -> Behaviour:
    return lambda _: steps


@dataclasses.dataclass(frozen=True)
class Procedure:
    name: str
    parameters: Sequence[Parameter]
    behaviour: Behaviour
    owner: str = "dbo"

    def parameter(self, name: str) -> Optional[Parameter]:
        return next((p for p in self.parameters if p.name.lower() == name.lower()), None)
