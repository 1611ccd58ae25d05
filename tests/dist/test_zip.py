#!/usr/bin/env python3
"""The zip for Windows, as its README tells to use it: unpacked into a folder with blanks and letters beyond ASCII in its
name, registered, used, unregistered; and used without registration.

VARNEX3_SOURCE_DIR is the source folder; VARNEX3_WIN32 and VARNEX3_WIN64 are the builds for Windows, if not build/win32
and build/win64.
"""

from __future__ import annotations

import os
import pathlib
import re
import shutil
import subprocess
import sys
import tempfile
import unittest
import zipfile

SOURCE = pathlib.Path(os.environ["VARNEX3_SOURCE_DIR"])
WIN32 = pathlib.Path(os.environ.get("VARNEX3_WIN32", SOURCE / "build/win32"))
WIN64 = pathlib.Path(os.environ.get("VARNEX3_WIN64", SOURCE / "build/win64"))
EXPECTED = SOURCE / "tests/dist/expected"
COMPILERS = {"win64": "x86_64-w64-mingw32-g++-win32", "win32": "i686-w64-mingw32-g++-win32"}
WARNINGS = ("-Wall", "-Wextra", "-Werror")
SCRIPT_HOSTS = {"win64": r"C:\windows\system32\cscript.exe", "win32": r"C:\windows\syswow64\cscript.exe"}

sys.path.insert(0, str(SOURCE / "tests/windows"))
from component import Component  # noqa: E402


def make_zip(folder: pathlib.Path) -> pathlib.Path:
    command = [SOURCE / "scripts/make_dist", "windows", WIN32, WIN64, folder]
    subprocess.run(command, env=os.environ | {"SOURCE_DATE_EPOCH": "1700000000"}, check=True)
    return next(folder.glob("Varnex3-*-win.zip"))


def unpack(archive: pathlib.Path, folder: pathlib.Path) -> pathlib.Path:
    with zipfile.ZipFile(archive) as content:
        content.extractall(folder)
    return next(folder.iterdir())


def examples_in(readme: str) -> list[str]:
    """The indented blocks, as typed: without their indentation."""
    blocks = re.findall(r"(?:^    .*\n)(?:^(?:    .*)?\n)*", readme, re.MULTILINE)
    return [re.sub("^    ", "", block, flags=re.MULTILINE).strip("\n") + "\n" for block in blocks]


def plain(printed: str) -> str:
    """Line ends as LF, once: an Echo ends the line that a record's own text has ended already."""
    return printed.replace("\r", "").replace("\n\n", "\n")


BUILT = all((build / "Varnex3.dll").exists() for build in (WIN32, WIN64))


