"""Servers and clients for the end-to-end tests. ZMLR_BUILD_DIR names the build under test."""

import json
import os
import re
import signal
import socket
import subprocess
import sys
import time
from pathlib import Path

import pytest
import pywbem

sys.path.insert(0, str(Path(__file__).resolve().parents[2]))

from tools.simulated_server import ROOT, SimulatedServer  # noqa: E402
from tools.wbemcli import Wbemcli  # noqa: E402

# Jobs in the background of a shell ignore it, and so would all that the tests start and interrupt.
signal.signal(signal.SIGINT, signal.default_int_handler)

NAME_SPACE = "root/zemlar"
TIMEOUT = 60  # seconds until something that must happen has failed to
REQUEST = (ROOT / "tests/e2e/enumerate_host.xml").read_bytes()
TST_MODULE = Path(os.environ.get("ZMLR_BUILD_DIR", ROOT / "build/dev")) / "tests/e2e/module/libtst_module.so"


def post(port, body=REQUEST, headers="", tls=None):
    """All that the server says to one request before it closes."""
    head = f"POST /cimom HTTP/1.1\r\nHost: localhost\r\nCIMOperation: MethodCall\r\n{headers}Connection: close\r\n"
    head += f"Content-Length: {len(body)}\r\n\r\n"
    with socket.create_connection(("127.0.0.1", port), timeout=60) as plain:
        connection = tls.wrap_socket(plain, server_hostname="127.0.0.1") if tls else plain
        with connection:
            connection.sendall(head.encode() + body)
            return b"".join(iter(lambda: connection.recv(65536), b""))


def without_id(message):
    return re.sub(r'MESSAGE ID="\d+"', 'MESSAGE ID=""', message)


def wait_until(condition):
    deadline = time.monotonic() + TIMEOUT
    while not condition():
        assert time.monotonic() < deadline
        time.sleep(0.02)


def code_of(call, *arguments):
    """The CIM status that the call fails with; the description has to say something."""
    with pytest.raises(pywbem.CIMError) as caught:
        call(*arguments)
    assert caught.value.status_description
    return caught.value.status_code


class Host:
    """A simulated host with its server and a client of each kind."""

    def __init__(self, server):
        self.server = server
        self.pywbem = pywbem.WBEMConnection(server.url, default_namespace=NAME_SPACE, timeout=60)
        self.wbemcli = Wbemcli(server.port)

    def device_ids(self, class_name="ZEMLAR_FCPort"):
        return [instance["DeviceID"] for instance in self.pywbem.EnumerateInstances(class_name)]


@pytest.fixture(scope="session")
def mixed():
    """The scenario with a CNA, an FC HBA and a mezzanine card; shared by all tests that change nothing."""
    with SimulatedServer("mixed") as server:
        yield Host(server)


@pytest.fixture(scope="session")
def tst():
    """A server with the tests' own module. Tests clean up what they make."""
    with SimulatedServer("fc-hba", module=TST_MODULE) as server:
        yield Host(server)


@pytest.fixture(scope="session")
def program(mixed):
    """The server's command line: the program, its module and a free port."""
    arguments = mixed.server.arguments()
    return [arguments[0], "--module", arguments[arguments.index("--module") + 1], "--port", "0"]


def certify(folder, *options):
    """A certificate of 127.0.0.1 and its key."""
    certificate, key = folder / "certificate.pem", folder / "key.pem"
    command = ["openssl", "req", "-x509", "-nodes", "-subj", "/CN=test", "-addext", "subjectAltName=IP:127.0.0.1"]
    subprocess.run([*command, *options, "-out", certificate, "-keyout", key], capture_output=True, check=True)
    return certificate, key


@pytest.fixture(scope="session")
def identity(tmp_path_factory):
    return certify(tmp_path_factory.mktemp("identity"), "-newkey", "ec", "-pkeyopt", "ec_paramgen_curve:prime256v1", "-days", "2")


@pytest.fixture(scope="module")
def module_start():
    """module_start(scenario): a server that the tests of one module share."""
    servers = []

    def start_server(scenario):
        servers.append(SimulatedServer(scenario))
        return Host(servers[-1])

    yield start_server
    for server in servers:
        server.stop()


@pytest.fixture
def start(tmp_path):
    """start(scenario): a server of the test's own; a dict is written to a scenario file first. Options replace --no-auth."""
    servers = []

    def start_server(scenario, environment=None, options=None, module=None):
        if isinstance(scenario, dict):
            path = tmp_path / f"scenario{len(servers)}.json"
            path.write_text(json.dumps(scenario), encoding="utf-8")
            scenario = str(path)
        server = SimulatedServer(scenario, environment, options, module)
        servers.append(server)
        return Host(server)

    yield start_server
    for server in servers:
        server.stop()
