#!/usr/bin/env python3
"""Runs the rules of this folder's JSON files through the Python package.

    PYTHONPATH=build/python tests/rules/run_rules.py tests/rules              all files
    PYTHONPATH=build/python tests/rules/run_rules.py tests/rules SourceDef    the files whose name begins so

README.md describes the files.
"""

from __future__ import annotations

import base64
import json
import pathlib
import re
import sys
import tempfile
from datetime import datetime
from typing import Any, Callable

import varnex3

KINDS = ("nothing", "text", "double", "date", "16-bit integer", "32-bit integer", "Boolean", "object", "enumeration",
         "variant")
ABSENT = ({"nothing": True}, None)  # both are None here


class Failure(Exception):
    pass


def shown(value: Any) -> str:
    return json.dumps(value, ensure_ascii=False)


# ---------------------------------------------------------------- a value as JSON


def to_json(value: Any) -> Any:
    if isinstance(value, datetime):
        return {"date": value.isoformat(timespec="seconds")}
    if isinstance(value, varnex3.Record):
        return {"object": type(value).__name__}
    return value


def equal(expected: Any, got: Any) -> bool:
    if got is None:
        return expected in ABSENT
    return expected == got and isinstance(expected, bool) == isinstance(got, bool)


# ---------------------------------------------------------------- an interface in words


def type_words(kind: int, type_name: str) -> str:
    return type_name or KINDS[kind]


def parameter_words(parameter: Any) -> str:
    words = f"{parameter.name}: {type_words(parameter.kind, parameter.type_name)}"
    words = f"out {words}" if parameter.is_output else words
    return f"[{words}]" if parameter.is_optional else words


def member_words(member: Any) -> str:
    words = member.name
    if not member.is_property or member.parameters:
        words += f"({', '.join(map(parameter_words, member.parameters))})"
    if member.kind:
        words += f": {type_words(member.kind, member.type_name)}"
    return words if not member.is_property or member.is_writable else words + " (read-only)"


# ---------------------------------------------------------------- one rule


