"""The C face of the library, as ctypes sees it."""

from __future__ import annotations

import ctypes
import os
import pathlib
import sys
from ctypes import POINTER, byref, c_char, c_char_p, c_double, c_int32, c_size_t, c_void_p
from typing import Any

EMPTY, TEXT, DOUBLE, DATE, INT16, INT32, BOOLEAN, OBJECT, ENUM, VARIANT = range(10)


class Value(ctypes.Structure):
    _fields_ = [
        ("kind", c_int32),
        ("integer", c_int32),
        ("number", c_double),
        ("text", POINTER(c_char)),
        ("length", c_size_t),
        ("record", c_void_p),
    ]


class ClassInfo(ctypes.Structure):
    _fields_ = [("name", c_char_p), ("doc", c_char_p), ("is_module", c_int32), ("member_count", c_int32)]


class MemberInfo(ctypes.Structure):
    _fields_ = [
        ("name", c_char_p),
        ("doc", c_char_p),
        ("is_property", c_int32),
        ("is_writable", c_int32),
        ("kind", c_int32),
        ("type_name", c_char_p),
        ("parameter_count", c_int32),
    ]


class ParameterInfo(ctypes.Structure):
    _fields_ = [
        ("name", c_char_p),
        ("kind", c_int32),
        ("type_name", c_char_p),
        ("is_optional", c_int32),
        ("initial", c_char_p),
        ("is_by_reference", c_int32),
        ("is_output", c_int32),
    ]


class EnumerationInfo(ctypes.Structure):
    _fields_ = [("name", c_char_p), ("doc", c_char_p), ("constant_count", c_int32)]


class ConstantInfo(ctypes.Structure):
    _fields_ = [("name", c_char_p), ("doc", c_char_p), ("value", c_int32)]


class Error(Exception):
    """What the library raises: its number, the class and operation it comes from, and a description.

    Numbers below 30000 are the classic automation numbers (13 type mismatch, 457 duplicate key), those from 30000 on
    the library's own.
    """

    def __init__(self, number: int, source: str, description: str) -> None:
        super().__init__(f"{source}: {description} ({number})")
        self.number = number
        self.source = source
        self.description = description

    def __reduce__(self) -> tuple[Any, ...]:
        return type(self), (self.number, self.source, self.description)


def _load() -> ctypes.CDLL:
    """The shared library: the one VARNEX3_LIBRARY names, the one beside this file, or the system's."""
    name, installed = "libvarnex3_c.so", "libvarnex3_c.so.3"
    if sys.platform == "win32":
        name = installed = "Varnex3.dll"  # the component has the C face, too
    beside = pathlib.Path(__file__).with_name(name)
    return ctypes.CDLL(os.environ.get("VARNEX3_LIBRARY") or (str(beside) if beside.exists() else installed))


def _declare(library: ctypes.CDLL) -> None:
    value, record = POINTER(Value), c_void_p
    for name, result, arguments in (
        ("version", c_char_p, []),
        ("class_count", c_int32, []),
        ("class_at", c_int32, [c_int32, POINTER(ClassInfo)]),
        ("member_at", c_int32, [c_char_p, c_int32, POINTER(MemberInfo)]),
        ("parameter_at", c_int32, [c_char_p, c_int32, c_int32, POINTER(ParameterInfo)]),
        ("enumeration_count", c_int32, []),
        ("enumeration_at", c_int32, [c_int32, POINTER(EnumerationInfo)]),
        ("constant_at", c_int32, [c_int32, c_int32, POINTER(ConstantInfo)]),
        ("create", c_int32, [c_char_p, POINTER(record)]),
        ("add_ref", None, [record]),
        ("release", None, [record]),
        ("class_of", c_char_p, [record]),
        ("get_indexed", c_int32, [record, c_char_p, value, c_int32, value]),
        ("put_indexed", c_int32, [record, c_char_p, value, c_int32, value]),
        ("call", c_int32, [record, c_char_p, value, c_int32, value]),
        ("call_function", c_int32, [c_char_p, c_char_p, value, c_int32, value]),
        ("to_json", c_int32, [record, value]),
        ("value_clear", None, [value]),
        ("error_source", c_char_p, []),
        ("error_description", c_char_p, []),
    ):
        function = getattr(library, "varnex3_" + name)
        function.restype, function.argtypes = result, arguments


library = _load()
_declare(library)


def check(number: int) -> None:
    """Raises the library's last error when a call did not return 0."""
    if number:
        source, description = library.varnex3_error_source(), library.varnex3_error_description()
        raise Error(number, decode(source), decode(description))


def decode(utf8: bytes | None) -> str:
    """Text from the library: a lone surrogate stays one."""
    return (utf8 or b"").decode("utf-8", "surrogatepass")


def describe(function: str, info: Any, *where: Any) -> Any:
    """Fills a description by one of the functions that tell what there is."""
    check(getattr(library, "varnex3_" + function)(*where, byref(info)))
    return info
