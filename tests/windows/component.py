"""The component of a build folder, and programs for Windows that use it: run by Wine in the prefix of the folder.

A program's status proves nothing under Wine; what it printed does.
"""

from __future__ import annotations

import os
import pathlib
import shutil
import struct
import subprocess
import tempfile

SOURCE = pathlib.Path(__file__).resolve().parents[2]
LIBRARY = "Varnex3.dll"
I386 = 0x014C  # the machine in the header of a 32-bit program


def windows_path(path: pathlib.Path) -> str:
    """A file's path as programs for Windows see it."""
    return "Z:" + str(path).replace("/", "\\")


def is_32_bit(program: pathlib.Path) -> bool:
    image = program.read_bytes()[:4096]
    (header,) = struct.unpack_from("<I", image, 0x3C)
    return struct.unpack_from("<H", image, header + 4) == (I386,)


class Component:
    def __init__(self, build: pathlib.Path) -> None:
        self.build = build.resolve()
        self.library = self.build / LIBRARY
        self.is_32_bit = is_32_bit(self.library)
        self.hosts = self.build / "tests/windows"  # programs that need no registration
        self.drive = self.build / "wine/drive_c"
        self.run("cmd", "/c", "exit")  # the first program that runs makes the prefix

    def run(self, program: object, *arguments: object, folder: pathlib.Path | None = None, seconds: float = 120) -> str:
        """What a program printed. One that does not end in time is ended, with all that runs in the prefix."""
        late = ""
        with tempfile.TemporaryFile() as printed:  # a pipe would not end before Wine's own processes do, seconds later
            try:
                subprocess.run(
                    [SOURCE / "scripts/wine", self.build, str(program), *map(str, arguments)],
                    cwd=folder,
                    env=os.environ | {"VARNEX3_WINEARCH": "win32" if self.is_32_bit else "win64"},
                    stdin=subprocess.DEVNULL,
                    stdout=printed,
                    stderr=subprocess.STDOUT,
                    timeout=seconds,
                    check=False,
                )
            except subprocess.TimeoutExpired:
                self.end_wine()
                late = f"\n{program} did not end in {seconds:.0f} s\n"
            printed.seek(0)
            return printed.read().decode(errors="replace").replace("\r\n", "\n") + late

    def end_wine(self) -> None:
        """Ends all that runs in the prefix. Its registry is in its files then."""
        for option in ("-k", "-w"):
            prefix = {"WINEPREFIX": str(self.drive.parent)}
            subprocess.run(["wineserver", option], env=os.environ | prefix, stderr=subprocess.DEVNULL, check=False)

    def run_script(self, script: pathlib.Path, *arguments: object, folder: pathlib.Path | None = None) -> str:
        """What a script printed that runs in a copy of Windows' script host with the component beside it."""
        host = self.hosts / "cscript.exe"
        if not host.exists():
            shutil.copy(self.drive / "windows/system32/cscript.exe", host)
        return self.run(host, "//nologo", windows_path(script), *arguments, folder=folder)
