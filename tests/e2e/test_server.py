"""The server as a process: start, stop, and clients that behave badly while others are served."""

import re
import signal
import socket
import subprocess
import time
from concurrent.futures import ThreadPoolExecutor
from pathlib import Path

import pytest
from conftest import REQUEST, post

HEAD = b"POST /cimom HTTP/1.1\r\nHost: localhost\r\n"
BODY = b"Content-Length: %d\r\n\r\n%b" % (len(REQUEST), REQUEST)
CHUNKS = b"Transfer-Encoding: chunked\r\n\r\n"


def connect(host):
    return socket.create_connection(("127.0.0.1", host.server.port), timeout=60)


def served(host):
    return len(host.device_ids()) > 0


@pytest.mark.parametrize("stop_signal", [signal.SIGTERM, signal.SIGINT])
def test_stops_while_clients_hang_on_it(start, stop_signal):
    host = start("fc-hba")
    with connect(host) as half:
        half.sendall(b"POST /cimom HTTP/1.1\r\nContent-Le")
        assert served(host)
        begin = time.monotonic()
        assert host.server.stop(stop_signal) == 0
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


def test_says_what_is_wrong_at_the_start(mixed, program):
    server, _, module, *port_0 = program
    for arguments, code, told in [
        (["--module", "/nonexistent.so", *port_0], 1, "/nonexistent.so"),
        (["--module", server, *port_0], 1, server),
        (["--module", module, "--port", str(mixed.server.port)], 1, str(mixed.server.port)),
        (port_0, 2, "--module"),
        (["--module", module, "--port", "65536"], 2, "65536"),
        (["--module", module, "--workers", "0"], 2, "--workers"),
        (["--module", module, "--colour"], 2, "--colour"),
    ]:
        done = subprocess.run([server, "--no-auth", *arguments], capture_output=True, text=True, timeout=60, check=False)
        assert (done.returncode, done.stdout) == (code, ""), arguments
        assert told in done.stderr


@pytest.mark.parametrize(
    "request_bytes,answers",
    [
        (HEAD + b"CIMOperation: MethodCall\r\n" + BODY, [b"200 OK", b"CIMOperation: MethodResponse", b"<INSTANCENAME"]),
        (HEAD + b"CIMOperation: MethodRequest\r\n" + BODY, [b"400", b"CIMError: unsupported-operation"]),
        (HEAD + BODY + HEAD + BODY, [b"<INSTANCENAME", b"HTTP/1.1 200", b"<INSTANCENAME"]),
        (HEAD + CHUNKS + b"%x\r\n%b\r\n1\r\n \r\n0\r\n\r\n" % (len(REQUEST), REQUEST), [b"<INSTANCENAME"]),
        (b"POST / HTTP/1.0\r\n" + BODY, [b"<INSTANCENAME"]),
        (b"GET / HTTP/1.1\r\nHost: x\r\n\r\n", [b"405", b"Allow: POST"]),
        (b"M-POST / HTTP/1.1\r\nHost: x\r\n\r\n", [b"405"]),
        (b"BREW / HTTP/1.1\r\nHost: x\r\n\r\n", [b"405"]),
        (HEAD + b"Content-Length: 0\r\n\r\n", [b"400", b"request-not-well-formed"]),
        (HEAD + b"Content-Length: many\r\n\r\n", [b"400"]),
        (HEAD + b"X: " + b"x" * 100_000 + b"\r\n\r\n", [b"431"]),
        (HEAD + b"Content-Length: 104857600\r\n\r\n", [b"413"]),  # answered before any of it is read
        (HEAD + b"Expect: 100-continue\r\nContent-Length: 99999999999999999999999\r\n\r\n", [b"413"]),
        (HEAD + CHUNKS + 2 * (b"100000\r\n%b\r\n" % (b"x" * 2**20)) + b"0\r\n\r\n", [b"413"]),
        (HEAD + b"Content-Length: 1048577\r\n\r\n", [b"413"]),
        (HEAD + b"Content-Length: 1048576\r\n\r\n" + b"x" * 2**20, [b"400", b"request-not-well-formed"]),
    ],
    ids=lambda value: "" if isinstance(value, list) else None,
)
def test_every_request_gets_its_answer(mixed, request_bytes, answers):
    with connect(mixed) as connection:
        connection.sendall(request_bytes)
        seen = b""
        for wanted in answers:
            while wanted not in seen:
                part = connection.recv(65536)
                assert part, seen
                seen += part
            seen = seen.partition(wanted)[2]


@pytest.mark.parametrize(
    "what,instead,code",
    [
        (b"EnumerateInstanceNames", b"FlyToTheMoon", 7),
        (b"ZEMLAR_ComputerSystem", b"ZEMLAR_" + b"x" * 1_000_000, 5),
    ],
    ids=["operation", "long class"],
)
def test_what_is_not_there_is_told(mixed, what, instead, code):
    assert b'<ERROR CODE="%d" DESCRIPTION="' % code in post(mixed.server.port, REQUEST.replace(what, instead))


def test_a_body_without_end_is_cut(mixed):
    with connect(mixed) as connection, pytest.raises(ConnectionError):
        connection.sendall(HEAD + CHUNKS)
        for _ in range(100):
            connection.sendall(b"100000\r\n%b\r\n" % (b"x" * 2**20))
    assert served(mixed)


def test_closing_half_way_harms_nobody(mixed):
    for cut in range(0, len(BODY), 97):
        with connect(mixed) as connection:
            connection.sendall(HEAD + BODY[:cut])
    assert served(mixed)


def test_200_connections_at_once(mixed):
    idle = [connect(mixed) for _ in range(200)]
    with ThreadPoolExecutor(20) as pool:
        answers = list(pool.map(lambda _: post(mixed.server.port), range(200)))
    accepted = [text for text in answers if b" 200 " in text[:20]]
    assert len(accepted) + sum(b" 503 " in text[:20] for text in answers) == 200
    assert accepted and all(b"<INSTANCENAME" in text for text in accepted)
    for connection in idle:
        connection.close()
    assert served(mixed)
