"""Values on their way between Python and the library."""

from __future__ import annotations

import ctypes
import datetime
import enum
from typing import Any, Callable

from . import _library
from ._library import BOOLEAN, DATE, DOUBLE, EMPTY, INT32, OBJECT, TEXT, VARIANT, Value

ZERO_DATE = datetime.datetime(1899, 12, 30)
_DAY = datetime.timedelta(days=1)


def serial_of(when: datetime.date) -> float:
    """The serial number of a date: days since 30 December 1899; below zero the time counts forward from the day."""
    if not isinstance(when, datetime.datetime):
        when = datetime.datetime(when.year, when.month, when.day)
    if when.tzinfo is not None:
        raise ValueError(f"a date of the message language has no time zone: {when.isoformat()}")
    whole = (when - ZERO_DATE) // _DAY
    fraction = (when - ZERO_DATE - whole * _DAY) / _DAY
    return whole - fraction if whole < 0 else whole + fraction


def date_of(serial: float) -> datetime.datetime:
    """The date of a serial number, to the millisecond: a serial is no more exact than that."""
    whole = int(serial)
    milliseconds = round(abs(serial - whole) * 86_400_000)
    return ZERO_DATE + datetime.timedelta(days=whole, milliseconds=milliseconds)


class Passing:
    """Arguments on their way into the library; keeps alive what they point to."""

    def __init__(self, values: list[tuple[Any, int]]) -> None:
        self._alive: list[Any] = []
        self.values = (Value * max(len(values), 1))(*(self._value(given, kind) for given, kind in values))
        self.count = len(values)

    def _value(self, given: Any, kind: int) -> Value:
        if given is None:
            return Value(EMPTY if kind == VARIANT else OBJECT)
        if isinstance(given, bool):
            return Value(BOOLEAN, integer=given)
        if isinstance(given, str):
            return self._text(given)
        if isinstance(given, (enum.IntEnum, int)):
            return self._integer(int(given))
        if isinstance(given, datetime.date):
            return Value(DATE, number=serial_of(given))
        handle = getattr(given, "_handle", None)
        if handle is not None:
            return Value(OBJECT, record=handle)
        return Value(DOUBLE, number=float(given))

    def _text(self, given: str) -> Value:
        utf8 = given.encode("utf-8", "surrogatepass")
        buffer = ctypes.create_string_buffer(utf8)
        self._alive.append(buffer)
        return Value(TEXT, text=ctypes.cast(buffer, ctypes.POINTER(ctypes.c_char)), length=len(utf8))

    @staticmethod
    def _integer(given: int) -> Value:
        fits = -(2**31) <= given < 2**31
        return Value(INT32, integer=given) if fits else Value(DOUBLE, number=float(given))


def take(value: Value, type_name: str, wrap: Callable[[int], Any], enums: dict[str, Any]) -> Any:
    """A value from the library as Python's; what the library gave is cleared."""
    try:
        if value.kind == TEXT:
            return _library.decode(ctypes.string_at(value.text, value.length))
        if value.kind == DATE:
            return date_of(value.number)
        if value.kind == DOUBLE:
            return value.number
        if value.kind == BOOLEAN:
            return bool(value.integer)
        if value.kind == OBJECT:
            return wrap(value.record) if value.record else None
        if value.kind == EMPTY:
            return None
        return _constant(enums[type_name], value.integer) if type_name in enums else value.integer
    finally:
        _library.library.varnex3_value_clear(ctypes.byref(value))


def _constant(enumeration: Any, number: int) -> int:
    """The constant of a number; the number itself when there is none: any number may be stored."""
    try:
        constant: int = enumeration(number)
        return constant
    except ValueError:
        return number
