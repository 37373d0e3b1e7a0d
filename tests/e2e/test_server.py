"""The server as a process: start, stop, and clients that behave badly while others are served."""

import re
import signal
import socket
import subprocess
import time
from concurrent.futures import ThreadPoolExecutor
from pathlib import Path

import pytest

from tools.simulated_server import ROOT

REQUEST = (ROOT / "tests/e2e/enumerate_host.xml").read_bytes()
HEADERS = "Host: localhost\r\nContent-Type: application/xml; charset=utf-8\r\nCIMOperation: MethodCall\r\n"


def connect(host):
    return socket.create_connection(("127.0.0.1", host.server.port), timeout=60)


def answer(connection):
    """Everything until the server closes."""
    parts = []
    while True:
        try:
            part = connection.recv(65536)
        except ConnectionError:
            break
        if not part:
            break
        parts.append(part)
    return b"".join(parts)


def post(host, body, headers=HEADERS):
    with connect(host) as connection:
        head = f"POST /cimom HTTP/1.1\r\n{headers}Connection: close\r\nContent-Length: {len(body)}\r\n\r\n"
        connection.sendall(head.encode() + body)
        return answer(connection)


def served(host):
    return len(host.device_ids()) > 0


@pytest.mark.parametrize("stop_signal", [signal.SIGTERM, signal.SIGINT])
def test_stops_cleanly(start, stop_signal):
    host = start("fc-hba")
    assert served(host)
    assert host.server.stop(stop_signal) == 0


def test_stops_while_clients_hang_on_it(start):
    host = start("fc-hba")
    with connect(host) as half:
        half.sendall(b"POST /cimom HTTP/1.1\r\nContent-Le")
        assert served(host)
        begin = time.monotonic()
        assert host.server.stop() == 0
        assert time.monotonic() - begin < 10


def signals_kept(pid):
    """The signals that a program would not get which the server's threads start: those blocked or ignored in any of them."""
    kept = 0
    for thread in Path(f"/proc/{pid}/task").iterdir():
        status = (thread / "status").read_text(encoding="utf-8")
        blocked, ignored = (int(re.search(rf"^{mask}:\s*(\w+)", status, re.M)[1], 16) for mask in ("SigBlk", "SigIgn"))
        kept |= ignored | blocked & ~(1 << signal.SIGPIPE - 1)  # the HTTP library's thread starts no programs
    return kept


def test_programs_that_the_module_starts_can_be_stopped(mixed):
    build = Path(mixed.server.arguments()[0]).parents[1]
    if "fsanitize=thread" in (build / "build.ninja").read_text(encoding="utf-8"):
        pytest.skip("the thread sanitizer has a thread of its own that blocks everything")
    wanted = sum(1 << number - 1 for number in (signal.SIGTERM, signal.SIGINT, signal.SIGPIPE))
    deadline = time.monotonic() + 10
    while signals_kept(mixed.server.pid) & wanted and time.monotonic() < deadline:
        time.sleep(0.1)  # a thread that is being started blocks everything for a moment
    assert not signals_kept(mixed.server.pid) & wanted


def test_says_what_is_wrong_at_the_start(mixed):
    server = next(line for line in mixed.server.arguments() if line.endswith("zmlr-cimserver"))
    module = mixed.server.arguments()[mixed.server.arguments().index("--module") + 1]
    cases = [
        (["--module", "/nonexistent.so", "--port", "0"], 1, "/nonexistent.so"),
        (["--module", server, "--port", "0"], 1, server),
        (["--module", module, "--port", str(mixed.server.port)], 1, str(mixed.server.port)),
        (["--port", "0"], 2, "--module"),
        (["--module", module, "--port", "65536"], 2, "65536"),
        (["--module", module, "--port", "-1"], 2, "-1"),
        (["--module", module, "--workers", "0"], 2, "--workers"),
        (["--module", module, "--colour"], 2, "--colour"),
    ]
    for arguments, code, told in cases:
        done = subprocess.run([server, "--no-auth", *arguments], capture_output=True, text=True, timeout=60, check=False)
        assert done.returncode == code, arguments
        assert told in done.stderr
        assert done.stdout == ""


