"""The server as a process: start, stop, and clients that behave badly while others are served."""

import os
import re
import select
import signal
import socket
import subprocess
import sys
import time
from concurrent.futures import ThreadPoolExecutor
from pathlib import Path

import pytest
import pywbem
from conftest import REQUEST, post, wait_until

from tools.simulated_server import ROOT

BARE = b"POST /cimom HTTP/1.1\r\nHost: localhost\r\n"
CALL = b"CIMOperation: MethodCall\r\n"
HEAD = BARE + CALL
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


def test_only_term_and_int_end_it(start):
    host = start("fc-hba")
    for name in ("HUP", "USR1", "USR2", "QUIT", "ALRM", "PIPE", "IO", "PWR"):
        os.kill(host.server.pid, signal.Signals[f"SIG{name}"])
    assert served(host)
    assert host.server.stop() == 0


@pytest.mark.parametrize("address", ["{folder}/notify", "\0zmlr-{process}"])
def test_tells_systemd_when_it_listens(start, tmp_path, address):
    address = address.format(folder=tmp_path, process=os.getpid())
    with socket.socket(socket.AF_UNIX, socket.SOCK_DGRAM) as manager:
        manager.bind(address)
        manager.settimeout(60)
        host = start("fc-hba", {"NOTIFY_SOCKET": address.replace("\0", "@")})
        assert manager.recv(100) == b"READY=1"
        assert served(host)


def test_closed_standard_descriptors_are_taken_by_nothing_else(program, tmp_path):
    command = 'exec "$@" <&- >&- 2>&-'
    process = subprocess.Popen(["sh", "-c", command, "sh", *program, "--no-auth"], cwd=tmp_path)
    try:
        descriptors = Path(f"/proc/{process.pid}/fd")
        wait_until(lambda: len(list(descriptors.iterdir())) > 5)  # it listens
        assert {os.readlink(descriptors / number) for number in "012"} == {"/dev/null"}
    finally:
        process.terminate()
        assert process.wait(60) == 0


def test_a_hung_driver_stops_only_its_provider(start, tmp_path):
    control = tmp_path / "control"
    host = start("fc-hba", {"HXASIM_CONTROL": str(control)}, ["--no-auth", "--provider-timeout", "6"])
    hxasim = [Path(host.server.arguments()[0]).parents[1] / "sim/hxasim", "--socket", control]
    subprocess.run([*hxasim, "fault", "--command", "IOCMD_PORT_GET_ATTR", "--delay", "600000"], check=True, timeout=60)
    body = REQUEST.replace(b"ZEMLAR_ComputerSystem", b"ZEMLAR_FCPort")
    hung = []
    for _ in range(300):  # more than the server has connections
        hung.append(connect(host))
        hung[-1].sendall(HEAD + b"Content-Length: %d\r\n\r\n%b" % (len(body), body))
    begin = time.monotonic()
    while True:
        try:
            assert len(host.pywbem.EnumerateClassNames(DeepInheritance=True)) == 177
            break
        except pywbem.HTTPError as error:
            assert error.status == 503 and time.monotonic() - begin < 5, "those 300 may have filled the queue for a moment"
    assert len(host.pywbem.EnumerateInstanceNames("CIM_Namespace", "root/PG_InterOp")) == 4
    assert time.monotonic() - begin < 6

    wait_until(lambda: len(select.select(hung, [], [], 0)[0]) >= 298)
    told = [connection.recv(65536) for connection in select.select(hung, [], [], 0)[0]]
    assert len(told) == 298, "two are with the provider"
    waited = [answer for answer in told if b"ZEMLAR_FCPort does not answer: earlier requests have kept it busy for 6 s" in answer]
    assert len(waited) > 100
    assert len(waited) + sum(answer == b"" or answer.startswith(b"HTTP/1.1 503") for answer in told) == 298, "cut or told"
    assert len(host.pywbem.EnumerateInstances("ZEMLAR_ComputerSystem")) == 1, "another provider"
    begin = time.monotonic()
    assert host.server.stop() == 0
    assert time.monotonic() - begin < 12


