"""Simulated hosts, and the program as a person runs it."""

import os
import subprocess
import sys
from pathlib import Path

import pytest

sys.path.insert(0, str(Path(__file__).resolve().parents[2]))

from tools.simulated_server import ROOT, SimulatedServer  # noqa: E402

PROGRAM = [sys.executable, "-B", str(ROOT / "client/zmlr-inventory")]


@pytest.fixture(scope="session")
def serve():
    """serve(scenario): a server that all tests share; options make one of the caller's own."""
    servers = {}

    def get(scenario, options=None):
        key = (scenario, *(options or []))
        if key not in servers:
            servers[key] = SimulatedServer(scenario, options=options)
        return servers[key]

    yield get
    for server in servers.values():
        server.stop()


@pytest.fixture
def run(tmp_path):
    """run(arguments...): what the program says and how it ends."""

    def start(*arguments, environment=None):
        return subprocess.run(
            [*PROGRAM, *map(str, arguments)],
            capture_output=True,
            text=True,
            encoding="utf-8",
            timeout=60,
            stdin=subprocess.DEVNULL,
            env={**os.environ, "HOME": str(tmp_path), **(environment or {})},
            check=False,
        )

    return start