@pytest.mark.parametrize(
    "body,expected",
    [
        (b"", b" 400 "),
        (b"<CIM", b"request-not-well-formed"),
        (b"\x00\xff\xfe", b" 400 "),
        (b'<?xml version="1.0"?><HELLO/>', b" 400 "),
        (b'<?xml version="1.0"?><!DOCTYPE x [<!ENTITY a "b">]><x>&a;</x>', b" 400 "),
        (REQUEST.replace(b"EnumerateInstanceNames", b"FlyToTheMoon"), b'CODE="7"'),
        (REQUEST.replace(b'NAME="zemlar"', b'NAME="elsewhere"'), b'CODE="3"'),
        (REQUEST.replace(b"ZEMLAR_ComputerSystem", b"ZEMLAR_" + b"x" * 1_000_000), b'CODE="5"'),
        (REQUEST, b"<INSTANCENAME"),
    ],
    ids=["empty", "cut", "bytes", "no CIM", "entity", "operation", "name space", "long class", "good"],
)
def test_every_body_gets_a_proper_answer(mixed, body, expected):
    assert expected in post(mixed, body)


def test_100_megabytes_are_refused_without_being_read(mixed):
    with connect(mixed) as connection:
        connection.sendall(f"POST /cimom HTTP/1.1\r\n{HEADERS}Content-Length: 104857600\r\n\r\n".encode())
        assert b" 413 " in connection.recv(4096)
    assert served(mixed)


def test_100_megabytes_in_chunks_are_refused_on_the_way(mixed):
    head = f"POST /cimom HTTP/1.1\r\n{HEADERS}Transfer-Encoding: chunked\r\n\r\n".encode()
    chunk = b"10000\r\n" + b"x" * 0x10000 + b"\r\n"
    with connect(mixed) as connection:
        connection.sendall(head + 32 * chunk + b"0\r\n\r\n")  # 2 MB: the body ends before the server loses patience
        assert b" 413 " in connection.recv(4096)
    with connect(mixed) as connection, pytest.raises(ConnectionError):
        connection.sendall(head)
        for _ in range(1600):
            connection.sendall(chunk)
    assert served(mixed)


def test_other_methods_are_refused(mixed):
    with connect(mixed) as connection:
        connection.sendall(b"GET / HTTP/1.1\r\nHost: localhost\r\nConnection: close\r\n\r\n")
        assert b" 405 " in answer(connection)


def test_closing_half_way_harms_nobody(mixed):
    for cut in range(0, len(REQUEST), 97):
        with connect(mixed) as connection:
            head = f"POST /cimom HTTP/1.1\r\n{HEADERS}Content-Length: {len(REQUEST)}\r\n\r\n"
            connection.sendall(head.encode() + REQUEST[:cut])
    assert served(mixed)


def test_one_byte_a_second_holds_up_nobody(mixed):
    with connect(mixed) as slow:
        request = f"POST /cimom HTTP/1.1\r\n{HEADERS}".encode()
        for byte in request[:5]:
            slow.sendall(bytes([byte]))
            begin = time.monotonic()
            assert served(mixed)
            assert time.monotonic() - begin < 30
            time.sleep(1)


def test_200_connections_at_once(mixed):
    idle = [connect(mixed) for _ in range(200)]
    try:
        with ThreadPoolExecutor(20) as pool:
            answers = list(pool.map(lambda _: post(mixed, REQUEST), range(200)))
        accepted = [text for text in answers if b" 200 " in text[:20]]
        refused = [text for text in answers if b" 503 " in text[:20]]
        assert len(accepted) + len(refused) == 200
        assert accepted
        assert all(b"<INSTANCENAME" in text for text in accepted)
    finally:
        for connection in idle:
            connection.close()
    assert served(mixed)
