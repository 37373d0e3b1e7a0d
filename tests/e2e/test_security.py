"""Who may ask: credentials, TLS, and what the server refuses to start with."""

import base64
import os
import pty
import select
import signal
import socket
import ssl
import subprocess
import threading
import time

import pytest
import pywbem
from conftest import certify, post, wait_until

from tools.wbemcli import Wbemcli, WbemcliError

PASSWORD = "open sésame"


@pytest.fixture
def users(program, tmp_path):
    """A file with the user "admin"."""
    file = tmp_path / "private/users"
    add_user(program, file, "admin", PASSWORD)
    return file


def add_user(program, file, name, password):
    command = [program[0], "--add-user", name, "--users", file]
    return subprocess.run(command, input=password + "\n", capture_output=True, text=True, timeout=60, check=True)


def basic(name, password):
    return "Basic " + base64.b64encode(f"{name}:{password}".encode()).decode()


def status(port, authorization=None, **keywords):
    headers = f"Authorization: {authorization}\r\n" if authorization else ""
    return int(post(port, headers=headers, **keywords).split(b" ")[1])


def test_only_users_are_served(start, users):
    server = start("fc-hba", options=["--users", str(users)]).server
    assert b'WWW-Authenticate: Basic realm="' in post(server.port)
    assert status(server.port) == 401
    for authorization, expected in [
        (basic('a\n"b', "wrong"), 401),
        (basic("admin", "wrong"), 401),
        (basic("nobody", PASSWORD), 401),
        (basic("admin", PASSWORD[:-1]), 401),
        (basic("admin", PASSWORD + "x"), 401),
        (basic("admin", ""), 401),
        (basic("", PASSWORD), 401),
        ("Basic !!!", 401),
        ("Basic", 401),
        ("Bearer " + basic("admin", PASSWORD)[6:], 401),
        (basic("admin", "x" * 20000), 401),
        (basic("admin", PASSWORD + "\0"), 401),
        (basic("admin", PASSWORD), 200),
        (basic("admin", PASSWORD).replace("Basic ", "bASIC  "), 200),
    ]:
        assert status(server.port, authorization) == expected, authorization
        assert status(server.port, authorization) == expected, "again, with what is remembered"
    assert status(server.port, body=b"x" * 900_000) == 401, "the answer comes after the body"

    good = pywbem.WBEMConnection(server.url, ("admin", PASSWORD), default_namespace="root/zemlar")
    assert len(good.EnumerateInstanceNames("ZEMLAR_FCPort")) == 2
    with pytest.raises(pywbem.AuthError):
        pywbem.WBEMConnection(server.url, ("admin", "wrong"), default_namespace="root/zemlar").EnumerateClassNames()
    with pytest.raises(WbemcliError):
        Wbemcli(server.port).enumerate_instance_names("ZEMLAR_FCPort")
    assert server.stop() == 0
    told = [line for line in server.lines if "refused the login" in line]
    assert told[0] == 'zmlr-cimserver: refused the login of "a\\x0A\\x22b" from 127.0.0.1'
    assert len(told) == 10, "more are counted, not told"


def test_a_name_that_does_not_exist_takes_as_long_as_a_wrong_password(start, users):
    port = start("fc-hba", options=["--users", str(users)]).server.port

    def fastest(name):
        times = []
        for _ in range(5):
            begin = time.monotonic()
            assert status(port, basic(name, "wrong")) == 401
            times.append(time.monotonic() - begin)
        return min(times)

    assert fastest("nobody") > fastest("admin") / 3


def test_wrong_passwords_keep_no_user_out(start, program, users):
    add_user(program, users, "newcomer", "sesame")
    port = start("fc-hba", options=["--users", str(users)]).server.port
    assert status(port, basic("admin", PASSWORD)) == 200
    over = threading.Event()
    refusals = []

    def guess():
        while not over.is_set():
            refusals.append(status(port, basic("admin", "wrong")))

    guessers = [threading.Thread(target=guess) for _ in range(70)]
    for guesser in guessers:
        guesser.start()
    try:
        assert [status(port, basic("admin", PASSWORD)) for _ in range(30)] == [200] * 30
        assert status(port, basic("newcomer", "sesame")) == 200, "nor one whose password has to be verified yet"
    finally:
        over.set()
        for guesser in guessers:
            guesser.join()
    assert set(refusals) == {401}


def test_a_flood_of_logins_delays_its_own_address_only(start, users):
    port = start("fc-hba", options=["--users", str(users), "--max-connections", "40"]).server.port

    def ask(address, password):
        connection = socket.create_connection(("127.0.0.1", port), timeout=60, source_address=(address, 0))
        head = f"POST / HTTP/1.1\r\nHost: x\r\nAuthorization: {basic('admin', password)}\r\nContent-Length: 0\r\n\r\n"
        connection.sendall(head.encode())
        return connection

    flood = [ask("127.0.0.1", "wrong") for _ in range(60)]
    assert ask("127.0.0.2", PASSWORD).recv(12) == b"HTTP/1.1 400", "known, heard and asking for nothing"
    refused = [connection for connection in select.select(flood, [], [], 0)[0] if connection.recv(12) == b"HTTP/1.1 401"]
    assert len(refused) < 20


