"""Just enough of ODBC, through the driver manager, to call stored procedures and see what comes back."""

from __future__ import annotations

import ctypes
import dataclasses
from types import TracebackType
from typing import List, Optional, Sequence, Type

NO_DATA, NULL_DATA = 100, -1
HANDLE_ENV, HANDLE_DBC, HANDLE_STMT = 1, 2, 3
ATTR_ODBC_VERSION, OV_ODBC3, ATTR_LOGIN_TIMEOUT, ATTR_QUERY_TIMEOUT = 200, 3, 103, 0
CLOSE_CURSOR = 0
PARAM_INPUT, PARAM_INPUT_OUTPUT, DEFAULT_PARAM = 1, 2, -5
C_WCHAR, WVARCHAR, C_LONG, INTEGER = -8, -9, 4, 4
WIDE = "utf-16-le"
TEXT_ROOM = 4000

odbc = ctypes.CDLL("libodbc.so.2")
Length = ctypes.c_ssize_t


class OdbcError(Exception):
    def __init__(self, state: str, number: int, text: str) -> None:
        super().__init__(f"{state} ({number}): {text}")
        self.state = state
        self.number = number


@dataclasses.dataclass(frozen=True)
class RowSet:
    columns: List[str]
    rows: List[List[Optional[str]]]


@dataclasses.dataclass(frozen=True)
class Outcome:
    row_sets: List[RowSet]
    status: int
    outputs: List[Optional[str]]


def wide(text: str) -> ctypes.Array[ctypes.c_char]:
    return ctypes.create_string_buffer((text + "\0").encode(WIDE))


def diagnosis(kind: int, handle: ctypes.c_void_p) -> OdbcError:
    state, text = ctypes.create_string_buffer(12), ctypes.create_string_buffer(2 * TEXT_ROOM)
    number, length = ctypes.c_int(), ctypes.c_short()
    odbc.SQLGetDiagRecW(
        ctypes.c_short(kind), handle, 1, state, ctypes.byref(number), text, TEXT_ROOM, ctypes.byref(length)
    )
    return OdbcError(state.raw[:10].decode(WIDE), number.value, text.raw[: 2 * length.value].decode(WIDE))


def allocate(kind: int, parent: Optional[ctypes.c_void_p]) -> ctypes.c_void_p:
    handle = ctypes.c_void_p()
    if odbc.SQLAllocHandle(ctypes.c_short(kind), parent, ctypes.byref(handle)) not in (0, 1):
        raise OdbcError("HY001", 0, f"no handle of kind {kind}")
    return handle


class Parameter:
    """Text goes in as text; an output is an integer or text, and null until it is set."""

    def __init__(self, value: Optional[str], is_output: bool = False, is_integer: bool = False) -> None:
        self.is_output = is_output
        self.is_integer = is_integer
        self.buffer = ctypes.create_string_buffer(2 * TEXT_ROOM)
        self.length = Length(NULL_DATA)
        if value is not None:
            data = int(value).to_bytes(4, "little", signed=True) if is_integer else value.encode(WIDE)
            ctypes.memmove(self.buffer, data, len(data))
            self.length = Length(len(data))

    def value(self) -> Optional[str]:
        if self.length.value == NULL_DATA:
            return None
        if self.is_integer:
            return str(int.from_bytes(self.buffer.raw[:4], "little", signed=True))
        return self.buffer.raw[: self.length.value].decode(WIDE)


def given(*texts: Optional[str]) -> List[Parameter]:
    return [Parameter(text) for text in texts]


def standard_outputs() -> List[Parameter]:
    """@ID, @ErrNo, @ErrMsg."""
    return [Parameter(None, True, True), Parameter(None, True, True), Parameter(None, True)]


