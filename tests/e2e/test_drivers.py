"""Drivers that are missing, refuse or fail: what a client sees, and what the log tells."""

import pytest

HBA = {"adapters": [{"kind": "fc-hba", "ports": [{}, {}]}]}
CNA = {"adapters": [{"kind": "cna", "ports": [{}, {}]}]}
GATE = "Driver is not installed or there is a hxal mismatch hence no instances returned"
NEEDS_NO_ADAPTER = {"ZEMLAR_ComputerSystem"}


@pytest.fixture
def logged(tmp_path):
    """An environment whose log is on, and a function that reads it."""
    (tmp_path / ".cimplerc").write_text("LOG_LEVEL = INFO\n", encoding="utf-8")
    return {"HOME": str(tmp_path)}, lambda: (tmp_path / ".cimple/messages").read_text(encoding="utf-8")


@pytest.mark.parametrize(
    "scenario,line",
    [
        ("no-driver", "ERROR: No driver found"),
        ("version-refused", "ERROR: HXAL version mismatch"),
    ],
)
def test_without_a_driver_only_the_host_is_left(start, logged, scenario, line):
    environment, log = logged
    host = start(scenario, environment)
    for name in host.pywbem.EnumerateClassNames(DeepInheritance=True):
        if name.startswith("ZEMLAR_"):
            assert len(host.pywbem.EnumerateInstances(name)) == (name in NEEDS_NO_ADAPTER), name
    text = log()
    assert line in text
    assert GATE in text


def test_an_empty_host_is_no_failure(start, logged):
    environment, log = logged
    host = start({"adapters": []}, environment)
    assert host.pywbem.EnumerateInstances("ZEMLAR_FCPort") == []
    assert GATE not in log()
    assert "No FC Ports Found!" in log()


SCAN = ["IOCMD_IOC_GET_VERSION", "IOCMD_IOC_GET_INST", "IOCMD_AEN_SYNC", "IOCMD_IOC_GET_INFO"]


@pytest.mark.parametrize("command", SCAN)
def test_a_failing_node_contributes_nothing_and_the_other_still_does(start, command):
    host = start({**CNA, "faults": [{"command": command, "node": "/dev/hxn", "error": "EIO"}]})
    assert len(host.device_ids()) == 2

    host = start({**CNA, "faults": [{"command": command, "node": "/dev/hxa", "error": "EIO"}]})
    assert host.device_ids() == [], "without the FC node there are no FC ports"
    assert len(host.device_ids("ZEMLAR_PortController")) == 1, "the Ethernet side still makes an adapter"


def test_a_port_that_fails_is_skipped_while_it_fails(start):
    host = start({**HBA, "faults": [{"command": "IOCMD_PORT_GET_ATTR", "instance": 0, "error": "EIO", "times": 1}]})
    assert len(host.device_ids()) == 1
    assert len(host.device_ids()) == 2, "everything is read anew for every request"


def test_a_text_of_any_bytes_spoils_no_answer(start):
    symbolic_name = {"offset": 48, "bytes": b"<&]]>\x01\x80\xc3\xa9\xff'\0".hex()}
    host = start({**HBA, "faults": [{"command": "IOCMD_PORT_GET_ATTR", "answer": symbolic_name}]})
    expected = ["<&]]>??\u00e9?'"] * 2
    assert [port["Caption"] for port in host.pywbem.EnumerateInstances("ZEMLAR_FCPort")] == expected
    assert [port["Caption"] for port in host.wbemcli.enumerate_instances("ZEMLAR_FCPort")] == expected


def test_large_host(start):
    host = start("large")
    ids = host.device_ids()
    assert len(ids) == len(set(ids)) == 128
    assert len(host.device_ids("ZEMLAR_PortController")) == 64