def test_a_change_of_the_file_counts_at_once(start, program, users):
    server = start("fc-hba", options=["--users", str(users)]).server
    port = server.port
    assert status(port, basic("admin", PASSWORD)) == 200
    add_user(program, users, "admin", "another")
    add_user(program, users, "second", "one more")
    assert status(port, basic("admin", PASSWORD)) == 401
    assert status(port, basic("admin", "another")) == status(port, basic("second", "one more")) == 200

    users.chmod(0o644)
    assert status(port, basic("admin", "another")) == 401, "nobody is let in by a file that others may read"
    users.chmod(0o600)
    assert status(port, basic("admin", "another")) == 200

    sound = users.read_text(encoding="utf-8")
    for text, told, answer in [("admin:plain", f"not reloaded: {users} line 1", 401), (sound, "cimserver: reloaded", 200)]:
        users.write_text(text, encoding="utf-8")
        server.send_signal(signal.SIGHUP)
        wait_until(lambda told=told: told in "".join(server.lines))
        assert status(port, basic("admin", "another")) == answer
    users.write_text("", encoding="utf-8")
    assert status(port, basic("admin", "another")) == 401
    users.unlink()
    assert status(port, basic("admin", "another")) == 401


def test_add_user_keeps_a_private_file_of_hashes(program, users):
    assert users.stat().st_mode & 0o777 == 0o600
    assert users.parent.stat().st_mode & 0o777 == 0o700
    before = users.read_text(encoding="utf-8")
    assert before.startswith("admin:$y$") and PASSWORD not in before
    users.chmod(0o640)
    group = os.getgid() if os.geteuid() else 4711
    os.chown(users, -1, group)
    add_user(program, users, "zoë", "x")
    assert (users.stat().st_mode & 0o777, users.stat().st_gid) == (0o640, group)
    after = users.read_text(encoding="utf-8")
    assert after.startswith(before) and after.splitlines()[1].startswith("zoë:$y$")
    assert os.listdir(users.parent) == ["users"], "nothing temporary is left"

    for name, password in [("", "x"), ("a:b", "x"), ("a\nb", "x"), ("a" * 65, "x"), ("a", ""), ("a", "x" * 512), ("a", "\x03")]:
        with pytest.raises(subprocess.CalledProcessError):
            add_user(program, users, name, password)
    for spoilt in ["admin", "admin:plain", after + after.splitlines()[0], ":$y$j9T$x$y"]:
        users.write_text(spoilt, encoding="utf-8")
        with pytest.raises(subprocess.CalledProcessError):
            add_user(program, users, "other", "x")
        assert users.read_text(encoding="utf-8") == spoilt, "what is damaged is not overwritten"


def test_a_terminal_does_not_show_the_password(program, tmp_path):
    for again, code in [("secret", 0), ("secrets", 1)]:
        terminal, line = pty.openpty()
        command = [program[0], "--add-user", "admin", "--users", tmp_path / "t/users"]
        process = subprocess.Popen(command, stdin=line, stdout=line, stderr=line)
        os.close(line)
        seen = b""
        for prompt, typed in [(b"Password: ", "secret"), (b"again: ", again)]:
            while not seen.endswith(prompt):
                seen += os.read(terminal, 1024)
            os.write(terminal, typed.encode() + b"\n")
        assert process.wait(60) == code
        assert b"secret" not in seen + os.read(terminal, 1024)
        os.close(terminal)


@pytest.mark.filterwarnings("ignore:ssl.TLSVersion.TLSv1_1")
def test_tls(start, users, identity, monkeypatch):
    for name in ("REQUESTS_CA_BUNDLE", "CURL_CA_BUNDLE"):
        monkeypatch.delenv(name, raising=False)  # they would come before ca_certs
    certificate, key = identity
    options = ["--users", str(users), "--certificate", str(certificate), "--key", str(key), "--address", "0.0.0.0"]
    server = start("fc-hba", options=options).server
    url = server.url.replace("http:", "https:")
    client = pywbem.WBEMConnection(url, ("admin", PASSWORD), default_namespace="root/zemlar", ca_certs=str(certificate))
    assert len(client.EnumerateInstanceNames("ZEMLAR_FCPort")) == 2

    trusting = ssl.create_default_context(cafile=certificate)
    assert status(server.port, tls=trusting) == 401
    old = ssl.create_default_context(cafile=certificate)
    old.set_ciphers("ALL:@SECLEVEL=0")
    old.minimum_version = old.maximum_version = ssl.TLSVersion.TLSv1_1
    with pytest.raises(ssl.SSLError):
        status(server.port, tls=old)
    with socket.create_connection(("127.0.0.1", server.port), timeout=60) as plain:
        plain.sendall(b"POST / HTTP/1.1\r\n\r\n")
        assert not plain.recv(4096).startswith(b"HTTP/")
    with socket.create_connection(("127.0.0.1", server.port), timeout=60):  # a silent one holds nobody up
        assert status(server.port, basic("admin", PASSWORD), tls=trusting) == 200
    assert server.stop() == 0


