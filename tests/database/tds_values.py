"""Values between Python and the TDS stream, and between one another as a server converts them."""

from __future__ import annotations

import struct
import uuid
from datetime import date, datetime, time, timedelta
from decimal import Decimal
from typing import Any, Callable, Dict, Tuple, Union

Value = Union[None, bool, int, float, str, bytes, Decimal, date, time, datetime, uuid.UUID]
Codec = Tuple[Callable[[Any], bytes], Callable[[bytes], Value]]

FIRST_DATETIME = datetime(1900, 1, 1)
FIRST_DATE = date(1, 1, 1)
TICKS_A_DAY = 24 * 60 * 60 * 300
MIDNIGHT = datetime(1, 1, 1)


def to_ticks(moment: datetime) -> bytes:
    """A datetime: days, and three-hundredths of a second, to which it is rounded."""
    passed = moment - FIRST_DATETIME
    ticks = round((passed.seconds * 1_000_000 + passed.microseconds) * 3 / 10_000)
    next_day, ticks = divmod(ticks, TICKS_A_DAY)
    return struct.pack("<iI", passed.days + next_day, ticks)


def from_ticks(data: bytes) -> datetime:
    days, ticks = struct.unpack("<iI", data)
    return FIRST_DATETIME + timedelta(days=days, milliseconds=round(ticks * 10 / 3))


def to_minutes(moment: datetime) -> bytes:
    passed = moment - FIRST_DATETIME
    return struct.pack("<HH", passed.days, passed.seconds // 60)


def from_minutes(data: bytes) -> datetime:
    days, minutes = struct.unpack("<HH", data)
    return FIRST_DATETIME + timedelta(days=days, minutes=minutes)


def to_money(amount: Decimal) -> bytes:
    high, low = divmod(int(amount * 10_000), 1 << 32)
    return struct.pack("<iI", high, low)


def from_money(data: bytes) -> Decimal:
    high, low = struct.unpack("<iI", data)
    return Decimal((high << 32) + low) / 10_000


def packed(form: str) -> Codec:
    def unpack(data: bytes) -> Value:
        value: float = struct.unpack(form, data)[0]
        return value

    return lambda value: struct.pack(form, value), unpack


def whole(size: int, signed: bool = True) -> Codec:
    return (
        lambda value: int(value).to_bytes(size, "little", signed=signed),
        lambda data: int.from_bytes(data, "little", signed=signed),
    )


CODECS: Dict[str, Codec] = {
    "tinyint": whole(1, signed=False),
    "smallint": whole(2),
    "int": whole(4),
    "bigint": whole(8),
    "bit": (lambda value: bytes([bool(value)]), lambda data: data != b"\0"),
    "real": packed("<f"),
    "float": packed("<d"),
    "smallmoney": (
        lambda value: struct.pack("<i", int(value * 10_000)),
        lambda data: Decimal(struct.unpack("<i", data)[0]) / 10_000,
    ),
    "money": (to_money, from_money),
    "smalldatetime": (to_minutes, from_minutes),
    "datetime": (to_ticks, from_ticks),
    "uniqueidentifier": (lambda value: bytes(value.bytes_le), lambda data: uuid.UUID(bytes_le=data)),
}


def text_of(value: Value) -> str:
    """A value as the server turns it into text."""
    if isinstance(value, bool):
        return "1" if value else "0"
    if isinstance(value, bytes):
        return value.decode("cp1252", errors="replace")
    return f"{value:g}" if isinstance(value, float) else str(value)


def moment_of(value: Value) -> datetime:
    if isinstance(value, datetime):
        return value
    if isinstance(value, date):
        return datetime.combine(value, time())
    if isinstance(value, time):
        return datetime.combine(FIRST_DATETIME.date(), value)
    return datetime.fromisoformat(str(value).strip())
