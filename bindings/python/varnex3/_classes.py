"""Python classes, made from the library's own interface tables: nothing here names a class or a member."""

from __future__ import annotations

import ctypes
import enum
import inspect
from dataclasses import dataclass
from typing import Any, Callable

from . import _library
from ._library import OBJECT, TEXT, Value, check, decode, describe, library
from ._values import Passing, take


@dataclass(frozen=True)
class Parameter:
    name: str
    kind: int
    type_name: str
    is_optional: bool
    initial: str
    is_by_reference: bool
    is_output: bool


@dataclass(frozen=True)
class Member:
    name: str
    doc: str
    is_property: bool
    is_writable: bool
    kind: int
    type_name: str
    parameters: tuple[Parameter, ...]

    @property
    def outputs(self) -> tuple[Parameter, ...]:
        return tuple(parameter for parameter in self.parameters if parameter.is_output)


@dataclass(frozen=True)
class Class:
    name: str
    doc: str
    is_module: bool
    members: tuple[Member, ...]


def _parameter(owner: bytes, member: int, position: int) -> Parameter:
    info = describe("parameter_at", _library.ParameterInfo(), owner, member, position)
    return Parameter(
        decode(info.name),
        info.kind,
        decode(info.type_name),
        bool(info.is_optional),
        decode(info.initial),
        bool(info.is_by_reference),
        bool(info.is_output),
    )


def _member(owner: bytes, position: int) -> Member:
    info = describe("member_at", _library.MemberInfo(), owner, position)
    parameters = tuple(_parameter(owner, position, i) for i in range(info.parameter_count))
    return Member(
        decode(info.name),
        decode(info.doc),
        bool(info.is_property),
        bool(info.is_writable),
        info.kind,
        decode(info.type_name),
        parameters,
    )


def _described(position: int) -> Class:
    info = describe("class_at", _library.ClassInfo(), position)
    members = tuple(_member(info.name, i) for i in range(info.member_count))
    return Class(decode(info.name), decode(info.doc), bool(info.is_module), members)


def _enumeration(position: int) -> type[enum.IntEnum]:
    info = describe("enumeration_at", _library.EnumerationInfo(), position)
    constants = [describe("constant_at", _library.ConstantInfo(), position, i) for i in range(info.constant_count)]
    made = enum.IntEnum(decode(info.name), [(decode(c.name), c.value) for c in constants], module="varnex3")  # type: ignore[misc]
    lines = [f"{decode(c.name)} = {c.value}: {decode(c.doc)}" for c in constants]
    made.__doc__ = "\n".join([decode(info.doc), "", *lines])
    return made


CLASSES: dict[str, Class] = {info.name: info for info in map(_described, range(library.varnex3_class_count()))}
ENUMERATIONS: dict[str, type[enum.IntEnum]] = {
    made.__name__: made for made in map(_enumeration, range(library.varnex3_enumeration_count()))
}


class Record:
    """A record of the library. Its properties and methods have the names they have everywhere."""

    __slots__ = ("_handle", "__weakref__")
    _handle: int

    def __init__(self) -> None:
        handle = ctypes.c_void_p()
        check(library.varnex3_create(type(self).__name__.encode(), ctypes.byref(handle)))
        self._handle = handle.value or 0

    def __del__(self) -> None:
        handle = getattr(self, "_handle", 0)
        if handle and library is not None:  # the module may be gone when the interpreter ends
            library.varnex3_release(handle)

    def __eq__(self, other: object) -> bool:
        return isinstance(other, Record) and self._handle == other._handle

    def __hash__(self) -> int:
        return hash(self._handle)

    def __repr__(self) -> str:
        return f"<varnex3.{type(self).__name__} {self.ToJson()}>"

    def put(self, name: str, *indexes_and_value: Any) -> None:
        """Stores a property, indexed or not: put("Values", "Phone", "03 9555 0100"), put("OrgType", "REP")."""
        member = next((m for m in CLASSES[type(self).__name__].members if m.name == name), None)
        kinds = [parameter.kind for parameter in member.parameters] + [member.kind] if member else []
        kinds += [TEXT] * (len(indexes_and_value) - len(kinds))
        passing = Passing(list(zip(indexes_and_value, kinds)))
        if not passing.count:
            raise TypeError("put() needs a value")
        *_, last = passing.values[: passing.count]
        check(
            library.varnex3_put_indexed(
                self._handle, name.encode(), passing.values, passing.count - 1, ctypes.byref(last)
            )
        )

    def ToJson(self) -> str:
        """The record as JSON: its properties in interface order, children included."""
        result = Value()
        check(library.varnex3_to_json(self._handle, ctypes.byref(result)))
        json: str = take(result, "", wrap, ENUMERATIONS)
        return json


