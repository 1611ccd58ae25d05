"""The messages of the TDS protocol, 7.0 to 7.4, as a server reads and writes them: no encryption, no transactions."""

from __future__ import annotations

import dataclasses
import socket
import struct
from typing import Iterator, List, Optional, Sequence, Tuple

from tds_types import LATIN1, LONG, TDS_7_0, TDS_7_1, TDS_7_2, Reader, SqlType, unsigned
from tds_values import Value

SQL_BATCH, RPC, RESPONSE, ATTENTION, TRANSACTION, LOGIN, PRELOGIN = 0x01, 0x03, 0x04, 0x06, 0x0E, 0x10, 0x12
END_OF_MESSAGE = 1
HEADER_SIZE = 8
LONGEST_MESSAGE = 64 * 1024 * 1024

FINAL, MORE, FAILED, HAS_COUNT, CANCELLED = 0x00, 0x01, 0x02, 0x10, 0x20  # what a DONE says
DONE, DONE_IN_PROCEDURE, DONE_PROCEDURE = 0xFD, 0xFF, 0xFE

BY_REFERENCE, DEFAULT_VALUE = 0x01, 0x02  # what a parameter's status says
NUMBERED_PROCEDURES = {10: "sp_executesql", 11: "sp_prepare", 12: "sp_execute", 13: "sp_prepexec", 15: "sp_unprepare"}

VERSION_NAMES = {0x70: "7.0", 0x71: "7.1", 0x72: "7.2", 0x73: "7.3", 0x74: "7.4"}
ACKNOWLEDGED = {TDS_7_0: 0x07000000, TDS_7_1: 0x71000001}  # newer clients get back what they sent
SERVER_NAME = "TESTSERVER"
PROGRAM = "Microsoft SQL Server"
PROGRAM_VERSION = bytes([15, 0, 0x07, 0xD0])


# Messages in packets


def receive_exactly(client: socket.socket, count: int) -> bytes:
    """So many bytes, or fewer at the end of the connection."""
    data = b""
    while len(data) < count:
        part = client.recv(count - len(data))
        if not part:
            break
        data += part
    return data


def receive(client: socket.socket) -> Optional[Tuple[int, bytes]]:
    """The kind and the body of the next message; nothing when the client has gone."""
    body = b""
    while len(body) < LONGEST_MESSAGE:
        header = receive_exactly(client, HEADER_SIZE)
        if len(header) < HEADER_SIZE:
            return None
        kind, status, length = struct.unpack(">BBH", header[:4])
        body += receive_exactly(client, length - HEADER_SIZE)
        if status & END_OF_MESSAGE:
            return kind, body
    raise ValueError("a message without end")


class Answer:
    """One message to the client, sent as its packets fill."""

    def __init__(self, client: socket.socket, packet_size: int) -> None:
        self.client = client
        self.room = packet_size - HEADER_SIZE
        self.pending = b""
        self.packets = 0

    def write(self, token: bytes) -> None:
        self.pending += token
        while len(self.pending) > self.room:
            self.send(self.pending[: self.room], 0)
            self.pending = self.pending[self.room :]

    def flush(self) -> None:
        """Sends what there is and keeps the message open."""
        if self.pending:
            self.send(self.pending, 0)
            self.pending = b""

    def end(self) -> None:
        self.send(self.pending, END_OF_MESSAGE)
        self.pending = b""

    def send(self, body: bytes, status: int) -> None:
        self.packets += 1
        header = struct.pack(">BBHHBB", RESPONSE, status, len(body) + HEADER_SIZE, 0, self.packets & 0xFF, 0)
        self.client.sendall(header + body)


# What a client sends


def prelogin_answer() -> bytes:
    """Version, no encryption, the instance is right, no thread, one result at a time."""
    options = [(0, PROGRAM_VERSION + bytes(2)), (1, b"\x02"), (2, b"\0"), (3, b""), (4, b"\0")]
    offset = 5 * len(options) + 1
    directory, values = b"", b""
    for number, value in options:
        directory += struct.pack(">BHH", number, offset + len(values), len(value))
        values += value
    return directory + b"\xff" + values


@dataclasses.dataclass(frozen=True)
class Login:
    version: int  # of the protocol: one of TDS_7_0 to TDS_7_4
    full_version: int
    packet_size: int
    computer: str
    user: str
    password: str
    application: str
    server: str
    library: str
    database: str


def unveiled(data: bytes) -> str:
    """A password, which a client sends with its half-bytes swapped and 0xA5 mixed in."""
    mixed = (byte ^ 0xA5 for byte in data)
    return bytes((byte << 4 & 0xF0) | byte >> 4 for byte in mixed).decode("utf-16-le", errors="replace")


def read_login(body: bytes) -> Login:
    full_version, packet_size = struct.unpack_from("<II", body, 4)

    def field(number: int) -> bytes:
        offset, characters = struct.unpack_from("<HH", body, 36 + 4 * number)
        return body[offset : offset + 2 * characters]

    def text(number: int) -> str:
        return field(number).decode("utf-16-le", errors="replace")

    version = full_version >> 24
    if version not in VERSION_NAMES:
        raise ValueError(f"no TDS version is {full_version:#x}")
    return Login(
        version=version,
        full_version=full_version,
        packet_size=min(max(packet_size, 512), 32767),
        computer=text(0),
        user=text(1),
        password=unveiled(field(2)),
        application=text(3),
        server=text(4),
        library=text(6),
        database=text(8),
    )


