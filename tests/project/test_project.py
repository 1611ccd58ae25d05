#!/usr/bin/env python3
"""What the project promises as a whole: what is installed works, layers point down, documents tell the truth."""

from __future__ import annotations

import os
import pathlib
import re
import shutil
import subprocess
import sys
import tempfile
import unittest

SOURCE = pathlib.Path(os.environ["VARNEX3_SOURCE_DIR"])
BINARY = pathlib.Path(os.environ["VARNEX3_BINARY_DIR"])

LAYERS = {  # each with the layers it may use
    "xml": {"xml"},
    "core": {"xml", "core"},
    "services": {"xml", "core", "services"},
    "request": {"xml", "core", "request"},
    "quote": {"xml", "core", "quote"},
    "notices": {"xml", "core", "notices"},
    "inbox": {"xml", "core", "inbox"},
}


def run(*command: object, **options: object) -> str:
    done = subprocess.run([str(word) for word in command], capture_output=True, text=True, **options)  # type: ignore[call-overload]
    if done.returncode != 0:
        raise AssertionError(f"{command} ended with {done.returncode}:\n{done.stdout}{done.stderr}")
    return str(done.stdout)


def tracked(*patterns: str) -> list[pathlib.Path]:
    return [SOURCE / name for name in run("git", "-C", SOURCE, "ls-files", "--", *patterns).splitlines()]


class Installed(unittest.TestCase):
    prefix: pathlib.Path

    @classmethod
    def setUpClass(cls) -> None:
        cls.prefix = pathlib.Path(tempfile.mkdtemp(prefix="varnex3-installed-"))
        cls.addClassCleanup(shutil.rmtree, cls.prefix)
        run("cmake", "--install", BINARY, "--prefix", cls.prefix)

    def pkg_config(self, package: str) -> list[str]:
        folder = next(self.prefix.glob("lib*/**/pkgconfig"))
        return run("pkg-config", "--cflags", "--libs", package, env=os.environ | {"PKG_CONFIG_PATH": str(folder)}).split()

    def test_a_cmake_project_finds_the_package_and_its_program_runs(self) -> None:
        build = self.prefix / "consumer"
        run("cmake", "-S", SOURCE / "tests/project/consumer", "-B", build, f"-DCMAKE_PREFIX_PATH={self.prefix}")
        run("cmake", "--build", build)
        self.assertIn("<RegistrationNo>ABC 123</RegistrationNo>", run(build / "consumer"))

    def test_a_cpp_program_builds_with_pkg_config(self) -> None:
        program = self.prefix / "cpp"
        run("g++", "-std=c++20", SOURCE / "tests/project/consumer/main.cpp", "-o", program, *self.pkg_config("varnex3"))
        self.assertIn("<RegistrationNo>ABC 123</RegistrationNo>", run(program))

    def test_a_c_program_builds_with_pkg_config(self) -> None:
        program = self.prefix / "c"
        run("gcc", SOURCE / "tests/c/c_face.c", "-o", program, *self.pkg_config("varnex3_c"))
        libraries = next(self.prefix.glob("lib*/**/libvarnex3_c.so")).parent
        self.assertIn(" 0 failed", run(program, env=os.environ | {"LD_LIBRARY_PATH": str(libraries)}))

    def test_the_python_package_is_installed_whole(self) -> None:
        package = next(self.prefix.glob("lib*/**/python/varnex3"))
        printed = run(
            sys.executable, "-B", "-c", "import varnex3; print(varnex3.__file__)", env=os.environ | {"PYTHONPATH": str(package.parent)}
        )
        self.assertEqual(printed.strip(), str(package / "__init__.py"))

    def test_the_program_and_its_manual_are_installed(self) -> None:
        self.assertIn(self.version(), run(self.prefix / "bin/varnex3", "--version"))
        self.assertTrue(list(self.prefix.glob("share/man/man1/varnex3.1*")))

    @staticmethod
    def version() -> str:
        return re.search(r"VERSION (\d+\.\d+\.\d+)", (SOURCE / "CMakeLists.txt").read_text())[1]  # type: ignore[index]


