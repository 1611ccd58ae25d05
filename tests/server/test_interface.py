#!/usr/bin/env python3
"""The interface that hosts are bound to: what the build has is what docs/ records."""

from __future__ import annotations

import importlib.machinery
import importlib.util
import os
import pathlib
import re
import subprocess
import sys
import tempfile
import unittest

SOURCE = pathlib.Path(os.environ["VARNEX3_SOURCE_DIR"])
BINARY = pathlib.Path(os.environ["VARNEX3_BINARY_DIR"])
sys.path.insert(0, str(SOURCE / "tests"))

import snapshot  # noqa: E402

loader = importlib.machinery.SourceFileLoader("coverage", str(SOURCE / "scripts/coverage"))
coverage = importlib.util.module_from_spec(importlib.util.spec_from_loader("coverage", loader))  # type: ignore[arg-type]
loader.exec_module(coverage)

RECORDED = (SOURCE / "docs/interface.txt").read_text()
LISTING = """library Varnex3 3.0 {AAAA}

enum KindEnum {BBBB}
       0  One
       5  Five

class ADef {CCCC}
  interface _ADef {DDDD} dual
       7    1  get    First: text
       8    2  get    Second: text

functions of the C library
    varnex3_call
"""


class Recorded(snapshot.Comparison):
    """If the change is meant: scripts/interface, and a word in the change log."""

    folder: pathlib.Path

    @classmethod
    def setUpClass(cls) -> None:
        held = tempfile.TemporaryDirectory()
        cls.addClassCleanup(held.cleanup)
        cls.folder = pathlib.Path(held.name)
        subprocess.run([sys.executable, "-B", SOURCE / "scripts/interface", BINARY, cls.folder], check=True)

    def test_the_listing_says_what_the_build_has(self) -> None:
        built = (self.folder / "interface.txt").read_text()
        self.assert_nothing("\n".join(snapshot.differences(RECORDED, built)))
        self.assert_nothing(snapshot.changed_lines(RECORDED, built))

    def test_the_idl_is_the_one_that_the_build_compiles(self) -> None:
        recorded, built = (folder / "interface.idl" for folder in (SOURCE / "docs", self.folder))
        self.assert_nothing(snapshot.changed_lines(recorded.read_text(), built.read_text()))

    def test_the_coverage_is_that_of_the_build(self) -> None:
        recorded, built = (folder / "coverage.md" for folder in (SOURCE / "docs", self.folder))
        self.assert_nothing(snapshot.changed_lines(recorded.read_text(), built.read_text()))

    def test_every_kind_of_host_has_every_class_member_and_constant(self) -> None:
        page = (self.folder / "coverage.md").read_text()
        self.assert_nothing("\n".join(line for line in page.splitlines() if "missing" in line))
        for _, *counts in re.findall(r"^\| \d+ (\w+) \| \w+ \|" + r" (\d+) \|" * 4, page, re.MULTILINE):
            self.assertEqual(len(set(counts)), 1, counts)

    def test_every_class_and_enumeration_of_the_headers_is_covered(self) -> None:
        """One that is in no list of classes, or that no member uses, is public in C++ alone."""
        headers = "".join(header.read_text() for header in (SOURCE / "varnex3").rglob("*.h"))
        declared = set(re.findall(r"^ *VARNEX_(?:RECORD|ENUM|MODULE)\((\w+),\s*\"", headers, re.MULTILINE))
        covered = set(re.findall(r"^### (\w+)$", (self.folder / "coverage.md").read_text(), re.MULTILINE))
        self.assertGreater(len(declared), 60)
        self.assertEqual(declared, covered)


class Listing(unittest.TestCase):
    def test_every_identifier_is_used_once(self) -> None:
        guids = [word.strip("{}") for word in RECORDED.split() if word.startswith("{")]
        self.assertGreater(len(guids), 30)
        self.assertEqual(len(guids), len(set(guids)))

    def test_it_has_the_functions_of_the_c_library(self) -> None:
        self.assertIn("varnex3_create", snapshot.symbols(RECORDED))


