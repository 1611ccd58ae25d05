"""The servers of this folder as tests use them: started, listening, and ended with the test."""

from __future__ import annotations

import json
import os
import pathlib
import subprocess
import sys
import tempfile
import time
from types import TracebackType
from typing import Any, Callable, Dict, List, Optional, Type

HERE = pathlib.Path(__file__).resolve().parent
PASSWORD = "x"
DRIVERS = {"SQL Server": "libtdsodbc.so", "SQL Native Client": "libtdsodbc.so", "MariaDB": "libmaodbc.so"}


def wait_for(what: str, is_there: Callable[[], bool], seconds: float = 10) -> None:
    end = time.monotonic() + seconds
    while not is_there():
        if time.monotonic() > end:
            raise AssertionError(f"{what} did not come in {seconds} seconds")
        time.sleep(0.01)


class Server:
    """A program of this folder that writes a file once it is ready."""

    program = ""
    longest_start = 10.0

    def __init__(self, *words: object) -> None:
        self.folder = tempfile.TemporaryDirectory(prefix="varnex3-database-")
        self.ready = pathlib.Path(self.folder.name, "ready")
        self.log_file = pathlib.Path(self.folder.name, "log")
        command = [sys.executable, str(HERE / self.program), "--port-file", str(self.ready)]
        command += [*self.common(), *map(str, words)]
        self.process = subprocess.Popen(command, stdin=subprocess.DEVNULL, stdout=subprocess.DEVNULL)
        try:
            wait_for(f"the answer of {self.program}", self.is_ready, self.longest_start)
        except AssertionError:
            self.stop()
            raise
        self.facts: Any = json.loads(self.ready.read_text(encoding="utf-8"))

    def common(self) -> List[str]:
        return []

    def is_ready(self) -> bool:
        if self.process.poll() is not None:
            raise AssertionError(f"{self.program} ended with {self.process.returncode}")
        return self.ready.exists()

    def stop(self) -> int:
        self.process.terminate()
        status = self.process.wait(timeout=30)
        self.folder.cleanup()
        return status

    def __enter__(self: Any) -> Any:
        return self

    def __exit__(self, _type: Optional[Type[BaseException]], _value: object, _trace: Optional[TracebackType]) -> None:
        self.stop()


class LoggingServer(Server):
    def common(self) -> List[str]:
        return ["--log", str(self.log_file), "--end-with-parent"]

    def log(self) -> List[Dict[str, Any]]:
        return [json.loads(line) for line in self.log_file.read_text(encoding="utf-8").splitlines()]

    def logged(self, event: str) -> List[Dict[str, Any]]:
        return [entry for entry in self.log() if entry["event"] == event]

    def last_call(self) -> Dict[str, Any]:
        return self.logged("rpc")[-1]


class TdsServer(LoggingServer):
    program = "tds_server.py"

    @property
    def port(self) -> int:
        return int(self.facts)


class SsrpServer(LoggingServer):
    program = "ssrp_server.py"

    @property
    def port(self) -> int:
        return int(self.facts)


class MariaDB(Server):
    program = "start_mariadb"
    longest_start = 90.0


def register_drivers(folder: pathlib.Path) -> None:
    """Makes the names of the drivers known to this process and those that it starts, and to nobody else."""
    text = "".join(f"[{name}]\nDriver={library}\n" for name, library in DRIVERS.items())
    (folder / "odbcinst.ini").write_text(text, encoding="utf-8")
    os.environ["ODBCSYSINI"] = str(folder)
