#!/usr/bin/env python3
"""Registering the component, for the machine and for a user, and what is left when it is unregistered: nothing.

    test_registration.py BUILD [UNITTEST OPTIONS]

In a prefix with both bitnesses the component of each is registered beside the other's: the 32-bit one is taken from the
build folder "win32" beside a 64-bit one.
"""

from __future__ import annotations

import pathlib
import re
import shutil
import sys
import tempfile
import unittest
from typing import Dict

from component import LIBRARY, SOURCE, Component, windows_path

BUILD = pathlib.Path(sys.argv.pop(1))
MACHINE, USER = "system.reg", "user.reg"  # the files of a prefix's registry
PROXY = "{00020424-0000-0000-C000-000000000046}"  # the system's own, which works by the type library
SCRIPT = """On Error Resume Next
Set o = CreateObject("Varnex3.VersionDef")
o.XaloVersion = "1.6"
WScript.Echo o.XaloVersion & " " & Err.Number
"""
CREATED = "1.6 0"

Registry = Dict[str, Dict[str, str]]  # values by their names, by keys such as "system.reg\Software\Classes\TypeLib"


def plain(text: str) -> str:
    """A text of a registry file without its quotes and escapes."""
    characters = re.sub(r"\\x([0-9a-f]{1,4})", lambda m: chr(int(m[1], 16)), text.strip('"'))
    return re.sub(r"\\(.)", r"\1", characters)


def registry_in(file: pathlib.Path) -> Registry:
    """The software of a registry file. Times of keys are no part of it."""
    keys: Registry = {}
    values: dict[str, str] = {}
    for line in file.read_text(encoding="utf-8").split("\n"):
        if line.startswith("["):
            key = plain(line[1 : line.rindex("]")])
            values = keys.setdefault(f"{file.name}\\{key}", {}) if key.startswith("Software\\") else {}
        elif not line.startswith("#") and (found := re.fullmatch(r'(@|".*?(?<!\\)")=(.*)', line)):
            values[plain(found[1])] = plain(found[2])
    return keys


def below(registry: Registry, *parts: str) -> dict[str, str]:
    """The values of a key; letter case does not count."""
    wanted = "\\".join(parts).lower()
    return next((values for key, values in registry.items() if key.lower() == wanted), {})


