"""Packages from the npm registry, at an exact version and with a hash that is checked here: any npm will do."""

from __future__ import annotations

import base64
import hashlib
import json
import pathlib
import shutil
import subprocess
import tarfile
from collections.abc import Mapping


class NotDelivered(Exception):
    """Why a package could not be had; nobody has it halfway."""


def archives(packages: Mapping[str, str], folder: pathlib.Path) -> dict[str, pathlib.Path]:
    """The archive of each package, by its name and version. The values are hashes as npm writes them: sha512-..."""
    npm = shutil.which("npm")
    if npm is None:
        raise NotDelivered("npm is not installed")
    command = [npm, "pack", *packages, "--json", "--loglevel=error", "--pack-destination", str(folder)]
    done = subprocess.run(command, stdin=subprocess.DEVNULL, capture_output=True, text=True, timeout=300, check=False)
    if done.returncode != 0:
        raise NotDelivered(f"npm pack ended with {done.returncode} (offline?)\n{done.stderr.strip()}")
    delivered = {f"{entry['name']}@{entry['version']}": _archive(folder, entry) for entry in json.loads(done.stdout)}
    for package, integrity in packages.items():
        _check(package, delivered.get(package), integrity)
    return delivered


def _archive(folder: pathlib.Path, entry: Mapping[str, str]) -> pathlib.Path:
    """Some versions of npm tell another name than they give a package with a scope."""
    return folder / entry["filename"].removeprefix("@").replace("/", "-")


def _check(package: str, archive: pathlib.Path | None, integrity: str) -> None:
    if archive is None or not archive.is_file():
        raise NotDelivered(f"npm did not deliver {package}")
    found = "sha512-" + base64.b64encode(hashlib.sha512(archive.read_bytes()).digest()).decode()
    if found != integrity:
        raise NotDelivered(f"{package} is not the package that is expected: its hash is {found}")


def unpack(archive: pathlib.Path, folder: pathlib.Path, below: str = "") -> None:
    """The files of an archive without its outermost folder and what `below` names. The hash vouches for the names."""
    with tarfile.open(archive) as tar:
        for member in tar.getmembers():
            path = member.name.partition("/")[2]
            content = tar.extractfile(member) if member.isfile() and path.startswith(below) else None
            if content is not None:
                target = folder / path.removeprefix(below)
                target.parent.mkdir(parents=True, exist_ok=True)
                target.write_bytes(content.read())