def test_tls_keeps_what_was_recorded_secret(start, users, tmp_path):
    certificate, key = certify(tmp_path, "-newkey", "rsa:2048", "-days", "2")
    server = start("fc-hba", options=["--users", str(users), "--certificate", str(certificate), "--key", str(key)]).server
    client = ssl.create_default_context(cafile=certificate)
    client.maximum_version = ssl.TLSVersion.TLSv1_2
    assert status(server.port, tls=client) == 401
    client.set_ciphers("kRSA")
    with pytest.raises(ssl.SSLError):
        status(server.port, tls=client)


def test_certificates_are_reloaded_and_weak_ones_told(start, users, identity, tmp_path):
    shown = [tmp_path / "certificate.pem", tmp_path / "key.pem"]

    def put(files):
        for file, place in zip(files, shown):
            place.write_bytes(file.read_bytes())
            place.chmod(0o600)

    weak = certify(users.parent, "-newkey", "rsa:1024")
    request = subprocess.run(["openssl", "x509", "-x509toreq", "-in", weak[0], "-signkey", weak[1]], capture_output=True, check=True)
    expired = ["openssl", "x509", "-req", "-signkey", weak[1], "-days", "-1", "-out", weak[0]]
    subprocess.run(expired, input=request.stdout, capture_output=True, check=True)
    put(weak)
    server = start("fc-hba", options=["--users", str(users), "--certificate", str(shown[0]), "--key", str(shown[1])]).server
    told = [line.partition(f"clients may refuse {shown[0]}: ")[2] for line in server.lines]
    assert any(line.startswith("it has expired on 20") for line in told)
    assert "its key is weak (RSA of 1024 bits)" in told

    put(identity)
    server.send_signal(signal.SIGHUP)
    wait_until(lambda: any(line.endswith(": reloaded") for line in server.lines))
    trusting = ssl.create_default_context(cafile=identity[0])
    assert status(server.port, basic("admin", PASSWORD), tls=trusting) == 200
    shown[0].write_text("spoilt", encoding="utf-8")
    server.send_signal(signal.SIGHUP)
    wait_until(lambda: any(line.endswith(f"not reloaded: {shown[0]} holds no certificate in PEM form") for line in server.lines))
    assert status(server.port, basic("admin", PASSWORD), tls=trusting) == 200


def test_refuses_to_start_unsafe(program, users, identity, tmp_path):
    certificate, key = map(str, identity)
    file = str(users)
    other_key = tmp_path / "other.pem"
    subprocess.run(["openssl", "genpkey", "-algorithm", "ed25519", "-out", other_key], check=True)

    def written(name, content, mode):
        (tmp_path / name).write_bytes(content)
        (tmp_path / name).chmod(mode)
        return str(tmp_path / name)

    open_key = written("open.pem", identity[1].read_bytes(), 0o644)
    shared = written("shared", users.read_bytes(), 0o644)
    empty = written("empty", b"", 0o600)
    spoilt = written("spoilt", b"admin:secret\n", 0o600)
    for options, code, told in [
        (["--users", str(tmp_path / "missing")], 1, "--add-user"),
        (["--users", shared], 1, "0640"),
        (["--users", empty], 1, "names no user"),
        (["--users", spoilt], 1, "line 1"),
        (["--users", str(tmp_path)], 1, "no regular file"),
        (["--no-auth", "--address", "0.0.0.0", "--certificate", certificate, "--key", key], 2, "--no-auth"),
        (["--users", file, "--address", "0.0.0.0"], 2, "TLS"),
        (["--users", file, "--address", "::"], 2, "TLS"),
        (["--users", file, "--address", "localhost"], 2, "localhost"),
        (["--users", file, "--certificate", certificate], 2, "--key"),
        (["--users", file, "--certificate", certificate, "--key", str(other_key)], 1, str(other_key)),
        (["--users", file, "--certificate", certificate, "--key", open_key], 1, "0640"),
        (["--users", file, "--certificate", key, "--key", key], 1, key),
        (["--users", file, "--certificate", str(tmp_path / "missing"), "--key", key], 1, "missing"),
    ]:
        done = subprocess.run([*program, *options], capture_output=True, text=True, timeout=60, check=False)
        assert (done.returncode, told in done.stderr) == (code, True), (options, done.stderr)
