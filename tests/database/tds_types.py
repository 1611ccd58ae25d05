"""The data types of SQL Server: how the TDS stream describes them and carries their values."""

from __future__ import annotations

import dataclasses
import re
import struct
import uuid
from datetime import date, datetime, time, timedelta
from decimal import ROUND_HALF_UP, Decimal, InvalidOperation
from typing import Dict, Optional, Tuple

from tds_values import CODECS, FIRST_DATE, MIDNIGHT, Value, moment_of, text_of

TDS_7_0, TDS_7_1, TDS_7_2, TDS_7_3, TDS_7_4 = 0x70, 0x71, 0x72, 0x73, 0x74
MAX = -1  # the size of varchar(max) and its like
LATIN1 = bytes.fromhex("0904d00034")  # SQL_Latin1_General_CP1_CI_AS: varchar is windows-1252
NULL_LENGTH = 0xFFFF
NULL_PLP, UNKNOWN_PLP = 0xFFFF_FFFF_FFFF_FFFF, 0xFFFF_FFFF_FFFF_FFFE
SOME_TEXT_POINTER = b"\x10" + bytes(16 + 8)  # its length, itself, a time stamp
MAX_PLP_CHUNK = 8000


class ConversionFailed(Exception):
    """A value that its declared type does not take."""


class Reader:
    """Takes values off the front of a message."""

    def __init__(self, data: bytes) -> None:
        self.data = data
        self.position = 0

    def take(self, count: int) -> bytes:
        taken = self.data[self.position : self.position + count]
        if len(taken) != count:
            raise ValueError(f"the message ends {count - len(taken)} bytes early")
        self.position += count
        return taken

    def number(self, size: int, signed: bool = False) -> int:
        return int.from_bytes(self.take(size), "little", signed=signed)

    def text(self, characters: int) -> str:
        return self.take(2 * characters).decode("utf-16-le", errors="replace")

    def is_at_end(self) -> bool:
        return self.position >= len(self.data)


def unsigned(value: int, size: int) -> bytes:
    return value.to_bytes(size, "little")


# name: token of the fixed form, token of the nullable form, size
FIXED_SIZE: Dict[str, Tuple[int, int, int]] = {
    "tinyint": (0x30, 0x26, 1),
    "smallint": (0x34, 0x26, 2),
    "int": (0x38, 0x26, 4),
    "bigint": (0x7F, 0x26, 8),
    "bit": (0x32, 0x68, 1),
    "real": (0x3B, 0x6D, 4),
    "float": (0x3E, 0x6D, 8),
    "smallmoney": (0x7A, 0x6E, 4),
    "money": (0x3C, 0x6E, 8),
    "smalldatetime": (0x3A, 0x6F, 4),
    "datetime": (0x3D, 0x6F, 8),
    "uniqueidentifier": (0x00, 0x24, 16),
}
SIZED: Dict[str, int] = {  # the size has two bytes
    "varbinary": 0xA5,
    "varchar": 0xA7,
    "binary": 0xAD,
    "char": 0xAF,
    "nvarchar": 0xE7,
    "nchar": 0xEF,
}
LONG: Dict[str, int] = {"image": 0x22, "text": 0x23, "ntext": 0x63}
EXACT: Dict[str, int] = {"decimal": 0x6A, "numeric": 0x6C}
TEMPORAL: Dict[str, int] = {"date": 0x28, "time": 0x29, "datetime2": 0x2A}  # from TDS 7.3 on
DECLARED_ONLY = {"xml", "sql_variant"}  # parameters have these types, nothing is sent in them

CHARACTER = {"char", "varchar", "text"}
NATIONAL = {"nchar", "nvarchar", "ntext"}
BINARY = {"binary", "varbinary", "image"}

BY_FIXED_TOKEN = {fixed: name for name, (fixed, _, _) in FIXED_SIZE.items() if fixed}
BY_NULLABLE_TOKEN = {(nullable, size): name for name, (_, nullable, size) in FIXED_SIZE.items()}
NULLABLE_TOKENS = {nullable for _, nullable, _ in FIXED_SIZE.values()}
BY_SIZED_TOKEN = {token: name for name, token in SIZED.items()}
BY_LONG_TOKEN = {token: name for name, token in LONG.items()}
BY_EXACT_TOKEN = {token: name for name, token in EXACT.items()}
BY_TEMPORAL_TOKEN = {token: name for name, token in TEMPORAL.items()}