def wrap(handle: int) -> Record:
    """A record that the library gave, with a reference of its own."""
    library.varnex3_add_ref(handle)
    made = object.__new__(RECORDS[decode(library.varnex3_class_of(handle))])
    made._handle = handle
    return made


def _signature(member: Member, first: tuple[str, ...]) -> inspect.Signature:
    """How the method is called from Python: arguments that only bring results back may be left out."""
    kind = inspect.Parameter.POSITIONAL_OR_KEYWORD
    parameters = [inspect.Parameter(name, kind) for name in first]
    for parameter in member.parameters:
        default = _default(parameter) if parameter.is_optional or parameter.is_output else inspect.Parameter.empty
        parameters.append(inspect.Parameter(parameter.name, kind, default=default))
    return inspect.Signature(parameters)


def _default(parameter: Parameter) -> Any:
    return parameter.initial if parameter.kind == TEXT else 0


Invoke = Callable[[Passing, Value], Any]


def _called(member: Member, bound: inspect.BoundArguments, first: tuple[str, ...], invoke: Invoke) -> Any:
    """The result of a call, followed by what came back in its arguments."""
    bound.apply_defaults()
    given = [bound.arguments[parameter.name] for parameter in member.parameters]
    passing = Passing([(value, parameter.kind) for value, parameter in zip(given, member.parameters)])
    result = Value()
    check(invoke(passing, result))
    outputs = [
        take(passing.values[i], parameter.type_name, wrap, ENUMERATIONS)
        for i, parameter in enumerate(member.parameters)
        if parameter.is_output
    ]
    returned = take(result, member.type_name, wrap, ENUMERATIONS)
    return (returned, *outputs) if outputs else returned


def _method(member: Member) -> Callable[..., Any]:
    name, first = member.name.encode(), ("self",)
    signature = _signature(member, first)
    function = library.varnex3_get_indexed if member.is_property else library.varnex3_call

    def method(*args: Any, **named: Any) -> Any:
        bound = signature.bind(*args, **named)
        handle = bound.arguments["self"]._handle
        return _called(
            member,
            bound,
            first,
            lambda passing, result: function(handle, name, passing.values, passing.count, ctypes.byref(result)),
        )

    return _documented(method, member, signature)


def _function(module: Class, member: Member) -> Callable[..., Any]:
    owner, name = module.name.encode(), member.name.encode()
    signature = _signature(member, ())

    def function(*args: Any, **named: Any) -> Any:
        return _called(
            member,
            signature.bind(*args, **named),
            (),
            lambda passing, result: library.varnex3_call_function(
                owner, name, passing.values, passing.count, ctypes.byref(result)
            ),
        )

    return _documented(function, member, signature)


def _documented(function: Any, member: Member, signature: inspect.Signature) -> Callable[..., Any]:
    function.__name__ = function.__qualname__ = member.name
    function.__doc__ = member.doc
    function.__signature__ = signature
    made: Callable[..., Any] = function
    return made


def _property(member: Member) -> property:
    name = member.name.encode()

    def get(self: Record) -> Any:
        result = Value()
        check(library.varnex3_get_indexed(self._handle, name, None, 0, ctypes.byref(result)))
        return take(result, member.type_name, wrap, ENUMERATIONS)

    def put(self: Record, value: Any) -> None:
        passing = Passing([(value, member.kind)])
        check(library.varnex3_put_indexed(self._handle, name, None, 0, passing.values))

    return property(get, put if member.is_writable else None, doc=member.doc)


def _made(info: Class) -> type[Record]:
    body: dict[str, Any] = {"__slots__": (), "__doc__": info.doc, "__module__": "varnex3"}
    for member in info.members:
        is_attribute = member.is_property and not member.parameters
        body[member.name] = _property(member) if is_attribute else _method(member)
    return type(info.name, (Record,), body)


def _module(info: Class) -> type:
    body: dict[str, Any] = {"__doc__": info.doc, "__module__": "varnex3"}
    body |= {member.name: staticmethod(_function(info, member)) for member in info.members}
    return type(info.name, (), body)


RECORDS: dict[str, type[Record]] = {name: _made(info) for name, info in CLASSES.items() if not info.is_module}
MODULES: dict[str, type] = {name: _module(info) for name, info in CLASSES.items() if info.is_module}