class Statement:
    def __init__(self, connection: ctypes.c_void_p) -> None:
        self.handle = allocate(HANDLE_STMT, connection)

    def __enter__(self) -> Statement:
        return self

    def __exit__(self, *_: object) -> None:
        odbc.SQLFreeHandle(ctypes.c_short(HANDLE_STMT), self.handle)

    def check(self, result: int) -> int:
        if result not in (0, 1, NO_DATA):
            raise diagnosis(HANDLE_STMT, self.handle)
        return result

    def bind(self, place: int, parameter: Parameter) -> None:
        direction = PARAM_INPUT_OUTPUT if parameter.is_output else PARAM_INPUT
        c_type, sql_type = (C_LONG, INTEGER) if parameter.is_integer else (C_WCHAR, WVARCHAR)
        size = ctypes.c_size_t(10 if parameter.is_integer else max(255, parameter.length.value // 2))
        self.check(
            odbc.SQLBindParameter(
                self.handle,
                ctypes.c_ushort(place),
                ctypes.c_short(direction),
                ctypes.c_short(c_type),
                ctypes.c_short(sql_type),
                size,
                ctypes.c_short(0),
                parameter.buffer,
                Length(2 * TEXT_ROOM),
                ctypes.byref(parameter.length),
            )
        )

    def row_sets(self) -> List[RowSet]:
        """Every result, read to its end: only then are outputs set and late errors told."""
        found = []
        while True:
            count = ctypes.c_short()
            self.check(odbc.SQLNumResultCols(self.handle, ctypes.byref(count)))
            if count.value:
                found.append(self.row_set(count.value))
            if self.check(odbc.SQLMoreResults(self.handle)) == NO_DATA:
                return found

    def row_set(self, count: int) -> RowSet:
        columns = [self.column_name(place) for place in range(1, count + 1)]
        rows = []
        while self.check(odbc.SQLFetch(self.handle)) != NO_DATA:
            rows.append([self.field(place) for place in range(1, count + 1)])
        return RowSet(columns, rows)

    def column_name(self, place: int) -> str:
        name, length = ctypes.create_string_buffer(512), ctypes.c_short()
        rest = (None, None, None, None)
        self.check(odbc.SQLDescribeColW(self.handle, ctypes.c_ushort(place), name, 256, ctypes.byref(length), *rest))
        return name.raw[: 2 * length.value].decode(WIDE)

    def field(self, place: int) -> Optional[str]:
        text = ""
        while True:  # long text comes in pieces
            buffer, length = ctypes.create_string_buffer(2 * TEXT_ROOM), Length()
            where = (self.handle, ctypes.c_ushort(place), ctypes.c_short(C_WCHAR))
            result = self.check(odbc.SQLGetData(*where, buffer, Length(len(buffer)), ctypes.byref(length)))
            if length.value == NULL_DATA:
                return None
            if result == NO_DATA:
                return text
            is_last = 0 <= length.value <= len(buffer) - 2
            end = length.value if is_last else len(buffer) - 2
            text += buffer.raw[:end].decode(WIDE, errors="surrogatepass")
            if is_last:
                return text.encode(WIDE, errors="surrogatepass").decode(WIDE)


class Connection:
    def __init__(self, settings: str, login_timeout: int = 5) -> None:
        self.environment = allocate(HANDLE_ENV, None)
        odbc.SQLSetEnvAttr(self.environment, ATTR_ODBC_VERSION, ctypes.c_void_p(OV_ODBC3), 0)
        self.handle = allocate(HANDLE_DBC, self.environment)
        odbc.SQLSetConnectAttrW(self.handle, ATTR_LOGIN_TIMEOUT, ctypes.c_void_p(login_timeout), 0)
        result = odbc.SQLDriverConnectW(self.handle, None, wide(settings), ctypes.c_short(-3), None, 0, None, 0)
        if result not in (0, 1):
            error = diagnosis(HANDLE_DBC, self.handle)
            self.free()
            raise error

    def __enter__(self) -> Connection:
        return self

    def __exit__(self, _type: Optional[Type[BaseException]], _value: object, _trace: Optional[TracebackType]) -> None:
        odbc.SQLDisconnect(self.handle)
        self.free()

    def free(self) -> None:
        odbc.SQLFreeHandle(ctypes.c_short(HANDLE_DBC), self.handle)
        odbc.SQLFreeHandle(ctypes.c_short(HANDLE_ENV), self.environment)

    def query(self, sql: str) -> List[RowSet]:
        with Statement(self.handle) as statement:
            statement.check(odbc.SQLExecDirectW(statement.handle, wide(sql), -3))
            return statement.row_sets()

    def call(
        self, procedure: str, parameters: Sequence[Parameter], timeout: int = 0, has_status: bool = True
    ) -> Outcome:
        """Waits at most so many seconds, when that is not 0.

        MariaDB's procedures have no status; its driver gives the outputs as a last row set and fills what is bound to
        them with bytes of another form, so they are not read.
        """
        with Statement(self.handle) as statement:
            if timeout:
                odbc.SQLSetStmtAttrW(statement.handle, ATTR_QUERY_TIMEOUT, ctypes.c_void_p(timeout), 0)
            status = Parameter("0", True, True)
            for place, parameter in enumerate([status, *parameters] if has_status else parameters, start=1):
                statement.bind(place, parameter)
            marks = ",".join("?" * len(parameters))
            sql = f"{{{'?=' if has_status else ''}CALL {procedure}({marks})}}"
            statement.check(odbc.SQLExecDirectW(statement.handle, wide(sql), -3))
            row_sets = statement.row_sets()
            outputs = [parameter.value() for parameter in parameters if parameter.is_output and has_status]
            return Outcome(row_sets, int(status.value() or 0), outputs)

    def parameter_list(self, procedure: str) -> List[List[Optional[str]]]:
        with Statement(self.handle) as statement:
            pattern = (wide(procedure), ctypes.c_short(-3))
            nothing = (None, ctypes.c_short(0))
            statement.check(odbc.SQLProcedureColumnsW(statement.handle, *nothing, *nothing, *pattern, *nothing))
            return statement.row_sets()[0].rows
