"""One client of the test server: its login, its requests and what they are answered with."""

from __future__ import annotations

import dataclasses
import select
import socket
from typing import Any, Callable, Dict, List, Optional, Sequence

import tds_batch
from tds_catalogue import COLUMNS, procedure_columns
from tds_procedures import called
from tds_protocol import (
    ATTENTION,
    CANCELLED,
    DONE,
    DONE_IN_PROCEDURE,
    DONE_PROCEDURE,
    FAILED,
    FINAL,
    HAS_COUNT,
    LOGIN,
    MORE,
    PRELOGIN,
    RPC,
    SQL_BATCH,
    VERSION_NAMES,
    Answer,
    Argument,
    Call,
    Login,
    Tokens,
    prelogin_answer,
    read_batch,
    read_calls,
    read_login,
    receive,
)
from tds_steps import (
    CloseIdleConnections,
    Delay,
    HangUp,
    Message,
    Parameter,
    Procedure,
    Return,
    RowCount,
    Rows,
    Set,
    Step,
)
from tds_types import ConversionFailed, SqlType, declared
from tds_values import Value

ERROR = 16
CATALOGUE = {"sp_sproc_columns", "sp_sproc_columns_90", "sp_sproc_columns_100"}
CATALOGUE_ARGUMENTS = ("@procedure_name", "@procedure_owner", "@procedure_qualifier", "@column_name", "@odbcver")


class Refused(Exception):
    """A request that is answered with an error of the server."""

    def __init__(self, number: int, text: str) -> None:
        super().__init__(text)
        self.number = number
        self.text = text


class Ended(Exception):
    """The connection is over, by either side."""


class Cancelled(Exception):
    """The client does not want the rest of the answer."""


@dataclasses.dataclass(frozen=True)
class Surroundings:
    """What a session needs of its server."""

    password: str
    log: Callable[[Dict[str, Any]], None]
    close_others: Callable[[], int]


def bind(procedure: Procedure, arguments: Sequence[Argument]) -> Dict[str, Optional[Argument]]:
    """The argument of each parameter, by name or by place."""
    bound: Dict[str, Optional[Argument]] = {parameter.name: None for parameter in procedure.parameters}
    if len(arguments) > len(bound):
        raise Refused(8144, f"Procedure or function {procedure.name} has too many arguments specified.")
    for place, argument in enumerate(arguments):
        parameter = procedure.parameter(argument.name) if argument.name else procedure.parameters[place]
        if parameter is None:
            raise Refused(8145, f"{argument.name} is not a parameter for procedure {procedure.name}.")
        bound[parameter.name] = argument
    return bound


def value_for(procedure: Procedure, parameter: Parameter, argument: Optional[Argument]) -> Value:
    """What the procedure sees: the argument in the parameter's declared type."""
    if argument is None or argument.is_default():
        if not parameter.has_default:
            text = f"'{procedure.name}' expects parameter '{parameter.name}', which was not supplied."
            raise Refused(201, f"Procedure or function {text}")
        return parameter.default
    return converted(parameter.type, argument.value)


def converted(type_: SqlType, value: Value) -> Value:
    try:
        return type_.convert(value)
    except ConversionFailed as reason:
        raise Refused(8114, str(reason)) from reason


def logged(value: Value) -> object:
    if value is None or isinstance(value, (bool, int, float, str)):
        return value
    return value.hex() if isinstance(value, bytes) else str(value)


def logged_argument(argument: Argument) -> Dict[str, object]:
    type_ = argument.type
    return {
        "name": argument.name,
        "type": type_.name,
        "size": type_.declared_size(),
        "precision": type_.precision,
        "scale": type_.scale,
        "null": argument.value is None,
        "value": logged(argument.value),
        "output": argument.is_output(),
        "default": argument.is_default(),
    }


