#!/usr/bin/env python3
"""Runs a test program for Windows with a database server: run_with_server.py BUILD PROGRAM.

Wine's ODBC leads to the driver manager of this system, and that to FreeTDS, registered under the drivers' names of Windows;
FreeTDS's own variables lead every connection string to the server.
"""

import os
import pathlib
import subprocess
import sys
import tempfile
import time

SOURCE = pathlib.Path(__file__).resolve().parents[3]
DRIVERS = "[SQL Server]\nDriver=libtdsodbc.so\n[SQL Native Client]\nDriver=libtdsodbc.so\n"
TEST = "[server]*"


def main() -> int:
    build, program = sys.argv[1:]
    with tempfile.TemporaryDirectory(prefix="varnex3-server-") as folder:
        ready = pathlib.Path(folder, "port")
        pathlib.Path(folder, "odbcinst.ini").write_text(DRIVERS)
        server = subprocess.Popen(
            [sys.executable, SOURCE / "tests/database/tds_server.py", "--port-file", ready, "--end-with-parent"],
            stdout=subprocess.DEVNULL,
        )
        try:
            while not ready.exists() and server.poll() is None:
                time.sleep(0.01)
            settings = {"ODBCSYSINI": folder, "TDSHOST": "127.0.0.1", "TDSPORT": ready.read_text().strip(), "TDSVER": "7.3"}
            return subprocess.run(
                [SOURCE / "scripts/wine", build, program, "-ns", f"-tc={TEST}"], env=os.environ | settings, check=False
            ).returncode
        finally:
            server.terminate()
            server.wait()


if __name__ == "__main__":
    sys.exit(main())
