#!/usr/bin/env python3
"""A server for tests that speaks TDS, the protocol of SQL Server, and logs what it was sent.

    tds_server.py --port 0 --port-file F --log F [--password x]

It listens on 127.0.0.1, prints its port and writes it to the port file once it does, and ends on SIGTERM. User sa logs
in. The stored procedures are those of tds_procedures.py. The log has one JSON object a line: `event` is login, rpc,
batch, attention, hang_up (the server did), closed_idle, gone (the client has), broken, unreadable or accepted;
`connection` numbers the clients from 1. The password is never logged, only whether it was right.
"""

from __future__ import annotations

import argparse
import contextlib
import itertools
import json
import pathlib
import socket
import threading
import time
from typing import Any, Dict, Optional

from lifetime import announce, end_on_sigterm, end_with_parent
from tds_session import Session, Surroundings


class Log:
    def __init__(self, file: pathlib.Path) -> None:
        self.file = file.open("a", encoding="utf-8")
        self.lock = threading.Lock()

    def write(self, entry: Dict[str, Any]) -> None:
        with self.lock:
            print(json.dumps(entry, ensure_ascii=False), file=self.file, flush=True)


class Server:
    def __init__(self, listener: socket.socket, log: Log, password: str, is_silent: bool) -> None:
        self.listener = listener
        self.log = log
        self.password = password
        self.is_silent = is_silent
        self.clients: Dict[int, socket.socket] = {}
        self.lock = threading.Lock()

    def serve(self, limit: Optional[int]) -> None:
        """Takes clients, a thread each; once there were so many as the limit says, it refuses the rest."""
        for number in itertools.count(1):
            if limit is not None and number > limit:
                break
            client, _ = self.listener.accept()
            client.setsockopt(socket.IPPROTO_TCP, socket.TCP_NODELAY, 1)
            with self.lock:
                self.clients[number] = client
            threading.Thread(target=self.attend, args=(number, client), daemon=True).start()
        self.listener.close()
        while True:
            time.sleep(3600)

    def attend(self, number: int, client: socket.socket) -> None:
        def log(entry: Dict[str, Any]) -> None:
            self.log.write({"connection": number, **entry})

        if self.is_silent:
            log({"event": "accepted"})
            while client.recv(4096):
                pass
        else:
            Session(client, Surroundings(self.password, log, lambda: self.close_all_but(number))).run()
        with self.lock:
            self.clients.pop(number, None)
        client.close()

    def close_all_but(self, number: int) -> int:
        with self.lock:
            others = [client for key, client in self.clients.items() if key != number]
        for client in others:
            with contextlib.suppress(OSError):  # it has gone meanwhile
                client.shutdown(socket.SHUT_RDWR)
        return len(others)


def arguments() -> argparse.Namespace:
    parser = argparse.ArgumentParser(description=(__doc__ or "").splitlines()[0])
    parser.add_argument("--port", type=int, default=0, help="0, the default, takes any free port")
    parser.add_argument("--port-file", type=pathlib.Path, help="where the port is written")
    parser.add_argument("--log", type=pathlib.Path, default=pathlib.Path("/dev/null"), help="where requests are logged")
    parser.add_argument("--password", default="x", help="of the user sa; x by default")
    parser.add_argument("--silent-login", action="store_true", help="accept connections and never answer")
    parser.add_argument("--refuse-after", type=int, metavar="N", help="refuse every connection after the Nth")
    parser.add_argument("--end-with-parent", action="store_true", help="end when the starting program does")
    return parser.parse_args()


def main() -> None:
    options = arguments()
    end_on_sigterm()
    if options.end_with_parent:
        end_with_parent()
    listener = socket.create_server(("127.0.0.1", options.port), backlog=64)
    announce(str(listener.getsockname()[1]), options.port_file)
    Server(listener, Log(options.log), options.password, options.silent_login).serve(options.refuse_after)


if __name__ == "__main__":
    main()
