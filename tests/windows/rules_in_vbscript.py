#!/usr/bin/env python3
"""Runs the rules of classes through the component, from VBScript: rules_in_vbscript.py BUILD [NAME...].

    tests/windows/rules_in_vbscript.py build/win32              all files of tests/rules
    tests/windows/rules_in_vbscript.py build/win32 SourceDef    the files whose name begins so

Each file becomes a script, a procedure for each rule. It makes the calls and notes what every step gave: the values with
their types, or the error. What is expected is compared here. An interface is read from the type library, which scripts
cannot see.

Prints a line for each rule that does not hold or that a script cannot show, and ends with "N passed, N failed".
"""

from __future__ import annotations

import base64
import json
import pathlib
import re
import sys
import tempfile
from dataclasses import dataclass
from datetime import datetime, timedelta
from typing import Any, Callable

from component import SOURCE, Component, windows_path

# The library of every script. Chr(30) ends a record, Chr(31) a field; texts that are no plain ASCII stand in files,
# because a script cannot: it has no more than one byte a character.
LIBRARY = """Option Explicit
Dim files, notes, noted
Set files = CreateObject("Scripting.FileSystemObject")
Set notes = files.CreateTextFile("notes.txt", True, True)

Function TextIn(name)
    Dim file
    Set file = files.OpenTextFile(name, 1, False, -1)
    TextIn = file.ReadAll
    file.Close
End Function

Sub Note(ByVal value)
    If Not IsObject(value) Then
        noted = noted & Chr(31) & VarType(value) & Chr(31)
        If VarType(value) = 7 Then value = CDbl(value)
        noted = noted & value
    ElseIf value Is Nothing Then
        noted = noted & Chr(31) & "nothing" & Chr(31)
    Else
        noted = noted & Chr(31) & "object" & Chr(31) & TypeName(value)
    End If
End Sub

Sub Done(rule, number)
    notes.Write rule & Chr(31) & number & Chr(31)
    If Err.Number = 0 Then
        notes.Write "gives" & noted
    Else
        notes.Write "raises" & Chr(31) & Err.Number & Chr(31) & Err.Source & Chr(31) & Err.Description
    End If
    notes.Write Chr(30)
    Err.Clear
    noted = ""
End Sub
"""

TYPES = {"text": "8", "double": "5", "date": "7", "16-bit integer": "2", "32-bit integer": "3", "Boolean": "11"}
ENUMERATION = TYPES["32-bit integer"]
EMPTY, DATE, BOOLEAN, TEXT = "0", "7", "11", "8"
NUMBERS = ("2", "3", "4", "5")
FIRST_DAY = datetime(1899, 12, 30)
LONGEST_LITERAL = 400  # a line of VBScript has at most 1022 characters


class CannotShow(Exception):
    """What a script has no way to do or see."""


class Failure(Exception):
    pass


def shown(value: Any) -> str:
    return json.dumps(value, ensure_ascii=False)


# ---------------------------------------------------------------- the interface, as the type library tells it


@dataclass(frozen=True)
class Member:
    """A member in words, such as "Find(sCode: text, [out Found: Boolean]): text"."""

    words: str

    @property
    def name(self) -> str:
        return re.match(r"\w+", self.words)[0]  # type: ignore[index]

    @property
    def type(self) -> str:
        found = re.search(r": ([^:()]+?)(?: \(read-only\))?$", self.words)
        return found[1] if found else ""

    @property
    def outputs(self) -> list[int]:
        parameters = re.search(r"\((\w.*?|\[.*?)\)(?::|$)", self.words)
        return [i for i, p in enumerate(parameters[1].split(", ")) if "out " in p] if parameters else []


class Interface:
    def __init__(self, listing: str) -> None:
        self.classes: dict[str, list[Member]] = {}
        for line in listing.splitlines():
            if line.startswith("\t"):
                self.classes[name].append(Member(line.strip()))
            else:
                name = line
                self.classes[name] = []

    def member(self, class_name: str, name: str) -> Member:
        found = next((m for m in self.classes[class_name] if m.name == name), None)
        if found is None:
            raise Failure(f"no {name} in {class_name}")
        return found