class Rule:
    def __init__(self, messages: pathlib.Path) -> None:
        self.messages = messages
        self.objects: dict[str, Any] = {}
        self.folders: dict[str, tempfile.TemporaryDirectory[str]] = {}
        self.turn = ""
        self.has_checked = False

    def close(self) -> None:
        for folder in self.folders.values():
            folder.cleanup()

    def do(self, step: list[Any]) -> None:
        verb: Callable[..., None] | None = getattr(self, "do_" + step[0], None)
        if verb is None:
            raise Failure(f"no verb {shown(step[0])}")
        verb(*step[1:])

    def filled(self, text: str) -> str:
        """The text with ${i} and the paths of the rule's folders filled in."""
        text = text.replace("${i}", self.turn)
        for name, folder in self.folders.items():
            text = text.replace("${" + name + "}", folder.name)
        return text

    def plain_text(self, value: Any) -> str:
        """A text, given as it is, as lines that each end with CR LF, or as a golden file."""
        if isinstance(value, str):
            return self.filled(value)
        if "file" in value:
            return (self.messages / value["file"]).read_bytes().decode()
        return "".join(self.filled(line) + "\r\n" for line in value["lines"])

    def argument(self, value: Any) -> Any:
        if not isinstance(value, (str, dict)):
            return value
        if "date" in value and isinstance(value, dict):
            return datetime.fromisoformat(value["date"])
        if "nothing" in value and isinstance(value, dict):
            return None
        if "object" in value and isinstance(value, dict):
            return self.objects[value["object"]]
        return self.plain_text(value)

    def arguments(self, values: list[Any]) -> list[Any]:
        return [self.argument(value) for value in values]

    def compare(self, expected: Any, got: Any) -> None:
        self.has_checked = True
        if isinstance(expected, dict) and "like" in expected:
            pattern = re.escape(self.filled(expected["like"])).replace(r"\*", ".*")
            if not isinstance(got, str) or not re.fullmatch(pattern, got, re.DOTALL):
                raise Failure(f"expected {shown(expected)}, got {shown(got)}")
            return
        is_text = isinstance(expected, str) or (isinstance(expected, dict) and {"lines", "file"} & expected.keys())
        wanted = self.plain_text(expected) if is_text else expected
        if not equal(wanted, got):
            raise Failure(f"expected {shown(wanted)}, got {shown(got)}")

    # ---- calls: the results and what is expected of them

    def results(self, step: list[Any]) -> tuple[list[Any], list[Any]]:
        verb, owner, name, *rest = step
        if verb == "get":
            return [getattr(self.objects[owner], name)], rest
        if verb not in ("getAt", "call", "function"):
            raise Failure(f"{shown(verb)} does not call")
        holder = getattr(varnex3, owner) if verb == "function" else self.objects[owner]
        result = getattr(holder, name)(*self.arguments(rest[0]))
        return list(result) if isinstance(result, tuple) else [result], rest[1:]

    def call_and_compare(self, step: list[Any]) -> None:
        results, expected = self.results(step)
        if len(expected) > len(results):
            raise Failure(f"no result for {shown(expected[len(results)])}")
        for wanted, got in zip(expected, results):
            self.compare(wanted, to_json(got))

    def do_get(self, *step: Any) -> None:
        self.call_and_compare(["get", *step])

    def do_getAt(self, *step: Any) -> None:
        self.call_and_compare(["getAt", *step])

    def do_call(self, *step: Any) -> None:
        self.call_and_compare(["call", *step])

    def do_function(self, *step: Any) -> None:
        self.call_and_compare(["function", *step])

    def do_keep(self, name: str, step: list[Any]) -> None:
        got = self.results(step)[0][0]
        if not isinstance(got, varnex3.Record):
            raise Failure(f"expected an object, got {shown(to_json(got))}")
        self.objects[name] = got

    def do_nothing(self, step: list[Any]) -> None:
        self.compare({"nothing": True}, to_json(self.results(step)[0][0]))

    # ---- the other verbs

    def do_new(self, name: str, class_name: str) -> None:
        self.objects[name] = getattr(varnex3, class_name)()

    def do_put(self, name: str, member: str, value: Any) -> None:
        setattr(self.objects[name], member, self.argument(value))

    def do_putAt(self, name: str, member: str, indexes: list[Any], value: Any) -> None:
        self.objects[name].put(member, *self.arguments(indexes), self.argument(value))

    def do_raises(self, number: int, source: str, *words_and_step: Any) -> None:
        self.has_checked = True
        *words, step = words_and_step
        try:
            self.do(step)
        except varnex3.Error as error:
            if (error.number, error.source) != (number, source):
                raise Failure(f"expected error {number} from {source}, got {error.number} from {error.source}: "
                              f"{shown(error.description)}") from None
            if words and self.filled(words[0]) not in error.description:
                raise Failure(f"expected the description to say {shown(words[0])}, "
                              f"got {shown(error.description)}") from None
            return
        raise Failure(f"expected error {number} from {source}, got none")

    def do_same(self, first: str, second: str) -> None:
        self.has_checked = True
        if self.objects[first] != self.objects[second]:
            raise Failure("expected one object, got two")

    def do_members(self, class_name: str, expected: list[str]) -> None:
        self.compare(expected, [member_words(member) for member in varnex3.CLASSES[class_name].members])

    def do_repeat(self, count: int, step: list[Any]) -> None:
        for i in range(count):
            self.turn = str(i)
            self.do(step)

    def do_folder(self, name: str, files: dict[str, Any]) -> None:
        self.folders[name] = tempfile.TemporaryDirectory(prefix="varnex3-rule-")
        for file_name, content in files.items():
            path = pathlib.Path(self.folders[name].name, file_name)
            path.parent.mkdir(parents=True, exist_ok=True)
            if content is None:
                path.mkdir()
            elif isinstance(content, dict) and "base64" in content:
                path.write_bytes(base64.b64decode(content["base64"]))
            else:
                path.write_bytes(self.plain_text(content).encode())

    def do_content(self, path: str, expected: Any) -> None:
        self.compare(expected, pathlib.Path(self.filled(path)).read_bytes().decode())

    def do_absent(self, path: str) -> None:
        self.has_checked = True
        if pathlib.Path(self.filled(path)).exists():
            raise Failure(f"expected no file {self.filled(path)}")


def fault_of(vector: dict[str, Any], messages: pathlib.Path) -> str:
    """What is wrong with a rule; nothing when it holds."""
    rule = Rule(messages)
    step: Any = vector["rule"]
    try:
        for step in vector["steps"]:
            rule.do(step)
        return "" if rule.has_checked else "checks nothing"
    except Exception as error:
        name = "" if isinstance(error, Failure) else type(error).__name__ + ": "
        return f"{shown(step)}: {name}{error}"
    finally:
        rule.close()


def main(arguments: list[str]) -> int:
    if not arguments:
        print("usage: run_rules.py FOLDER [NAME...]", file=sys.stderr)
        return 2
    folder, names = pathlib.Path(arguments[0]), tuple(arguments[1:])
    passed = failed = 0
    for file in sorted(folder.glob("*.json")):
        if names and not file.name.startswith(names):
            continue
        for vector in json.loads(file.read_text(encoding="utf-8")):
            fault = fault_of(vector, folder.parent / "messages")
            if fault:
                failed += 1
                print(f"{file.name}: {vector['rule']}: {fault}")
            else:
                passed += 1
    print(f"{passed} passed, {failed} failed")
    return 0 if passed and not failed else 1


if __name__ == "__main__":
    sys.exit(main(sys.argv[1:]))
