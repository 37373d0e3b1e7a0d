"""The embedded CIM server on a simulated host, as a context manager."""

import json
import os
import re
import signal
import subprocess
import threading
from pathlib import Path

ROOT = Path(__file__).resolve().parent.parent
START_TIMEOUT = 60  # seconds; sanitized builds start slowly
STOP_TIMEOUT = 30  # seconds


class SimulatedServer:
    """Starts script/server on a free port; `lines` collects what it says on standard error."""

    def __init__(self, scenario="mixed", environment=None, options=None, module=None):
        """`options`, if any, replace --no-auth on the server's command line; `module` is served instead of the product's."""
        self.lines = []
        self.port = None
        self._started_or_ended = threading.Event()
        self._process = subprocess.Popen(
            [
                *[ROOT / "script/server", "--scenario", scenario, "--port", "0"],
                *(["--module", module] if module else []),
                *(["--", *options] if options else []),
            ],
            stdin=subprocess.DEVNULL,
            stdout=subprocess.PIPE,
            stderr=subprocess.PIPE,
            text=True,
            errors="replace",
            env={**os.environ, **(environment or {})},
        )
        self._readers = [
            threading.Thread(target=self._collect, args=[stream], daemon=True)
            for stream in (self._process.stdout, self._process.stderr)
        ]
        for reader in self._readers:
            reader.start()

        self._started_or_ended.wait(START_TIMEOUT)
        if self.port is None:
            self._process.kill()
            raise RuntimeError("the server did not start:\n" + "\n".join(self.lines))

    def _collect(self, stream):
        for line in stream:
            self.lines.append(line.rstrip("\n"))
            listening = re.search(r"listening on \S+:(\d+)", line)
            if listening:
                self.port = int(listening[1])
                self.url = f"http://127.0.0.1:{self.port}"
                self._started_or_ended.set()
        self._started_or_ended.set()

    @property
    def pid(self):
        return self._process.pid

    def arguments(self):
        """The server's own command line, as the system knows it."""
        return Path(f"/proc/{self.pid}/cmdline").read_text(encoding="utf-8").split("\0")[:-1]

    def hxasim(self, *words):
        """Steers the simulated host by the tool of that name; its answer."""
        socket, tool = re.search(r"HXASIM_CONTROL=(.+) (\S+/hxasim) status", "\n".join(self.lines)).groups()
        asked = subprocess.run([tool, "--socket", socket, *map(str, words)], capture_output=True, text=True, check=False)
        if asked.returncode != 0:
            raise RuntimeError(f"hxasim {words}: {asked.stdout}{asked.stderr}")
        return json.loads(asked.stdout)

    def send_signal(self, number):
        self._process.send_signal(number)

    def stop(self, with_signal=signal.SIGTERM):
        """Stops the server and returns its exit code."""
        if self._process.poll() is None:
            self._process.send_signal(with_signal)
        try:
            code = self._process.wait(STOP_TIMEOUT)
        except subprocess.TimeoutExpired:
            self._process.kill()
            raise
        for reader in self._readers:
            reader.join(STOP_TIMEOUT)
        return code

    def __enter__(self):
        return self

    def __exit__(self, *_):
        self.stop()