# ---------------------------------------------------------------- what a step gave


@dataclass(frozen=True)
class Value:
    type: str  # as VarType tells it, or "nothing", "object"
    text: str

    def to_json(self) -> Any:
        if self.type == EMPTY:
            return None
        if self.type == "nothing":
            return {"nothing": True}
        if self.type == "object":
            return {"object": self.text.removeprefix("_")}
        if self.type == BOOLEAN:
            return self.text == "True"
        if self.type == DATE:
            return {"date": date_of(float(self.text)).isoformat(timespec="seconds")}
        return float(self.text) if self.type in NUMBERS else self.text


@dataclass(frozen=True)
class Outcome:
    error: tuple[int, str, str] | None
    values: list[Value]


def date_of(serial: float) -> datetime:
    day, time = int(serial), abs(serial - int(serial))
    return FIRST_DAY + timedelta(days=day, seconds=round(time * 86400))


def outcomes_in(notes: str) -> dict[tuple[int, int], Outcome]:
    outcomes = {}
    for record in notes.split("\x1e")[:-1]:
        rule, number, verb, *fields = record.split("\x1f")
        error = (int(fields[0]), fields[1], fields[2]) if verb == "raises" else None
        values = [] if error else [Value(*pair) for pair in zip(fields[::2], fields[1::2])]
        outcomes[int(rule), int(number)] = Outcome(error, values)
    return outcomes


# ---------------------------------------------------------------- texts of a script


class Texts:
    """Texts as expressions of VBScript; those that it cannot write stand in files beside the script."""

    def __init__(self, folder: pathlib.Path) -> None:
        self.folder = folder
        self.count = 0

    def expression(self, text: str) -> str:
        if "${i}" in text:
            return " & CStr(i) & ".join(self.expression(part) for part in text.split("${i}"))
        if len(text) > LONGEST_LITERAL or not re.fullmatch(r"[\t\r\n -~]*", text):
            return self.in_file(text)
        pieces = re.split(r"([\t\r\n])", text)
        names = {"\t": "vbTab", "\r": "vbCr", "\n": "vbLf"}
        return " & ".join(names.get(p) or '"' + p.replace('"', '""') + '"' for p in pieces if p) or '""'

    def in_file(self, text: str) -> str:
        self.count += 1
        name = f"text{self.count}.txt"
        (self.folder / name).write_bytes(b"\xff\xfe" + text.encode("utf-16-le", "surrogatepass"))
        return f'TextIn("{name}")'


# ---------------------------------------------------------------- one rule


