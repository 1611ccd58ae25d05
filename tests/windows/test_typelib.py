#!/usr/bin/env python3
"""What hosts see of the component: the type library inside it, its exports, its header, its manifest.

    test_typelib.py BUILD NATIVE_BUILD
"""

from __future__ import annotations

import pathlib
import re
import subprocess
import sys
import tempfile
import unittest
import xml.etree.ElementTree as ElementTree

from component import LIBRARY, SOURCE, Component, is_32_bit, windows_path

sys.path.insert(0, str(SOURCE / "tests"))

import snapshot  # noqa: E402

BINARY, NATIVE = map(pathlib.Path, sys.argv[1:3])
RECORDED = (SOURCE / "docs/interface.txt").read_text()
CLASSES = dict(re.findall(r"^class (\w+) \{([\w-]+)\}", RECORDED, re.MULTILINE))
INTERFACES = dict(re.findall(r"^  interface (\w+) \{([\w-]+)\}", RECORDED, re.MULTILINE))
ENTRIES = ["DllCanUnloadNow", "DllGetClassObject", "DllInstall", "DllRegisterServer", "DllUnregisterServer"]
PROGRAM = """
#include <windows.h>
#include "Varnex3.h"
int main(void) { return 0; }
"""


def told(*command: object) -> str:
    return subprocess.run([str(word) for word in command], capture_output=True, text=True, check=True).stdout


class InsideTheComponent(snapshot.Comparison):
    component: Component

    @classmethod
    def setUpClass(cls) -> None:
        cls.component = Component(BINARY)

    def read(self, *options: str) -> str:
        return self.component.run(self.component.hosts / "read_typelib.exe", windows_path(BINARY / LIBRARY), *options)

    def test_the_type_library_says_what_is_recorded(self) -> None:
        recorded, read = snapshot.component(RECORDED).strip(), self.read().strip()
        self.assert_nothing("\n".join(snapshot.differences(recorded, read)))
        self.assert_nothing(snapshot.changed_lines(recorded, read))

    def test_the_help_strings_are_the_words_of_the_rows(self) -> None:
        rows = told(NATIVE / "varnex3/server/idl/varnex3_idl", "--help-strings")
        self.assertIn("VersionDef.DLLVersion: ", rows)
        self.assert_nothing(snapshot.changed_lines(rows, self.read("--help-strings")))

    def test_the_entries_of_a_component_and_the_functions_of_the_c_library_are_exported_and_nothing_else(self) -> None:
        table = told("objdump", "-p", BINARY / LIBRARY).partition("[Ordinal/Name Pointer] Table")[2].partition("\n\n")[0]
        names = [line.split()[-1] for line in table.splitlines() if line.strip()]
        self.assertEqual(sorted(names), sorted(ENTRIES + snapshot.symbols(RECORDED)))


class BesideTheComponent(snapshot.Comparison):
    def test_the_idl_is_the_recorded_one(self) -> None:
        recorded, built = (SOURCE / "docs/interface.idl").read_text(), (BINARY / "Varnex3.idl").read_text()
        self.assert_nothing(snapshot.changed_lines(recorded, built))

    def compile(self, compiler: str, suffix: str, program: str) -> None:
        target = "i686" if is_32_bit(BINARY / LIBRARY) else "x86_64"
        with tempfile.TemporaryDirectory() as folder:
            source = pathlib.Path(folder, f"host{suffix}")
            source.write_text(program)
            words = [f"{target}-w64-mingw32-{compiler}-win32", "-Wall", "-Wextra", "-Werror", "-fsyntax-only", "-I", str(BINARY)]
            done = subprocess.run([*words, str(source)], capture_output=True, text=True, check=False)
            self.assertEqual(done.stderr, "")

    def test_the_header_compiles_as_c(self) -> None:
        self.compile("gcc", ".c", PROGRAM)

    def test_the_header_names_every_class_and_interface_in_cpp(self) -> None:
        classes = "".join(f"static_assert(sizeof(CLSID_{name}) && sizeof(__uuidof(class {name})));\n" for name in CLASSES)
        interfaces = "".join(f"static_assert(sizeof(IID_{name}) && sizeof({name}));\n" for name in INTERFACES)
        self.compile("g++", ".cpp", PROGRAM + classes + interfaces)

    def test_the_manifest_has_every_class_and_interface(self) -> None:
        manifest = ElementTree.parse(BINARY / "Varnex3.Component.manifest").getroot()
        space = "{urn:schemas-microsoft-com:asm.v1}"
        classes = {c.get("progid"): c.get("clsid") for c in manifest.iter(f"{space}comClass")}
        interfaces = {i.get("name"): i.get("iid") for i in manifest.iter(f"{space}comInterfaceExternalProxyStub")}
        self.assertEqual(classes, {f"Varnex3.{name}": f"{{{guid}}}" for name, guid in CLASSES.items()})
        self.assertEqual(interfaces, {name: f"{{{guid}}}" for name, guid in INTERFACES.items()})

    def test_the_manifest_names_the_architecture(self) -> None:
        manifest = (BINARY / "Varnex3.Component.manifest").read_text()
        self.assertIn(f'processorArchitecture="{"x86" if is_32_bit(BINARY / LIBRARY) else "amd64"}"', manifest)


if __name__ == "__main__":
    unittest.main(argv=sys.argv[:1])
