#!/usr/bin/env python3
"""Checks that mistakes in the rows of a class do not compile, and say what is wrong.

    tests/compile_fail/check.py SOURCE_DIR COMPILER

Each file beside this one holds one mistake and begins with the words of the diagnostic: `// expect: ...`, with ` | `
between them where compilers word it differently. With VARNEX3_CORRECT defined the same file is correct and must
compile, so that it fails for its mistake alone.
"""

from __future__ import annotations

import pathlib
import subprocess
import sys

FLAGS = ["-std=c++20", "-fsyntax-only"]
EXPECT = "// expect: "


def compiled(command: list[str]) -> tuple[bool, str]:
    run = subprocess.run(command, capture_output=True, text=True, errors="replace")
    return run.returncode == 0, run.stdout + run.stderr


def fault_of(file: pathlib.Path, command: list[str]) -> str:
    """What is wrong with a file; nothing when it does what it should."""
    first = file.read_text(encoding="utf-8").splitlines()[0]
    if not first.startswith(EXPECT):
        return f"does not begin with {EXPECT!r}"
    expected = first.removeprefix(EXPECT)
    is_fine, said = compiled([*command, "-DVARNEX3_CORRECT", str(file)])
    if not is_fine:
        return "does not compile without its mistake:\n" + said
    is_fine, said = compiled([*command, str(file)])
    if is_fine:
        return "compiles with its mistake"
    said_in_errors = [line for line in said.splitlines() if "error:" in line]
    is_said = any(words in line for words in expected.split(" | ") for line in said_in_errors)
    return "" if is_said else f"does not say {expected!r}:\n{said}"


def main(source: str, compiler: str) -> int:
    command = [compiler, *FLAGS, f"-I{source}"]
    files = sorted(pathlib.Path(__file__).parent.glob("*.cpp"))
    faults = {file.name: fault for file in files if (fault := fault_of(file, command))}
    for name, fault in faults.items():
        print(f"{name}: {fault}")
    print(f"{len(files) - len(faults)} passed, {len(faults)} failed")
    return 0 if files and not faults else 1


if __name__ == "__main__":
    if len(sys.argv) != 3:
        sys.exit(__doc__)
    sys.exit(main(*sys.argv[1:]))