class Exports(unittest.TestCase):
    def test_the_c_library_exports_its_versioned_functions_and_nothing_else(self) -> None:
        library = BINARY / "bindings/libvarnex3_c.so"
        exported = {line.split()[-1] for line in run("nm", "-D", "--defined-only", library).splitlines()}
        header = (SOURCE / "bindings/c/varnex3_c.h").read_text()
        declared = set(re.findall(r"VARNEX3_API [^(]*?\b(varnex3_\w+)\(", header))
        self.assertTrue(declared)
        self.assertEqual(exported - {"VARNEX3_3"}, {f"{name}@@VARNEX3_3" for name in declared})

    def test_every_function_of_the_c_header_has_words(self) -> None:
        lines = (SOURCE / "bindings/c/varnex3_c.h").read_text().splitlines()
        for above, line in zip(lines, lines[1:]):
            if line.startswith("VARNEX3_API"):
                self.assertTrue(above.endswith("*/"), line)


class Layers(unittest.TestCase):
    def test_a_layer_includes_only_itself_and_what_lies_below(self) -> None:
        for layer, allowed in LAYERS.items():
            files = tracked(f"varnex3/{layer}/*.h", f"varnex3/{layer}/*.cpp")
            self.assertTrue(files)
            for file in files:
                used = set(re.findall(r'#include "varnex3/(\w+)/', file.read_text()))
                self.assertLessEqual(used, allowed, file)

    def test_headers_of_windows_are_included_by_the_component_and_what_is_named_after_windows(self) -> None:
        for file in tracked("varnex3/*.h", "varnex3/*.cpp", "bindings/*.h", "bindings/*.cpp", "tools/*.h", "tools/*.cpp"):
            if not re.search(r"varnex3/(server|services)/|Windows\w*\.cpp$", str(file)):
                self.assertNotRegex(file.read_text(), r"#include <(windows|oaidl|oleauto|objbase)\.h>", file)

    def test_every_public_header_compiles_alone(self) -> None:
        public = [file.relative_to(SOURCE) for file in tracked("varnex3/*.h") if "server" not in file.parts]
        self.assertTrue(public)
        for header in public:
            with self.subTest(header):
                run("g++", "-std=c++20", "-fsyntax-only", "-x", "c++", "-I", SOURCE, "-", input=f'#include "{header}"\n')


class Documents(unittest.TestCase):
    def test_the_examples_of_the_readme_print_what_it_shows(self) -> None:
        text = (SOURCE / "README.md").read_text(encoding="utf-8")
        pairs = re.findall(r"```python\n(.*?)```\n+(?:prints|which prints):?\n+```xml\n(.*?)```", text, re.DOTALL)
        self.assertTrue(pairs)
        for program, shown in pairs:
            self.assertEqual(run(sys.executable, "-c", program).split(), shown.split())

    def test_every_link_between_documents_leads_somewhere(self) -> None:
        for document in tracked("*.md"):
            for target in re.findall(r"\]\(([^)#\s]+)(?:#[^)]*)?\)", document.read_text(encoding="utf-8")):
                if not target.startswith(("http:", "https:", "mailto:")):
                    self.assertTrue((document.parent / target).exists(), f"{document}: {target}")

    def test_the_reference_has_a_page_for_each_class(self) -> None:
        with tempfile.TemporaryDirectory() as folder:
            run(sys.executable, "-B", SOURCE / "scripts/make_reference", folder)
            page = (pathlib.Path(folder) / "VehicleDef.md").read_text()
            self.assertRegex(page, r"\| 3 \| `RegistrationNo` \| text \| \w+")

    def test_every_word_of_the_makefile_is_explained(self) -> None:
        helped = {line.split()[0] for line in run("make", "-s", "-C", SOURCE, "help").splitlines() if line.strip()}
        self.assertLessEqual({"setup", "demo", "test", "bench", "format", "tidy", "docs", "clean"}, helped)


class Samples(unittest.TestCase):
    def test_the_same_seed_gives_the_same_inbox(self) -> None:
        with tempfile.TemporaryDirectory() as folder:
            for name in ("a", "b"):
                run(SOURCE / "samples/make_inbox", f"{folder}/{name}", "--count", 30, "--seed", 7)
            first, second = (
                {file.name: file.read_bytes() for file in pathlib.Path(folder, name).iterdir()} for name in ("a", "b")
            )
        self.assertEqual(len(first), 30)
        self.assertEqual(first, second)


if __name__ == "__main__":
    unittest.main()