class Registration(unittest.TestCase):
    component: Component
    folder: pathlib.Path

    @classmethod
    def setUpClass(cls) -> None:
        cls.component = Component(BUILD)
        cls.folder = pathlib.Path(tempfile.mkdtemp(prefix="varnex3-registration-"))
        cls.addClassCleanup(shutil.rmtree, cls.folder)
        (cls.folder / "create.vbs").write_text(SCRIPT)
        cls.library = windows_path(cls.component.library)
        listing = cls.component.run(cls.component.hosts / "typelib.exe", cls.library)
        cls.classes = [line for line in listing.splitlines() if not line.startswith("\t")]

        # Wine registers the type library by itself when a host without registration uses a proxy: away with that. Its
        # script hosts register their own: let them do so first.
        cls.regsvr32(cls.library)
        cls.regsvr32("/u", cls.library)
        for folder in cls.folders_of_windows():
            cls.created(folder)
        cls.before = cls.registry()
        assert len(cls.before) > 1000, "the registry was not read"
        left = f"registered already, by a run that was interrupted: remove {cls.component.drive.parent}"
        assert "varnex3" not in str(cls.before).lower(), left

    def tearDown(self) -> None:
        """After each test the registry is what it was before."""
        try:
            self.assertSame(self.registry(), self.before)
        except AssertionError:
            self.regsvr32("/u", self.library)  # for the next test
            raise

    def assertSame(self, registry: Registry, expected: Registry) -> None:
        self.assertEqual(sorted(registry.keys() - expected.keys()), [], "keys that are new")
        self.assertEqual(sorted(expected.keys() - registry.keys()), [], "keys that are gone")
        changed = [key for key, values in registry.items() if values != expected[key]]
        self.assertEqual({key: registry[key] for key in changed}, {key: expected[key] for key in changed})

    # ---- what programs of Windows do

    @classmethod
    def program(cls, name: str, folder: str) -> pathlib.Path:
        return cls.component.drive / "windows" / folder / name

    @classmethod
    def registry(cls) -> Registry:
        """What is in the files when Wine has ended: they are written then."""
        cls.component.end_wine()
        prefix = cls.component.drive.parent
        return registry_in(prefix / MACHINE) | registry_in(prefix / USER)

    @classmethod
    def regsvr32(cls, *arguments: str, folder: str = "system32") -> None:
        cls.component.run(cls.program("regsvr32.exe", folder), "/s", *arguments)

    @classmethod
    def created(cls, folder: str = "system32") -> str:
        """What a script prints that creates an object; its host has nothing but the registry to find the class by."""
        return cls.script(cls.folder / "create.vbs", folder).strip()

    @classmethod
    def script(cls, path: pathlib.Path, folder: str = "system32") -> str:
        return cls.component.run(cls.program("cscript.exe", folder), "//nologo", windows_path(path))

    @classmethod
    def folders_of_windows(cls) -> list[str]:
        """Of each bitness that the prefix has: the component's own first."""
        return [name for name in ("system32", "syswow64") if (cls.component.drive / "windows" / name / "cscript.exe").exists()]

    # ---- what is promised

    def test_objects_are_created_while_the_component_is_registered(self) -> None:
        self.assertNotEqual(self.created(), CREATED)
        self.regsvr32(self.library)
        self.assertEqual(self.created(), CREATED)
        self.regsvr32("/u", self.library)
        self.assertNotEqual(self.created(), CREATED)

    def test_every_fact_of_script_hosts_holds_for_the_registered_component(self) -> None:
        self.regsvr32(self.library)
        for script in ("hosts.vbs", "hosts.js"):
            printed = self.script(SOURCE / "tests/windows" / script)
            self.assertRegex(printed[-1000:], r"\n[1-9]\d* passed, 0 failed\n\Z")
        self.regsvr32("/u", self.library)

    def test_every_class_has_its_names_file_and_threading_model(self) -> None:
        self.regsvr32(self.library)
        registry = self.registry()
        classes = MACHINE + r"\Software\Classes"
        self.assertGreaterEqual(len(self.classes), 15)
        for name in self.classes:
            with self.subTest(name):
                prog_id, versioned = f"Varnex3.{name}", f"Varnex3.{name}.3"
                class_id = below(registry, classes, prog_id, "CLSID")["@"]
                self.assertEqual(below(registry, classes, prog_id, "CurVer")["@"], versioned)
                self.assertEqual(below(registry, classes, versioned, "CLSID")["@"], class_id)
                self.assertTrue(below(registry, classes, prog_id)["@"])
                key = rf"{classes}\CLSID\{class_id}"
                server = below(registry, key, "InprocServer32")
                self.assertEqual(server, {"@": self.library, "ThreadingModel": "Apartment"})
                self.assertEqual(below(registry, key, "ProgID")["@"], versioned)
                self.assertEqual(below(registry, key, "VersionIndependentProgID")["@"], prog_id)
                self.assertEqual(below(registry, key, "Version")["@"], "3.0")
                library = below(registry, key, "TypeLib")["@"]
                system = "win32" if self.component.is_32_bit else "win64"
                self.assertEqual(below(registry, classes, "TypeLib", library, "3.0", "0", system)["@"], self.library)
        interfaces = {values["@"]: key for key, values in registry.items()
                      if key.startswith(classes + r"\Interface") and values.get("@", "").startswith("_")}
        for name in self.classes:
            with self.subTest("_" + name):
                self.assertEqual(below(registry, interfaces["_" + name], "ProxyStubClsid32")["@"], PROXY)
        self.regsvr32(self.library)
        self.assertSame(self.registry(), registry)
        self.regsvr32("/u", self.library)
        self.regsvr32("/u", self.library)

    def test_a_path_with_blanks_and_letters_beyond_ascii(self) -> None:
        folder = self.component.drive / "Werkstatt Größe 日本"
        folder.mkdir()
        self.addCleanup(shutil.rmtree, folder)
        shutil.copy(self.component.library, folder)
        path = rf"C:\{folder.name}\{LIBRARY}"
        self.regsvr32(path)
        self.assertEqual(self.created(), CREATED)
        servers = {values["@"] for key, values in self.registry().items()
                   if key.endswith("InprocServer32") and LIBRARY in values.get("@", "")}
        self.assertEqual(servers, {path})
        self.regsvr32("/u", path)

    def test_a_component_that_moved_is_registered_where_it_is(self) -> None:
        moved = self.folder / "moved"
        moved.mkdir()
        shutil.copy(self.component.library, moved)
        self.regsvr32(self.library)
        self.regsvr32(windows_path(moved / LIBRARY))
        servers = {values["@"] for key, values in self.registry().items()
                   if key.endswith("InprocServer32") and LIBRARY in values.get("@", "")}
        self.assertEqual(servers, {windows_path(moved / LIBRARY)})
        self.assertEqual(self.created(), CREATED)
        self.regsvr32("/u", windows_path(moved / LIBRARY))

    def test_a_user_alone_registers_without_touching_the_machine(self) -> None:
        """Wine takes no classes of a user into account, so the keys are all there is to see. It also writes a user's type
        library where the machine's are."""
        self.regsvr32("/n", "/i:user", self.library)
        registry = self.registry()
        added = registry.keys() - self.before.keys()
        library_of_wine = re.compile(r"\\Classes\\(Wow6432Node\\)?(TypeLib|Interface)(\\|$)", re.IGNORECASE)
        self.assertFalse([key for key in added if key.startswith(MACHINE) and not library_of_wine.search(key)])
        classes = USER + r"\Software\Classes"
        for name in self.classes:
            with self.subTest(name):
                class_id = below(registry, classes, f"Varnex3.{name}", "CLSID")["@"]
                server = below(registry, classes, "CLSID", class_id, "InprocServer32")
                self.assertEqual(server, {"@": self.library, "ThreadingModel": "Apartment"})
        self.regsvr32("/u", "/n", "/i:user", self.library)

    def test_words_that_mean_nothing_install_nothing(self) -> None:
        self.regsvr32("/n", "/i:everybody", self.library)

    def test_both_bitnesses_are_registered_side_by_side(self) -> None:
        """Each host gets the component of its own bitness; what goes first leaves the other's as it was."""
        narrow = self.component.build.parent / "win32" / LIBRARY
        if self.component.is_32_bit:
            self.skipTest("a prefix with both bitnesses is the 64-bit component's")
        if not narrow.exists() or "syswow64" not in self.folders_of_windows():
            self.skipTest("32-bit Wine is not installed, or the 32-bit component not built")
        self.regsvr32(self.library)
        wide_alone = self.registry()
        self.assertNotEqual(self.created("syswow64"), CREATED)
        self.regsvr32(windows_path(narrow), folder="syswow64")
        self.assertEqual((self.created(), self.created("syswow64")), (CREATED, CREATED))
        self.regsvr32("/u", windows_path(narrow), folder="syswow64")
        self.assertSame(self.registry(), wide_alone)
        self.assertEqual(self.created(), CREATED)
        self.regsvr32(windows_path(narrow), folder="syswow64")
        self.regsvr32("/u", self.library)
        self.assertEqual(self.created("syswow64"), CREATED)
        self.regsvr32("/u", windows_path(narrow), folder="syswow64")


if __name__ == "__main__":
    unittest.main()