class Session:
    def __init__(self, client: socket.socket, surroundings: Surroundings) -> None:
        self.client = client
        self.surroundings = surroundings
        self.login: Optional[Login] = None
        self.tokens = Tokens(0)
        self.answer = Answer(client, 4096)
        self.hangs_up_after_answer = False

    def run(self) -> None:
        try:
            while (message := receive(self.client)) is not None:
                self.take(*message)
            self.log("gone")
        except Ended:
            pass
        except OSError as reason:
            self.log("broken", reason=str(reason))
        except (ValueError, KeyError) as reason:
            self.log("unreadable", reason=repr(reason))

    def log(self, event: str, **facts: object) -> None:
        self.surroundings.log({"event": event, **facts})

    def take(self, kind: int, body: bytes) -> None:
        self.answer = Answer(self.client, self.login.packet_size if self.login else 4096)
        if kind == PRELOGIN:
            self.answer.write(prelogin_answer())
            self.answer.end()
        elif kind == LOGIN:
            self.take_login(read_login(body))
        elif self.login is None:
            raise ValueError(f"a message of kind {kind:#x} before the login")
        elif kind == ATTENTION:
            self.confirm_attention()
        else:
            self.take_request(kind, body)
            if self.hangs_up_after_answer:
                self.hang_up()

    def take_login(self, login: Login) -> None:
        is_right = login.user.lower() == "sa" and login.password == self.surroundings.password
        self.tokens = Tokens(login.version)
        self.log(
            "login",
            user=login.user,
            database=login.database,
            application=login.application,
            server=login.server,
            computer=login.computer,
            library=login.library,
            tds=VERSION_NAMES[login.version],
            packet_size=login.packet_size,
            password_right=is_right,
        )
        if not is_right:
            self.answer.write(self.tokens.message(18456, f"Login failed for user '{login.user}'.", 14, ""))
            self.answer.write(self.tokens.done(DONE, FAILED))
            self.answer.end()
            raise Ended
        self.login = login
        self.answer.write(self.tokens.login_accepted(login))
        self.answer.end()

    def take_request(self, kind: int, body: bytes) -> None:
        try:
            if kind == SQL_BATCH:
                self.take_batch(read_batch(body, self.tokens.version))
            elif kind == RPC:
                self.take_calls(list(read_calls(body, self.tokens.version)))
            else:
                self.refuse(Refused(3930, f"Requests of kind {kind:#x} are not supported."), DONE)
        except Cancelled:
            self.confirm_attention()
            return
        self.answer.end()

    def take_batch(self, text: str) -> None:
        self.log("batch", text=text)
        try:
            statements = tds_batch.statements(text)
        except tds_batch.SyntaxFault as reason:
            self.refuse(Refused(102, f"Incorrect syntax near '{reason}'."), DONE)
            return
        for statement in statements:
            if isinstance(statement, Call):
                self.execute(statement, has_next=True)
            elif statement is not None:
                types = [type_ for _, type_ in statement.columns]
                self.answer.write(self.tokens.columns(statement.columns) + self.tokens.row(types, statement.row))
                self.answer.write(self.tokens.done(DONE, HAS_COUNT | MORE, 1))
        self.answer.write(self.tokens.done(DONE, FINAL))

    def take_calls(self, calls: List[Call]) -> None:
        for call in calls:
            self.log("rpc", procedure=call.procedure, parameters=[logged_argument(a) for a in call.arguments])
        for call in calls:
            self.execute(call, has_next=call is not calls[-1])

    def execute(self, call: Call, has_next: bool) -> None:
        try:
            if call.procedure.split(".")[-1].strip("[]").lower() in CATALOGUE:
                self.list_parameters(call.arguments, has_next)
            else:
                self.execute_procedure(call, has_next)
        except Refused as reason:
            self.refuse(reason, DONE_PROCEDURE, has_next)

    def refuse(self, reason: Refused, token: int, has_next: bool = False) -> None:
        self.answer.write(self.tokens.message(reason.number, reason.text, ERROR, ""))
        self.answer.write(self.tokens.done(token, FAILED | (MORE if has_next else FINAL)))

    def list_parameters(self, arguments: Sequence[Argument], has_next: bool) -> None:
        named: Dict[str, Value] = {}
        for argument, place in zip(arguments, CATALOGUE_ARGUMENTS):
            named[argument.name.lower() or place] = argument.value
        patterns = [named.get(name) for name in ("@procedure_name", "@procedure_owner", "@column_name")]
        self.send_rows(Rows(COLUMNS, procedure_columns(*patterns)))
        self.answer.write(self.tokens.return_status(0))
        self.answer.write(self.tokens.done(DONE_PROCEDURE, MORE if has_next else FINAL))

    def execute_procedure(self, call: Call, has_next: bool) -> None:
        procedure = called(call.procedure)
        if procedure is None:
            raise Refused(2812, f"Could not find stored procedure '{call.procedure}'.")
        bound = bind(procedure, call.arguments)
        values = {p.name: value_for(procedure, p, bound[p.name]) for p in procedure.parameters}
        status: Optional[int] = 0
        for step in procedure.behaviour(dict(values)):
            if isinstance(step, Set):
                values.update(step.values)
            elif isinstance(step, Return):
                status = step.status
            elif isinstance(step, Message) and step.ends:
                raise Refused(step.number, step.text)
            else:
                self.take_step(step, procedure)
        self.answer.write(self.tokens.return_status(status or 0))
        self.send_outputs(call.arguments, bound, values)
        self.answer.write(self.tokens.done(DONE_PROCEDURE, MORE if has_next else FINAL))

    def take_step(self, step: Step, procedure: Procedure) -> None:
        if isinstance(step, Rows):
            self.send_rows(step)
        elif isinstance(step, RowCount):
            self.answer.write(self.tokens.done(DONE_IN_PROCEDURE, HAS_COUNT | MORE, step.count))
        elif isinstance(step, Message):
            self.answer.write(self.tokens.message(step.number, step.text, step.severity, procedure.name))
            if step.severity > 10:
                self.answer.write(self.tokens.done(DONE_IN_PROCEDURE, FAILED | MORE))
        elif isinstance(step, Delay):
            self.wait(step.seconds)
        elif isinstance(step, CloseIdleConnections):
            self.log("closed_idle", connections=self.surroundings.close_others())
        elif isinstance(step, HangUp) and step.after_answer:
            self.hangs_up_after_answer = True
        elif isinstance(step, HangUp):
            self.hang_up()

    def send_rows(self, step: Rows) -> None:
        columns = [(name, declared(declaration)) for name, declaration in step.columns]
        types = [type_ for _, type_ in columns]
        self.answer.write(self.tokens.columns(columns))
        for row in step.rows:
            self.answer.write(self.tokens.row(types, row))
        if step.cut_short:
            self.answer.flush()
        else:
            self.answer.write(self.tokens.done(DONE_IN_PROCEDURE, HAS_COUNT | MORE, len(step.rows)))

    def send_outputs(
        self, arguments: Sequence[Argument], bound: Dict[str, Optional[Argument]], values: Dict[str, Value]
    ) -> None:
        """Every output that the client asked for, in the type and size that the client gave it."""
        for name, argument in bound.items():
            if argument is not None and argument.is_output():
                value = converted(argument.type, values[name])
                place = [given is argument for given in arguments].index(True)
                self.answer.write(self.tokens.return_value(place, name, argument.type, value))

    def wait(self, seconds: float) -> None:
        """The client may cancel meanwhile, or go."""
        if not select.select([self.client], [], [], seconds)[0]:
            return
        message = receive(self.client)
        if message is None:
            self.log("gone")
            raise Ended
        if message[0] == ATTENTION:
            raise Cancelled
        raise ValueError(f"a message of kind {message[0]:#x} during an answer")

    def confirm_attention(self) -> None:
        self.log("attention")
        self.answer.write(self.tokens.done(DONE, CANCELLED))
        self.answer.end()

    def hang_up(self) -> None:
        self.log("hang_up")
        raise Ended