class Rule:
    """Translates the steps of a rule, and judges what they gave."""

    def __init__(self, number: int, vector: dict[str, Any], interface: Interface, texts: Texts,
                 messages: pathlib.Path) -> None:
        self.number, self.name = number, vector["rule"]
        self.interface, self.texts, self.messages = interface, texts, messages
        self.folder = texts.folder / f"rule{number}"
        self.classes: dict[str, str] = {}  # of the objects that have names
        self.folders: set[str] = set()
        self.lines: list[str] = []
        self.judges: list[tuple[list[Any], Callable[[Outcome], None]]] = []
        self.has_checked = False
        self.cannot_show = ""
        try:
            for step in vector["steps"]:
                self.translate(step)
        except CannotShow as reason:
            self.cannot_show = str(reason)

    def procedure(self) -> str:
        names = sorted(f"o_{name}" for name in self.classes)
        head = [f"Sub Rule{self.number}", "On Error Resume Next", "Dim i, " + ", ".join(["a0, a1, a2, a3, a4, a5", *names])]
        return "\n".join([*head, *self.lines, "End Sub", f"Rule{self.number}", ""])

    def fault(self, outcomes: dict[tuple[int, int], Outcome]) -> str:
        """What is wrong with the rule; nothing when it holds."""
        for number, (step, judge) in enumerate(self.judges):
            try:
                outcome = outcomes.get((self.number, number))
                if outcome is None:
                    raise Failure("the script ended before it")
                judge(outcome)
            except Failure as fault:
                return f"{shown(step)}: {fault}"
        return "" if self.has_checked else "checks nothing"

    # ---- values

    def filled(self, text: str) -> str:
        """The text with the paths of the rule's folders filled in, the way Windows writes them."""
        return re.sub(r"\$\{([a-hj-z]\w*)\}([\w./-]*)", lambda m: windows_path(self.folder / m[1]) + m[2].replace("/", "\\"), text)

    def plain_text(self, value: Any) -> str:
        if isinstance(value, str):
            return self.filled(value)
        if "file" in value:
            return (self.messages / value["file"]).read_bytes().decode()
        return "".join(self.filled(line) + "\r\n" for line in value["lines"])

    def argument(self, value: Any) -> str:
        """A value as an expression."""
        if value is None:
            return "Empty"
        if isinstance(value, (bool, int, float)):
            return str(value)
        if isinstance(value, dict):
            if "nothing" in value:
                return "Nothing"
            if "object" in value:
                return f"o_{value['object']}"
            if "date" in value:
                since = datetime.fromisoformat(value["date"]) - FIRST_DAY
                return f"CDate({since / timedelta(days=1)!r})"
        return self.texts.expression(self.plain_text(value))

    @staticmethod
    def is_object(value: Any) -> bool:
        return isinstance(value, dict) and bool({"nothing", "object"} & value.keys())

    # ---- comparing

    def compare(self, expected: Any, value: Value) -> None:
        self.has_checked = True
        got = value.to_json()
        if isinstance(expected, dict) and "like" in expected:
            pattern = re.escape(self.filled(expected["like"])).replace(r"\*", ".*")
            if not isinstance(got, str) or not re.fullmatch(pattern, got, re.DOTALL):
                raise Failure(f"expected {shown(expected)}, got {shown(got)}")
            return
        is_text = isinstance(expected, str) or (isinstance(expected, dict) and {"lines", "file"} & expected.keys())
        wanted = self.plain_text(expected) if is_text else expected
        if wanted != got or isinstance(wanted, bool) != isinstance(got, bool):
            raise Failure(f"expected {shown(wanted)}, got {shown(got)}")

    def compare_type(self, declared: str, value: Value) -> None:
        """A value comes as what the type library says: a count as a 16-bit integer, not as any number."""
        if declared == "variant":
            return
        if declared in self.interface.classes:
            expected = ("object", "nothing")
        else:
            expected = (TYPES.get(declared, ENUMERATION) if declared else EMPTY,)
        if value.type not in expected:
            raise Failure(f"expected a {declared or 'Empty'}, got the VarType {value.type}")

    # ---- steps

    def translate(self, step: list[Any]) -> None:
        verb: Callable[..., None] | None = getattr(self, "do_" + step[0], None)
        if verb is None:
            raise CannotShow(f"a script has no {step[0]}")
        verb(step)

    def after(self, step: list[Any], judge: Callable[[Outcome], None], *lines: str) -> None:
        """Adds the lines of a step, and who judges what it gave."""
        self.lines += [*lines, f"Done {self.number}, {len(self.judges)}"]
        self.judges.append((step, judge))

    @staticmethod
    def succeed(outcome: Outcome) -> None:
        if outcome.error:
            raise Failure("raised {0} from {1}: {2}".format(*outcome.error))

    def call(self, step: list[Any]) -> tuple[list[str], str, Member]:
        """The lines that set the arguments of a calling step, the call, and the member that it calls."""
        verb, owner, name = step[:3]
        if verb not in ("get", "getAt", "call"):
            raise CannotShow(f"a script has no {verb}: a module is no class")
        arguments = step[3] if verb != "get" else []
        lines = [f"{'Set ' * self.is_object(value)}a{i} = {self.argument(value)}" for i, value in enumerate(arguments)]
        given = ", ".join(f"a{i}" for i in range(len(arguments)))
        called = f"o_{owner}.{name}" + (f"({given})" if verb != "get" else "")
        return lines, called, self.interface.member(self.classes[owner], name)

    def do_new(self, step: list[Any]) -> None:
        _, name, class_name = step
        self.classes[name] = class_name
        self.after(step, self.succeed, f'Set o_{name} = CreateObject("Varnex3.{class_name}")')

    def calls(self, step: list[Any]) -> None:
        lines, called, member = self.call(step)
        arguments = step[3] if step[0] != "get" else []
        expected = step[3:] if step[0] == "get" else step[4:]
        outputs = [i for i in member.outputs if i < len(arguments)]

        def judge(outcome: Outcome) -> None:
            self.succeed(outcome)
            results = [outcome.values[0], *(outcome.values[1 + i] for i in outputs)]
            self.compare_type(member.type, results[0])
            if len(expected) > len(results):
                raise Failure(f"no result for {shown(expected[len(results)])}")
            for wanted, value in zip(expected, results):
                self.compare(wanted, value)

        self.after(step, judge, *lines, f"Note {called}", *(f"Note a{i}" for i in range(len(arguments))))

    do_get = do_getAt = do_call = calls

    def put(self, step: list[Any]) -> None:
        verb, owner, name, *rest = step
        indexes, value = (rest[0], rest[1]) if verb == "putAt" else ([], rest[0])
        type_name = self.interface.member(self.classes[owner], name).type
        is_set = type_name in self.interface.classes and self.is_object(value)
        at = f"({', '.join(self.argument(index) for index in indexes)})" if indexes else ""
        self.after(step, self.succeed, f"{'Set ' * is_set}o_{owner}.{name}{at} = {self.argument(value)}")

    do_put = do_putAt = put

    def do_keep(self, step: list[Any]) -> None:
        _, name, inner = step
        lines, called, member = self.call(inner)
        self.classes[name] = member.type

        def judge(outcome: Outcome) -> None:
            self.succeed(outcome)
            if outcome.values[0].type != "object":
                raise Failure(f"expected an object, got {shown(outcome.values[0].to_json())}")

        self.after(step, judge, *lines, f"Set o_{name} = {called}", f"Note o_{name}")

    def do_nothing(self, step: list[Any]) -> None:
        lines, called, _ = self.call(step[1])

        def judge(outcome: Outcome) -> None:
            self.succeed(outcome)
            self.compare({"nothing": True}, outcome.values[0])

        self.after(step, judge, *lines, f"Note {called}")

    def do_same(self, step: list[Any]) -> None:
        def judge(outcome: Outcome) -> None:
            self.succeed(outcome)
            self.compare(True, outcome.values[0])

        self.after(step, judge, f"Note (o_{step[1]} Is o_{step[2]})")

    def do_raises(self, step: list[Any]) -> None:
        _, number, source, *words, inner = step
        self.translate(inner)
        self.judges.pop()

        def judge(outcome: Outcome) -> None:
            self.has_checked = True
            if outcome.error is None:
                raise Failure(f"expected error {number} from {source}, got none")
            if outcome.error[:2] != (number, source):
                raise Failure("expected error {0} from {1}, got {2} from {3}: {4}".format(number, source, *outcome.error))
            wanted = words[0].replace("/", "\\") if words and self.folders else "".join(words)
            if wanted not in outcome.error[2]:
                raise Failure(f"expected the description to say {shown(wanted)}, got {shown(outcome.error[2])}")

        self.judges.append((step, judge))

    def do_members(self, step: list[Any]) -> None:
        _, class_name, expected = step

        def judge(_: Outcome) -> None:
            self.has_checked = True
            # A type library says of every argument by reference that something comes back.
            got = [member.words.replace("out ", "") for member in self.interface.classes.get(class_name, [])]
            wanted = [words.replace("out ", "") for words in expected]
            if got != wanted:
                raise Failure(f"expected {shown(wanted)}, got {shown(got)}")

        self.after(step, judge)

    def do_repeat(self, step: list[Any]) -> None:
        _, count, inner = step
        before = len(self.lines)
        self.translate(inner)
        body = self.lines[before:-1]
        self.lines[before:] = [f"For i = 0 To {count - 1}", *body, 'noted = ""', "If Err.Number <> 0 Then Exit For", "Next",
                               self.lines[-1]]
        self.judges[-1] = (step, self.succeed)

    def do_folder(self, step: list[Any]) -> None:
        _, name, files = step
        self.folders.add(name)
        (self.folder / name).mkdir(parents=True)
        for file_name, content in files.items():
            path = self.folder / name / file_name
            path.parent.mkdir(parents=True, exist_ok=True)
            if content is None:
                path.mkdir()
            elif isinstance(content, dict) and "base64" in content:
                path.write_bytes(base64.b64decode(content["base64"]))
            else:
                path.write_bytes(self.plain_text(content).encode())

    def do_content(self, step: list[Any]) -> None:
        """The file is copied at this point of the script, and read when it has ended."""
        _, path, expected = step
        copy = self.folder / f"copy{len(self.judges)}"

        def judge(outcome: Outcome) -> None:
            self.succeed(outcome)
            self.compare(expected, Value(TEXT, copy.read_bytes().decode()))

        self.after(step, judge, f"files.CopyFile {self.argument(path)}, {self.argument(windows_path(copy))}")

    def do_absent(self, step: list[Any]) -> None:
        def judge(outcome: Outcome) -> None:
            self.succeed(outcome)
            self.compare(False, outcome.values[0])

        self.after(step, judge, f"Note files.FileExists({self.argument(step[1])})")