@unittest.skipUnless(BUILT, "the component is not built (make windows)")
@unittest.skipUnless(pathlib.Path("/usr/lib/wine/wine").exists(), "32-bit Wine is not installed")
class Zip(unittest.TestCase):
    component: Component
    folder: pathlib.Path

    @classmethod
    def setUpClass(cls) -> None:
        top = pathlib.Path(tempfile.mkdtemp(prefix="varnex3-zip-"))
        cls.addClassCleanup(shutil.rmtree, top)
        cls.archive = make_zip(top)
        cls.folder = unpack(cls.archive, top / "Müllers Büro – 車")
        cls.readme = (cls.folder / "README.txt").read_text()
        cls.component = Component(WIN64)

    def cmd(self, *words: str) -> str:
        """What a command printed in the folder of the zip."""
        return self.component.run("cmd", "/c", *words, folder=self.folder)

    def script(self, bits: str, *words: str) -> str:
        """What a script printed in the folder of the zip, run by the script host of that bitness."""
        return self.cmd(SCRIPT_HOSTS[bits], "//nologo", *words)

    def expected(self, sample: str) -> str:
        """What every sample of that name prints, in whatever language."""
        return (EXPECTED / sample).with_suffix(".txt").read_text()

    def first_example(self) -> tuple[str, str]:
        """The script that the README has one type, and what it says that it prints."""
        examples = examples_in(self.readme)
        script = next(i for i, text in enumerate(examples) if "CreateObject" in text)
        (self.folder / "first.vbs").write_text(examples[script], newline="\r\n")
        self.assertEqual(examples[script + 1], "cscript //nologo first.vbs\n")
        return "first.vbs", examples[script + 2]

    def registered(self, *word: str) -> None:
        whom = "you alone" if word else "all users"
        self.assertEqual(self.cmd("register.cmd", *word), self.words("registered", whom))
        self.addCleanup(self.cmd, "unregister.cmd", *word)

    @staticmethod
    def words(done: str, whom: str) -> str:
        return "".join(f"{bits}\\Varnex3.dll is {done} for {whom}.\n" for bits in ("win64", "win32"))

    # ---- the files

    def test_the_same_sources_give_the_same_bytes(self) -> None:
        with tempfile.TemporaryDirectory() as folder:
            self.assertEqual(make_zip(pathlib.Path(folder)).read_bytes(), self.archive.read_bytes())

    def test_what_is_opened_in_an_editor_has_the_line_ends_of_windows(self) -> None:
        with zipfile.ZipFile(self.archive) as archive:
            for name in archive.namelist():
                if not name.endswith((".dll", ".tlb", ".manifest")) and "/samples/inbox/" not in name:
                    content = archive.read(name)
                    self.assertEqual(content.count(b"\n"), content.count(b"\r\n"), name)

    def test_every_file_that_the_readme_names_is_there(self) -> None:
        named = re.findall(r"\b(?:samples|include|docs|win32)\\[\w.\\]*\w", self.readme)
        self.assertGreater(len(named), 5)
        for name in named:
            self.assertTrue((self.folder / name.replace("\\", "/")).exists(), name)

    # ---- registered

    def test_registered_the_first_example_and_the_samples_print_what_they_should(self) -> None:
        self.registered()
        example, shown = self.first_example()
        for bits in SCRIPT_HOSTS:
            with self.subTest(bits):
                self.assertEqual(self.script(bits, example).split(), shown.split())
                for script in ("inbox.vbs", "inbox.js", "record.vbs"):
                    printed = self.script(bits, rf"samples\windows\{script}")
                    self.assertEqual(plain(printed), self.expected(script), script)
                without_source = self.expected("record.js").replace(" from SourceDef.ParseXML", "")
                printed = self.script(bits, r"samples\windows\record.js")
                self.assertEqual(plain(printed), without_source)

    def test_the_session_in_the_documents_is_what_scripts_print(self) -> None:
        self.registered()
        text = (SOURCE / "docs/automation.md").read_text()
        session = re.findall(r"^> cscript //nologo (.*)\n([^`]*)```", text, re.MULTILINE)
        self.assertEqual(len(session), 3)
        for words, shown in session:
            self.assertEqual(self.script("win64", *words.split()).replace("\r\n", "\n"), shown)

    def test_registered_the_early_bound_samples_print_what_they_should(self) -> None:
        self.registered()
        for bits, compiler in COMPILERS.items():
            for sample in ("inbox", "record"):
                with self.subTest(f"{bits} {sample}"):
                    program = self.folder / f"{bits}-{sample}.exe"
                    source = self.folder / f"samples/windows/{sample}.cpp"
                    words = ["-std=c++17", "-static", *WARNINGS, "-isystem", self.folder / "include", source, "-o", program]
                    subprocess.run([compiler, *words, "-lole32", "-loleaut32", "-luuid"], check=True)
                    printed = self.component.run(program, folder=self.folder)
                    self.assertEqual(plain(printed), self.expected(sample))

    def test_unregistered_no_object_can_be_made(self) -> None:
        self.registered()
        self.assertEqual(self.cmd("unregister.cmd"), self.words("unregistered", "all users"))
        example, _ = self.first_example()
        for bits in SCRIPT_HOSTS:
            self.assertNotIn("<Vehicle>", self.script(bits, example))

    def test_one_user_registers_and_unregisters_without_the_machine(self) -> None:
        self.registered("user")
        key = r"\Software\Classes\Varnex3.VehicleDef\CLSID"
        self.assertIn("{", self.cmd("reg", "query", "HKCU" + key))
        self.assertNotIn("{", self.cmd("reg", "query", "HKLM" + key))
        self.assertEqual(self.cmd("unregister.cmd", "user"), self.words("unregistered", "you alone"))
        self.assertNotIn("{", self.cmd("reg", "query", "HKCU" + key))

    def test_what_cannot_be_registered_is_told_in_words(self) -> None:
        library = self.folder / "win32/Varnex3.dll"
        library.rename(library.with_suffix(".away"))
        self.addCleanup(lambda: library.with_suffix(".away").rename(library))
        self.addCleanup(self.cmd, "unregister.cmd")
        self.assertIn(r"win32\Varnex3.dll could not be registered: it cannot be loaded.", self.cmd("register.cmd"))
        self.assertIn("the only word it takes is user", self.cmd("register.cmd", "me"))

    # ---- not registered

    def test_beside_a_program_with_the_manifest_of_the_readme_nothing_is_registered(self) -> None:
        manifest = next(text for text in examples_in(self.readme) if "<dependency>" in text)
        for bits, folder in (("win64", "system32"), ("win32", "syswow64")):
            with self.subTest(bits):
                program = shutil.copy(self.component.drive / "windows" / folder / "cscript.exe", self.folder / bits)
                architecture = 'processorArchitecture="' + ("x86" if bits == "win32" else "amd64")
                own = re.sub('processorArchitecture="[^"]*', architecture, manifest)
                pathlib.Path(f"{program}.manifest").write_text(own)
                printed = self.component.run(program, "//nologo", r"samples\windows\record.vbs", folder=self.folder)
                self.assertEqual(plain(printed), self.expected("record"))

    # ---- in a process of its own

    def test_a_64_bit_host_uses_the_32_bit_component_in_another_process(self) -> None:
        register = (r"C:\windows\syswow64\regsvr32.exe", "/s", r"win32\Varnex3.dll")
        self.cmd(*register)
        self.addCleanup(self.cmd, register[0], "/u", *register[1:])
        self.assertEqual(self.script("win64", r"samples\windows\record.vbs"), "")
        self.cmd("reg", "import", "surrogate.reg")
        self.addCleanup(self.cmd, "reg", "import", "surrogate-undo.reg")
        self.addCleanup(self.cmd, "taskkill", "/f", "/im", "dllhost.exe")
        self.assertEqual(plain(self.script_apart("win64", r"samples\windows\record.vbs")), self.expected("record"))

    def script_apart(self, bits: str, script: str) -> str:
        """What a script printed that starts another process: that one lives on and keeps what it inherits open."""
        command = f"{SCRIPT_HOSTS[bits]} //nologo {script} > printed.txt"
        words = [SOURCE / "scripts/wine", WIN64, "cmd", "/c", command]
        subprocess.run(words, cwd=self.folder, stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL, timeout=300, check=False)
        return (self.folder / "printed.txt").read_text()


if __name__ == "__main__":
    unittest.main()
