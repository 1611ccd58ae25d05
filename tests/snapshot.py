"""Compares two listings of the public interface (docs/interface.txt) and names each difference."""

from __future__ import annotations

import difflib
import re
import unittest

FUNCTIONS = "functions of the C library"
HEADING = re.compile(rf"^(library|enum|class|module|{FUNCTIONS})\b *(\w*)")
LINES = (  # what a line below a heading tells of, first match wins
    re.compile(r"^ +\d+ +\d+  (?P<of>method|get|put|putref) +(?P<name>\w+)"),  # slot, dispatch id, access
    re.compile(r"^ +-?\d+  (?P<name>\w+)$"),  # value of a constant
    re.compile(r"^  (?P<of>interface) "),
    re.compile(r"^    (?P<name>\w+)"),  # a function
)


def facts(listing: str) -> dict[str, str]:
    """Every line that tells something, under the name of what it tells of."""
    told: dict[str, str] = {}
    heading = ""
    for line in listing.splitlines():
        if not line.strip() or line.startswith("#"):
            continue
        if found := HEADING.match(line):
            heading = found[2] if found[1] != FUNCTIONS else FUNCTIONS
            key = f"{found[1]} {found[2]}".strip()
        else:
            key = f"{heading}: {subject_of(line)}"
        if key in told:
            raise ValueError(f"told twice: {key}")
        told[key] = " ".join(line.split())
    return told


def subject_of(line: str) -> str:
    for pattern in LINES:
        if found := pattern.match(line):
            return " ".join(filter(None, found.groupdict().values()))
    raise ValueError(f"a line that no listing has: {line!r}")


def differences(expected: str, found: str) -> list[str]:
    """A line for each fact that is gone, new or another one; empty when the listings say the same in the same order."""
    before, after = facts(expected), facts(found)
    changed = [key for key in before if before[key] != after.get(key, before[key])]
    told = [f"{key}\n    was {before[key]}\n    is  {after[key]}" for key in changed]
    told += [f"{key} is gone: {before[key]}" for key in before if key not in after]
    told += [f"{key} is new: {after[key]}" for key in after if key not in before]
    if not told:
        told += [f"{a} has changed its place with {b}" for a, b in zip(before, after) if a != b][:1]
    return told


def changed_lines(expected: str, found: str) -> str:
    """Of two texts of any kind, the lines that differ."""
    lines = difflib.unified_diff(expected.splitlines(), found.splitlines(), "recorded", "found", lineterm="", n=0)
    return "\n".join(lines)


def section(listing: str, first: str, after: str | None) -> str:
    """The lines from a heading on, up to another one."""
    start = re.search(f"^{first}", listing, re.MULTILINE)
    if not start:
        raise ValueError(f"the listing has no {first}")
    end = re.search(f"^{after}", listing, re.MULTILINE) if after else None
    return listing[start.start() : end.start() if end else None]


def component(listing: str) -> str:
    """What the component's type library has to say: all but the modules and the functions of the C library."""
    return section(listing, "library", "module|functions")


def symbols(listing: str) -> list[str]:
    """The functions that the C library exports."""
    return section(listing, FUNCTIONS, None).split("\n", 1)[1].split()


class Comparison(unittest.TestCase):
    """Says what differs and nothing else."""

    def assert_nothing(self, told: str) -> None:
        if told:
            self.fail(f"\n{told}")