class Differences(unittest.TestCase):
    """What the comparison says when something moved: it must not be blind."""

    def told(self, old: str, new: str) -> str:
        self.assertEqual(LISTING.count(old), 1)
        return "\n".join(snapshot.differences(LISTING, LISTING.replace(old, new)))

    def test_none(self) -> None:
        self.assertEqual(self.told("First", "First"), "")

    def test_members_that_changed_places_are_named(self) -> None:
        swapped = "       7    1  get    Second: text\n       8    2  get    First: text\n"
        told = self.told("       7    1  get    First: text\n       8    2  get    Second: text\n", swapped)
        self.assertIn("ADef: get First\n    was 7 1 get First: text\n    is  8 2 get First: text", told)
        self.assertIn("ADef: get Second", told)

    def test_a_type_that_changed_is_named(self) -> None:
        self.assertIn("is  7 1 get First: date", self.told("First: text", "First: date"))

    def test_an_identifier_that_changed_is_named(self) -> None:
        self.assertIn("class ADef\n", self.told("{CCCC}", "{EEEE}"))
        self.assertIn("ADef: interface\n", self.told("{DDDD}", "{EEEE}"))
        self.assertIn("library Varnex3\n", self.told("{AAAA}", "{EEEE}"))

    def test_a_value_that_changed_is_named(self) -> None:
        self.assertEqual(self.told(" 5  Five", " 6  Five"), "KindEnum: Five\n    was 5 Five\n    is  6 Five")

    def test_what_is_gone_and_what_is_new_is_named(self) -> None:
        told = "ADef: get First is gone: 7 1 get First: text\nADef: get Next is new: 7 1 get Next: text"
        self.assertEqual(self.told("First: text", "Next: text"), told)
        self.assertEqual(
            self.told("    varnex3_call\n", ""), "functions of the C library: varnex3_call is gone: varnex3_call"
        )

    def test_constants_that_changed_places_are_told(self) -> None:
        told = self.told("       0  One\n       5  Five\n", "       5  Five\n       0  One\n")
        self.assertEqual(told, "KindEnum: One has changed its place with KindEnum: Five")

    def test_a_line_that_tells_nothing_known_is_an_error(self) -> None:
        with self.assertRaises(ValueError):
            self.told("       5  Five", "five")


class Coverage(unittest.TestCase):
    """How the coverage is found: it must not be blind."""

    def test_what_does_not_compile_is_told(self) -> None:
        uses = ["using Use = VersionDef;", "using Use = NoDef;", "constexpr auto Used = &VersionDef::Serialize;"]
        self.assertEqual(coverage.compiled(uses), {1, 2})

    def test_a_property_of_another_type_is_told(self) -> None:
        uses = [coverage.cpp_use("VersionDef", "get", "XaloVersion", None, of) for of in ("Text", "Date")]
        self.assertEqual(coverage.compiled(uses), {1})

    def test_a_read_only_property_cannot_be_stored(self) -> None:
        uses = [coverage.cpp_use("VersionDef", "put", name, None, "Text") for name in ("XaloVersion", "DLLVersion")]
        self.assertEqual(coverage.compiled(uses), {1})

    def test_the_listing_is_read_whole(self) -> None:
        facts = coverage.component_facts(LISTING)
        self.assertEqual(facts["class", "ADef"], {"First": "1 get", "Second": "2 get"})
        self.assertEqual(facts["enum", "KindEnum"], {"One": "0", "Five": "5"})

    def test_what_one_kind_of_host_lacks_is_missing(self) -> None:
        one = {("class", "ADef"): {"First": "get"}, ("class", "BDef"): {}}
        page = coverage.page({"C++": one, "COM": {("class", "ADef"): {}}})
        self.assertIn("| First | get | **missing** |", page)
        self.assertIn("### BDef\n\n**missing** in COM", page)


if __name__ == "__main__":
    unittest.main()
