#!/usr/bin/env python3
"""The Debian packages: made, installed with what they depend on in a root that has only Debian's essential packages, used
there, and purged. Making that root needs root.

VARNEX3_SOURCE_DIR and VARNEX3_BINARY_DIR are the source and the build folder.
"""

from __future__ import annotations

import os
import pathlib
import platform
import shutil
import subprocess
import sys
import tempfile
import unittest

SOURCE = pathlib.Path(os.environ["VARNEX3_SOURCE_DIR"])
BINARY = pathlib.Path(os.environ["VARNEX3_BINARY_DIR"])
EXPECTED = SOURCE / "tests/dist/expected"
PACKAGES = ("libvarnex3-3", "libvarnex3-dev", "python3-varnex3", "varnex3")
SHOW_THROUGH = "/usr/share/mmdebstrap/hooks/file-mirror-automount"  # packages outside of the root are seen in it


def run(*command: object, status: int = 0, **options: object) -> str:
    done = subprocess.run([str(word) for word in command], capture_output=True, text=True, **options)  # type: ignore[call-overload]
    if done.returncode != status:
        raise AssertionError(f"{command} ended with {done.returncode}:\n{done.stdout}{done.stderr}")
    return str(done.stdout)  # as text: CR LF is read as LF


def source_of_packages() -> str:
    """The release's own packages, from where this machine has its own: a line as sources.list has them."""
    release = platform.freedesktop_os_release()["VERSION_CODENAME"]
    targets = run("apt-get", "indextargets", "--format", "$(RELEASE) $(COMPONENT) $(REPO_URI)", "Created-By: Packages")
    address = next(line.split()[2] for line in targets.splitlines() if line.startswith(f"{release} main "))
    return f"deb {address} {release} main"


class Root:
    """A folder with a small Debian of its own, where the packages are installed."""

    def __init__(self, folder: pathlib.Path) -> None:
        self.packages = folder / "packages"
        self.path = folder / "root"
        run(SOURCE / "scripts/make_dist", "debian", BINARY, self.packages)
        included = [f"--include={file}" for file in sorted(self.packages.glob("*.deb"))]
        words = ["--mode=root", "--variant=essential", f"--hook-dir={SHOW_THROUGH}", *included]
        release = platform.freedesktop_os_release()["VERSION_CODENAME"]
        run("mmdebstrap", "--quiet", *words, release, self.path, source_of_packages(), cwd="/")

    def run(self, *command: object, status: int = 0) -> str:
        clean = {"PATH": "/usr/sbin:/usr/bin:/sbin:/bin", "LC_ALL": "C.UTF-8"}
        return run("chroot", self.path, *command, status=status, env=clean)

    def files_of(self, *packages: str) -> set[str]:
        return set(self.run("dpkg", "--listfiles", *packages).split("\n")) - {"", "/."}

    def compile(self, program: str, *sources: pathlib.Path, package: str) -> str:
        """Compiles with this machine's compiler and the packages' headers and libraries."""
        folder = next(self.path.glob("usr/lib/**/pkgconfig"))
        environment = os.environ | {"PKG_CONFIG_LIBDIR": str(folder), "PKG_CONFIG_ALLOW_SYSTEM_CFLAGS": "1",
                                    "PKG_CONFIG_ALLOW_SYSTEM_LIBS": "1"}
        words = run("pkg-config", "--cflags", "--libs", package, env=environment).split()
        compiler = ["g++", "-std=c++20"] if package == "varnex3" else ["gcc"]
        run(*compiler, *sources, "-o", self.path / program, *words)
        return f"/{program}"


@unittest.skipIf(os.geteuid() != 0, "only root can make a root to install into")
@unittest.skipUnless(shutil.which("mmdebstrap"), "mmdebstrap is not installed")
class Packages(unittest.TestCase):
    root: Root

    @classmethod
    def setUpClass(cls) -> None:
        folder = tempfile.mkdtemp(prefix="varnex3-packages-")
        cls.addClassCleanup(shutil.rmtree, folder)
        cls.root = Root(pathlib.Path(folder))

    def expected(self, name: str) -> str:
        return (EXPECTED / name).read_text()

    def test_all_four_are_installed(self) -> None:
        states = self.root.run("dpkg-query", "-W", "-f", "${Package} ${db:Status-Status}\\n", *PACKAGES)
        self.assertEqual(states.split("\n")[:-1], [f"{name} installed" for name in PACKAGES])

    def test_each_says_its_licence_and_its_changes(self) -> None:
        for package in PACKAGES:
            with self.subTest(package):
                folder = self.root.path / "usr/share/doc" / package
                self.assertIn("Expat", (folder / "copyright").read_text())
                self.assertIn(f"varnex3 ({self.version()})", run("zcat", folder / "changelog.gz"))

    def version(self) -> str:
        return self.root.run("dpkg-query", "-W", "-f", "${Version}", "varnex3")

    def test_the_program_lists_the_sample_inbox(self) -> None:
        shutil.copytree(SOURCE / "samples/inbox", self.root.path / "srv/inbox")
        listed = self.root.run("varnex3", "scan", "/srv/inbox", status=1)  # some of the files are broken
        self.assertIn("job-4711-2-quote.xml", listed)
        self.assertTrue((self.root.path / "usr/share/man/man1/varnex3.1.gz").exists())

    def test_a_cpp_program_is_built_from_the_development_files_and_runs(self) -> None:
        program = self.root.compile("record", SOURCE / "samples/cpp/record.cpp", package="varnex3")
        self.assertEqual(self.root.run(program), self.expected("record.txt"))

    def test_a_c_program_runs_with_the_shared_library(self) -> None:
        program = self.root.compile("c_face", SOURCE / "tests/c/c_face.c", package="varnex3_c")
        self.assertIn(" 0 failed", self.root.run(program))

    def test_a_cmake_project_finds_the_development_files(self) -> None:
        with tempfile.TemporaryDirectory() as build:
            found = run("cmake", "-S", SOURCE / "samples/cpp", "-B", build, f"-DCMAKE_PREFIX_PATH={self.root.path}/usr",
                        "-DCMAKE_FIND_USE_CMAKE_SYSTEM_PATH=OFF")
            self.assertIn("Generating done", found)

    def test_python_writes_and_reads_a_record(self) -> None:
        shutil.copy(SOURCE / "samples/python/record.py", self.root.path / "srv")
        self.assertEqual(self.root.run("python3", "/srv/record.py"), self.expected("record.txt"))

    def test_zz_purged_they_leave_nothing(self) -> None:  # the last one, by its name
        owned = self.root.files_of(*PACKAGES)
        self.root.run("dpkg", "--purge", *PACKAGES)
        others = {str(pathlib.Path("/", path)) for path in self.root.files_of(*self.installed())}
        left = {path for path in owned - others if os.path.lexists(f"{self.root.path}{path}")}
        self.assertEqual(left, set())
        named = run("find", self.root.path, "-xdev", "-iname", "*varnex3*", "-not", "-path", "*/srv/*")
        self.assertEqual(named, "")

    def installed(self) -> list[str]:
        return self.root.run("dpkg-query", "-W", "-f", "${binary:Package}\\n").split()


if __name__ == "__main__":
    unittest.main()