# ---------------------------------------------------------------- files of rules


@dataclass
class Result:
    passed: int = 0
    failed: int = 0
    not_shown: int = 0


def run_file(component: Component, interface: Interface, file: pathlib.Path, result: Result) -> None:
    vectors = json.loads(file.read_text(encoding="utf-8"))
    with tempfile.TemporaryDirectory(prefix="varnex3-rules-") as name:
        folder = pathlib.Path(name)
        texts = Texts(folder)
        rules = [Rule(i, v, interface, texts, SOURCE / "tests/messages") for i, v in enumerate(vectors)]
        shown_rules = [rule for rule in rules if not rule.cannot_show]
        script = LIBRARY + "".join(rule.procedure() for rule in shown_rules)
        (folder / "rules.vbs").write_text(script, encoding="ascii")
        printed = component.run_script(folder / "rules.vbs", folder=folder)
        notes = folder / "notes.txt"
        outcomes = outcomes_in(notes.read_bytes().decode("utf-16", "surrogatepass")) if notes.exists() else {}
        if printed:
            print(f"{file.name}: the script printed: {printed}")
        for rule in rules:
            fault = "" if rule.cannot_show else rule.fault(outcomes)
            if rule.cannot_show:
                result.not_shown += 1
                print(f"{file.name}: {rule.name}: not shown: {rule.cannot_show}")
            elif fault:
                result.failed += 1
                print(f"{file.name}: {rule.name}: {fault}")
            else:
                result.passed += 1


def main(arguments: list[str]) -> int:
    if not arguments:
        print("usage: rules_in_vbscript.py BUILD [NAME...]", file=sys.stderr)
        return 2
    component, names = Component(pathlib.Path(arguments[0])), tuple(arguments[1:])
    interface = Interface(component.run(component.hosts / "typelib.exe", windows_path(component.library)))
    result = Result()
    for file in sorted((SOURCE / "tests/rules").glob("*.json")):
        is_class = file.stem in interface.classes
        if is_class and (not names or file.name.startswith(names)):
            run_file(component, interface, file, result)
    if result.not_shown:
        print(f"{result.not_shown} rules cannot be shown from VBScript")
    print(f"{result.passed} passed, {result.failed} failed")
    return 0 if result.passed and not result.failed else 1


if __name__ == "__main__":
    sys.exit(main(sys.argv[1:]))