def signals_kept(pid):
    """The signals that a program would not get which the server's threads start: those blocked or ignored in any of them."""
    kept = 0
    for thread in Path(f"/proc/{pid}/task").iterdir():
        status = (thread / "status").read_text(encoding="utf-8")
        blocked, ignored = (int(re.search(rf"^{mask}:\s*(\w+)", status, re.M)[1], 16) for mask in ("SigBlk", "SigIgn"))
        kept |= ignored | blocked & ~(1 << signal.SIGPIPE - 1)  # the HTTP library's thread starts no programs
    return kept


def test_programs_that_the_module_starts_can_be_stopped(start):
    mixed = start("mixed", {"HXASIM_CONTROL": "off"})  # its thread takes no signals, and starts no programs
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
        (["--module", str(Path(server).parents[1] / "sim/libhxasim.so"), *port_0], 1, "has no function cimple_module"),
        (["--module", module, "--port", str(mixed.server.port)], 1, str(mixed.server.port)),
        (port_0, 2, "--module"),
        (["--module", module, "--port", "65536"], 2, "65536"),
        (["--module", module, "--workers", "0"], 2, "--workers"),
        (["--module", module, "--colour"], 2, "--colour"),
        (["--module", module, "--max-connections", "10000", *port_0], 1, "lower --max-connections"),
    ]:
        limited = ["prlimit", "--nofile=2048:2048", server, "--no-auth", *arguments]
        done = subprocess.run(limited, capture_output=True, text=True, timeout=60, check=False)
        assert (done.returncode, done.stdout) == (code, ""), arguments
        assert told in done.stderr


def test_help_shows_units(program):
    hxasim = Path(program[0]).parents[1] / "sim/hxasim"
    commands = [[path] for path in [program[0], hxasim, *(ROOT / "script").iterdir()] if os.access(path, os.X_OK)]
    commands += [[hxasim, name] for name in ("event", "fault", "plug", "port")]
    tools = [path for folder in ("bench", "schema", "tools") for path in (ROOT / folder).glob("*.py")]
    commands += [[sys.executable, path] for path in tools if "__main__" in path.read_text(encoding="utf-8")]
    told = ""
    for command in commands:
        command = ["env", f"PYTHONPATH={ROOT}", *command, "--help"]
        done = subprocess.run(command, capture_output=True, text=True, timeout=60, check=False)
        assert (done.returncode, done.stderr, len(done.stdout) > 50) == (0, "", True), command
        told += done.stdout
    assert all(text in told for text in ("--max-request BYTES", "--delivery-pause SECONDS", "--delay MILLISECONDS", "PROGRAM"))
    assert not re.search(r"\b(TEXT|UINT|INT|FLOAT)\b", told)


@pytest.mark.parametrize(
    "request_bytes,answers",
    [
        (HEAD + BODY, [b"200 OK", b"CIMOperation: MethodResponse", b"<INSTANCENAME"]),
        (BARE + b"CIMOperation: MethodRequest\r\n" + BODY, [b"400", b"CIMError: unsupported-operation"]),
        # What a web page can send: no header of its own, its own name that leads here, or where it comes from.
        (BARE + BODY, [b"400", b"CIMError: unsupported-operation"]),
        (HEAD.replace(b"localhost", b"evil.example:5988") + BODY, [b"403"]),
        (HEAD.replace(b"localhost", b"127.0.0.1.evil.example") + BODY, [b"403"]),
        (HEAD + b"Origin: http://localhost\r\n" + BODY, [b"403"]),
        (HEAD + b"Origin: null\r\n" + BODY, [b"403"]),
        (HEAD.replace(b"localhost", b"127.0.0.1:5988") + BODY, [b"<INSTANCENAME"]),
        (HEAD.replace(b"localhost", b"[::1]:5988") + BODY, [b"<INSTANCENAME"]),
        (HEAD + BODY + HEAD + BODY, [b"<INSTANCENAME", b"HTTP/1.1 200", b"<INSTANCENAME"]),
        (HEAD + CHUNKS + b"%x\r\n%b\r\n1\r\n \r\n0\r\n\r\n" % (len(REQUEST), REQUEST), [b"<INSTANCENAME"]),
        (b"POST / HTTP/1.0\r\n" + CALL + BODY, [b"<INSTANCENAME"]),
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
