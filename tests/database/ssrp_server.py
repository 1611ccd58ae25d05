#!/usr/bin/env python3
"""Tells clients where a named instance listens, as the SQL Server Browser does on UDP port 1434.

    ssrp_server.py --instance SQLEXPRESS --tcp-port N [--port 1434] [--port-file F] [--log F]

It listens on 127.0.0.1 and ends on SIGTERM. As the real one, it does not answer about an instance that it does not
know. The log has one JSON object a line: the instance asked for ("" when all are) and whether there was an answer.
"""

from __future__ import annotations

import argparse
import json
import pathlib
import socket
from typing import Optional

from lifetime import announce, end_on_sigterm, end_with_parent

ALL_BROADCAST, ALL, ONE_INSTANCE, ANSWER = 2, 3, 4, 5


def instance_asked_for(request: bytes) -> Optional[str]:
    """The name, "" for all instances, nothing for what is no such request."""
    if request[:1] in (bytes([ALL_BROADCAST]), bytes([ALL])):
        return ""
    if request[:1] != bytes([ONE_INSTANCE]):
        return None
    return request[1:].split(b"\0")[0].decode("cp1252", errors="replace")


def answer_about(instance: str, port: int) -> bytes:
    facts = f"ServerName;TESTSERVER;InstanceName;{instance};IsClustered;No;Version;15.0.2000.5;tcp;{port};;"
    return bytes([ANSWER]) + len(facts).to_bytes(2, "little") + facts.encode("cp1252")


def main() -> None:
    parser = argparse.ArgumentParser(description=(__doc__ or "").splitlines()[0])
    parser.add_argument("--instance", required=True, help="the name of the one instance there is")
    parser.add_argument("--tcp-port", type=int, required=True, help="where it listens")
    parser.add_argument("--port", type=int, default=1434, help="where this program listens; 0 takes any free port")
    parser.add_argument("--port-file", type=pathlib.Path, help="where that port is written")
    parser.add_argument("--log", type=pathlib.Path, default=pathlib.Path("/dev/null"), help="where requests are logged")
    parser.add_argument("--end-with-parent", action="store_true", help="end when the starting program does")
    options = parser.parse_args()

    end_on_sigterm()
    if options.end_with_parent:
        end_with_parent()
    with socket.socket(socket.AF_INET, socket.SOCK_DGRAM) as listener, options.log.open("a", encoding="utf-8") as log:
        listener.bind(("127.0.0.1", options.port))
        announce(str(listener.getsockname()[1]), options.port_file)
        while True:
            request, client = listener.recvfrom(1024)
            instance = instance_asked_for(request)
            is_known = instance is not None and instance.lower() in ("", options.instance.lower())
            print(json.dumps({"instance": instance, "answered": is_known}), file=log, flush=True)
            if is_known:
                listener.sendto(answer_about(options.instance, options.tcp_port), client)


if __name__ == "__main__":
    main()
