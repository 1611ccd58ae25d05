#!/usr/bin/env python3
"""What scripts see of the component: test_scripts.py BUILD.

Runs hosts.vbs and hosts.js, which state facts, and the sessions that docs/automation.md shows: each prints what stands
there. Shows what does not hold, and ends with "N passed, N failed".
"""

from __future__ import annotations

import difflib
import pathlib
import re
import sys

from component import SOURCE, Component

SCRIPTS = ("hosts.vbs", "hosts.js")
CLOSING = re.compile(r"^(\d+) passed, (\d+) failed\n\Z", re.MULTILINE)
SESSION = re.compile(r"^```text\n> cscript //nologo (.+)\n((?:.*\n)*?)```$", re.MULTILINE)
PAGE = "docs/automation.md"


def facts(component: Component, script: str) -> tuple[int, int]:
    printed = component.run_script(SOURCE / "tests/windows" / script)
    closing = CLOSING.search(printed)
    if closing is None:
        print(f"{script} ended without counting its facts:\n{printed}")
        return 0, 1
    for line in printed.splitlines()[:-1]:
        if not line.startswith("ok "):
            print(f"{script}: {line}")
    return int(closing[1]), int(closing[2])


def session(component: Component, command: str, shown: str) -> tuple[int, int]:
    """A session as it stands in the documents, on the sample inbox."""
    script, *arguments = command.split()
    printed = component.run_script(SOURCE / script.replace("\\", "/"), *arguments, folder=SOURCE)
    if printed == shown:
        return 1, 0
    print(*difflib.unified_diff(shown.splitlines(), printed.splitlines(), PAGE, command, lineterm=""), sep="\n")
    return 0, 1


def main(build: str) -> int:
    component = Component(pathlib.Path(build))
    results = [facts(component, script) for script in SCRIPTS]
    sessions = SESSION.findall((SOURCE / PAGE).read_text(encoding="utf-8"))
    results += [session(component, *found) for found in sessions]
    if not sessions:
        print(f"{PAGE} shows no session")
        results.append((0, 1))
    passed, failed = (sum(column) for column in zip(*results))
    print(f"{passed} passed, {failed} failed")
    return 0 if passed and not failed else 1


if __name__ == "__main__":
    sys.exit(main(*sys.argv[1:]))