@dataclasses.dataclass(frozen=True)
class SqlType:
    """A type with its size in bytes (MAX: no limit), and precision and scale where it has them."""

    name: str
    size: int
    precision: int = 0
    scale: int = 0

    def declared_size(self) -> int:
        """As a declaration gives it: in characters."""
        return self.size // 2 if self.name in NATIONAL and self.size > 0 else self.size

    # How the stream describes it

    def for_version(self, version: int) -> SqlType:
        """What a server sends to a client that does not know the type yet."""
        if self.name in TEMPORAL and version < TDS_7_3:
            return SqlType("nvarchar", 60)
        if self.size == MAX and version < TDS_7_2:
            return {"varchar": SqlType("text", 0x7FFFFFFF), "nvarchar": SqlType("ntext", 0x7FFFFFFE)}[self.name]
        return self

    def describe(self, version: int) -> bytes:
        collation = LATIN1 if version >= TDS_7_1 and self.name in CHARACTER | NATIONAL else b""
        if self.name in FIXED_SIZE:
            return bytes([FIXED_SIZE[self.name][1], self.size])
        if self.name in EXACT:
            return bytes([EXACT[self.name], 17, self.precision, self.scale])
        if self.name in TEMPORAL:
            return bytes([TEMPORAL[self.name]]) + (b"" if self.name == "date" else bytes([self.scale]))
        if self.name in LONG:
            return bytes([LONG[self.name]]) + unsigned(self.size, 4) + collation
        return bytes([SIZED[self.name]]) + unsigned(self.size & 0xFFFF, 2) + collation

    @staticmethod
    def read(source: Reader, version: int) -> SqlType:
        """The type of a parameter, as a client describes it."""
        token = source.number(1)
        if token in BY_FIXED_TOKEN:
            name = BY_FIXED_TOKEN[token]
            return FixedType(name, FIXED_SIZE[name][2])
        if token in NULLABLE_TOKENS:
            size = source.number(1)
            return SqlType(BY_NULLABLE_TOKEN[token, size], size)
        if token in BY_EXACT_TOKEN:
            size, precision, scale = source.take(3)
            return SqlType(BY_EXACT_TOKEN[token], size, precision, scale)
        if token in BY_TEMPORAL_TOKEN:
            name = BY_TEMPORAL_TOKEN[token]
            return SqlType(name, 0, scale=0 if name == "date" else source.number(1))
        if token in BY_SIZED_TOKEN or token in BY_LONG_TOKEN:
            return SqlType.read_sized(token, source, version)
        raise ValueError(f"no type has the token {token:#x}")

    @staticmethod
    def read_sized(token: int, source: Reader, version: int) -> SqlType:
        name = BY_SIZED_TOKEN.get(token) or BY_LONG_TOKEN[token]
        size = source.number(2 if token in BY_SIZED_TOKEN else 4)
        if token in BY_SIZED_TOKEN and size == 0xFFFF:
            size = MAX
        if version >= TDS_7_1 and name not in BINARY:
            source.take(len(LATIN1))
        return SqlType(name, size)

    # How the stream carries its values

    def encode(self, value: Value, in_row: bool = False) -> bytes:
        """The value with its length before it. A row holds long values with a text pointer, a parameter without."""
        if self.name in LONG:
            pointer = SOME_TEXT_POINTER if in_row else b""
            if value is None:
                return b"\0" if in_row else b"\xff\xff\xff\xff"
            data = self.bytes_of(value)
            return pointer + unsigned(len(data), 4) + data
        if self.name in SIZED:
            return self.encode_unlimited(value) if self.size == MAX else self.encode_sized(value)
        if value is None:
            return b"\0"
        data = self.bytes_of(value)
        return bytes([len(data)]) + data

    def encode_sized(self, value: Value) -> bytes:
        if value is None:
            return unsigned(NULL_LENGTH, 2)
        data = self.bytes_of(value)
        return unsigned(len(data), 2) + data

    def encode_unlimited(self, value: Value) -> bytes:
        if value is None:
            return unsigned(NULL_PLP, 8)
        data = self.bytes_of(value)
        chunks = [data[start : start + MAX_PLP_CHUNK] for start in range(0, len(data), MAX_PLP_CHUNK)]
        return unsigned(len(data), 8) + b"".join(unsigned(len(c), 4) + c for c in chunks) + bytes(4)

    def decode(self, source: Reader) -> Value:
        if self.name in LONG:
            length = source.number(4)
            return None if length == 0xFFFFFFFF else self.value_of(source.take(length))
        if self.name in SIZED and self.size == MAX:
            return self.decode_unlimited(source)
        length = source.number(2 if self.name in SIZED else 1)
        if length == (NULL_LENGTH if self.name in SIZED else 0):
            return None
        return self.value_of(source.take(length))

    def decode_unlimited(self, source: Reader) -> Value:
        if source.number(8) == NULL_PLP:
            return None
        data = b""
        while length := source.number(4):
            data += source.take(length)
        return self.value_of(data)

    def bytes_of(self, value: Value) -> bytes:
        """The value, which must have the type's Python form (see convert), without its length."""
        if self.name in CODECS:
                    return CODECS[self.name][0](value)
        if self.name in NATIONAL:
            return str(value).encode("utf-16-le")
        if self.name in CHARACTER:
            return str(value).encode("cp1252", errors="replace")
        if isinstance(value, Decimal):
            scaled = int(value.scaleb(self.scale))
            return bytes([scaled >= 0]) + abs(scaled).to_bytes(16, "little")
        if isinstance(value, datetime):
            return self.time_bytes(value) + unsigned((value.date() - FIRST_DATE).days, 3)
        if isinstance(value, date):
            return unsigned((value - FIRST_DATE).days, 3)
        if isinstance(value, time):
            return self.time_bytes(datetime.combine(FIRST_DATE, value))
        assert isinstance(value, bytes), f"{value!r} is no {self.name}"
        return value

    def time_bytes(self, moment: datetime) -> bytes:
        passed = moment - datetime.combine(moment.date(), time())
        fractions = (passed.seconds * 10**7 + passed.microseconds * 10) // 10 ** (7 - self.scale)
        return unsigned(fractions, 3 if self.scale < 3 else 4 if self.scale < 5 else 5)

    def value_of(self, data: bytes) -> Value:
        if self.name in CODECS:
            return CODECS[self.name][1](data)
        if self.name in NATIONAL:
            return data.decode("utf-16-le", errors="surrogatepass")
        if self.name in CHARACTER:
            return data.decode("cp1252", errors="replace")
        if self.name in EXACT:
            magnitude = Decimal(int.from_bytes(data[1:], "little")).scaleb(-self.scale)
            return magnitude if data[0] else -magnitude
        if self.name in TEMPORAL:
            return self.temporal_value(data)
        return data

    def temporal_value(self, data: bytes) -> Value:
        if self.name == "date":
            return FIRST_DATE + timedelta(days=int.from_bytes(data, "little"))
        fractions = data if self.name == "time" else data[:-3]
        passed = timedelta(microseconds=int.from_bytes(fractions, "little") * 10 ** (7 - self.scale) // 10)
        if self.name == "time":
            return (MIDNIGHT + passed).time()
        return MIDNIGHT + timedelta(days=int.from_bytes(data[-3:], "little")) + passed

    # How a server converts

    def convert(self, value: Value) -> Value:
        """The value as a variable of this type holds it: texts cut, numbers rounded."""
        if value is None or self.name in DECLARED_ONLY:
            return value
        try:
            return self.convert_present(value)
        except (ValueError, TypeError, OverflowError, InvalidOperation, struct.error) as reason:
            raise ConversionFailed(f"Error converting data type to {self.name}.") from reason

    def convert_present(self, value: Value) -> Value:
        if self.name in CHARACTER | NATIONAL:
            return self.convert_text(text_of(value))
        if self.name in BINARY:
            return value.encode("cp1252") if isinstance(value, str) else value
        if self.name == "uniqueidentifier":
            return value if isinstance(value, uuid.UUID) else uuid.UUID(str(value))
        if self.name in {"date", "time", "datetime", "smalldatetime", "datetime2"}:
            return self.convert_moment(value)
        number = Decimal(str(int(value)) if isinstance(value, bool) else str(value).strip() or "0")
        return self.convert_number(number)

    def convert_text(self, text: str) -> str:
        if self.size == MAX or self.name in LONG:
            return text
        size = self.declared_size()
        return text[:size].ljust(size) if self.name in {"char", "nchar"} else text[:size]

    def convert_number(self, number: Decimal) -> Value:
        if self.name in {"real", "float"}:
            return CODECS[self.name][1](CODECS[self.name][0](float(number)))  # a real loses digits
        if self.name == "bit":
            return number != 0
        if self.name in EXACT or self.name in {"money", "smallmoney"}:
            scale = self.scale if self.name in EXACT else 4
            rounded = number.quantize(Decimal(1).scaleb(-scale), ROUND_HALF_UP)
            if self.name in EXACT and len(rounded.as_tuple().digits) > self.precision and rounded:
                raise OverflowError(rounded)
            return rounded
        self.bytes_of(int(number))  # refuses what is out of range
        return int(number)

    def convert_moment(self, value: Value) -> Value:
        moment = moment_of(value)
        if self.name == "date":
            return moment.date()
        if self.name == "time":
            return moment.time()
        return moment if self.name == "datetime2" else self.value_of(self.bytes_of(moment))


@dataclasses.dataclass(frozen=True)
class FixedType(SqlType):
    """A type in its form without a length, which cannot be null. Only clients use it."""

    def decode(self, source: Reader) -> Value:
        return self.value_of(source.take(self.size))


DECLARATION = re.compile(r"(?P<name>\w+)(?:\((?P<size>max|\d+)(?:,\s*(?P<scale>\d+))?\))?")


def declared(declaration: str) -> SqlType:
    """The type that a declaration such as `decimal(9,2)` or `varchar(max)` names."""
    found = DECLARATION.fullmatch(declaration)
    if found is None:
        raise ValueError(f"no type is declared as {declaration!r}")
    name, size = found["name"], found["size"]
    scale = int(found["scale"] or 0)
    if name in FIXED_SIZE:
        return SqlType(name, FIXED_SIZE[name][2])
    if name in EXACT:
        return SqlType(name, 17, int(size or 18), scale)
    if name in TEMPORAL:
        return SqlType(name, 0, scale=7 if size is None and name != "date" else int(size or 0))
    if name in LONG or name in DECLARED_ONLY:
        return SqlType(name, 0x7FFFFFFF)
    if name in SIZED:
        return SqlType(name, byte_size(name, size))
    raise ValueError(f"there is no type {name!r}")


def byte_size(name: str, size: Optional[str]) -> int:
    if size == "max":
        return MAX
    return int(size or 1) * (2 if name in NATIONAL else 1)