def without_headers(body: bytes, version: int) -> Reader:
    source = Reader(body)
    if version >= TDS_7_2:
        source.take(source.number(4) - 4)
    return source


def read_batch(body: bytes, version: int) -> str:
    source = without_headers(body, version)
    return source.take(len(body) - source.position).decode("utf-16-le", errors="replace")


@dataclasses.dataclass(frozen=True)
class Argument:
    """A parameter of a call as it came over the wire."""

    name: str
    status: int
    type: SqlType
    value: Value

    def is_output(self) -> bool:
        return bool(self.status & BY_REFERENCE)

    def is_default(self) -> bool:
        return bool(self.status & DEFAULT_VALUE)


@dataclasses.dataclass(frozen=True)
class Call:
    procedure: str
    arguments: Sequence[Argument]


def read_calls(body: bytes, version: int) -> Iterator[Call]:
    """The calls of one message; clients may send several at once."""
    source = without_headers(body, version)
    separator = 0xFF if version >= TDS_7_2 else 0x80
    while not source.is_at_end():
        length = source.number(2)
        if length == 0xFFFF:
            number = source.number(2)
            procedure = NUMBERED_PROCEDURES.get(number, f"procedure {number}")
        else:
            procedure = source.text(length)
        source.take(2)  # options: compile again, send no column descriptions
        arguments: List[Argument] = []
        while not source.is_at_end():
            name_length = source.number(1)
            if name_length == separator:
                break
            name, status = source.text(name_length), source.number(1)
            type_ = SqlType.read(source, version)
            arguments.append(Argument(name, status, type_, type_.decode(source)))
        yield Call(procedure, arguments)


# What a server answers


def short_text(text: str) -> bytes:
    return bytes([len(text.encode("utf-16-le")) // 2]) + text.encode("utf-16-le")


def long_text(text: str) -> bytes:
    return unsigned(len(text.encode("utf-16-le")) // 2, 2) + text.encode("utf-16-le")


def sized(token: int, body: bytes) -> bytes:
    return bytes([token]) + unsigned(len(body), 2) + body


class Tokens:
    """The pieces of an answer, in the form of one version of the protocol."""

    def __init__(self, version: int) -> None:
        self.version = version

    def login_accepted(self, login: Login) -> bytes:
        version = ACKNOWLEDGED.get(login.version, login.full_version)
        acknowledged = b"\x01" + version.to_bytes(4, "big") + short_text(PROGRAM) + PROGRAM_VERSION
        size = str(login.packet_size)
        return (
            sized(0xE3, b"\x01" + short_text(login.database or "master") + short_text("master"))
            + (sized(0xE3, b"\x07" + bytes([len(LATIN1)]) + LATIN1 + b"\0") if self.version >= TDS_7_1 else b"")
            + sized(0xE3, b"\x02" + short_text("us_english") + short_text(""))
            + sized(0xAD, acknowledged)
            + sized(0xE3, b"\x04" + short_text(size) + short_text("4096"))
            + self.done(DONE, FINAL)
        )

    def message(self, number: int, text: str, severity: int, procedure: str) -> bytes:
        """An error, or with a severity of 10 and below a message for information."""
        line = unsigned(1, 4 if self.version >= TDS_7_2 else 2)
        body = unsigned(number, 4) + bytes([1, severity]) + long_text(text) + short_text(SERVER_NAME)
        return sized(0xAA if severity > 10 else 0xAB, body + short_text(procedure) + line)

    def columns(self, columns: Sequence[Tuple[str, SqlType]]) -> bytes:
        described = b""
        for name, type_ in columns:
            sent = type_.for_version(self.version)
            table = unsigned(0, 2) if sent.name in LONG else b""
            described += self.user_type() + unsigned(1, 2) + sent.describe(self.version) + table + short_text(name)
        return b"\x81" + unsigned(len(columns), 2) + described

    def row(self, types: Sequence[SqlType], values: Sequence[Value]) -> bytes:
        sent = [(type_.for_version(self.version), type_.convert(value)) for type_, value in zip(types, values)]
        return b"\xd1" + b"".join(type_.encode(value, in_row=True) for type_, value in sent)

    def return_status(self, status: int) -> bytes:
        return b"\x79" + status.to_bytes(4, "little", signed=True)

    def return_value(self, position: int, name: str, type_: SqlType, value: Value) -> bytes:
        described = self.user_type() + unsigned(0, 2) + type_.describe(self.version)
        return b"\xac" + unsigned(position, 2) + short_text(name) + b"\x01" + described + type_.encode(value)

    def done(self, token: int, status: int, count: int = 0) -> bytes:
        counted = unsigned(count, 8 if self.version >= TDS_7_2 else 4)
        return bytes([token]) + unsigned(status, 2) + unsigned(0, 2) + counted

    def user_type(self) -> bytes:
        return bytes(4 if self.version >= TDS_7_2 else 2)
