"""How the servers of these tests begin and end: what they wait for, and what ends them."""

from __future__ import annotations

import ctypes
import os
import pathlib
import signal
import sys
from types import FrameType
from typing import Optional

PR_SET_PDEATHSIG = 1


def end_with_parent() -> None:
    """The system sends SIGTERM when the parent ends, however it does. The caller is the program's first thread."""
    parent = os.getppid()
    ctypes.CDLL(None, use_errno=True).prctl(PR_SET_PDEATHSIG, signal.SIGTERM)
    if os.getppid() != parent:  # it ended before the request
        os.kill(os.getpid(), signal.SIGTERM)


def end_on_sigterm() -> None:
    def end(_number: int, _frame: Optional[FrameType]) -> None:
        sys.exit(0)

    signal.signal(signal.SIGTERM, end)
    signal.signal(signal.SIGINT, end)


def announce(text: str, file: Optional[pathlib.Path]) -> None:
    """Prints the text, and puts it into a file that appears only when it is complete."""
    print(text, flush=True)
    if file is not None:
        unfinished = file.with_name(file.name + ".part")
        unfinished.write_text(text + "\n", encoding="utf-8")
        unfinished.replace(file)
