"""Drivers that are missing, refuse or say nonsense: what a client sees, and what the log tells."""

import re

import pytest

GATE = "Driver is not installed or there is a hxal mismatch hence no instances returned"


@pytest.mark.parametrize(
    "scenario,line", [("no-driver", "ERROR: No driver found"), ("version-refused", "ERROR: HXAL version mismatch")]
)
def test_without_a_driver_the_host_and_the_profiles_are_left(start, tmp_path, scenario, line):
    (tmp_path / ".cimplerc").write_text("LOG_LEVEL = INFO\n", encoding="utf-8")
    host = start(scenario, {"HOME": str(tmp_path)})
    assert len(host.pywbem.EnumerateInstances("ZEMLAR_ComputerSystem")) == 1
    assert len(host.pywbem.EnumerateInstances("ZEMLAR_ElementConformsToProfile")) == 14
    elements = ("LogicalDevice", "PhysicalElement", "ProtocolEndpoint", "StatisticalData", "Product", "LogicalPortGroup")
    software = ("SoftwareInstallationService", "SoftwareInstallationServiceCapabilities", "DiagnosticTest")
    for needs_it in [f"CIM_{name}" for name in elements + software]:
        assert host.pywbem.EnumerateInstanceNames(needs_it) == []
    log = (tmp_path / ".cimple/messages").read_text(encoding="utf-8")
    for service in ("Service", "ServiceCapabilities"):
        empty = rf"ERR: ZEMLAR_HBASoftwareInstallation{service}_Provider\(\d+\): Error: Invalid mapping information\n"
        assert re.search(empty, log)
    assert line in log and GATE in log and "Building association instance for profile : Server\n" in log


def test_a_text_of_any_bytes_spoils_no_answer(start):
    symbolic_name = {"offset": 48, "bytes": b"<&]]>\x01\x80\xc3\xa9\xff'\0".hex()}
    faults = [{"command": "IOCMD_PORT_GET_ATTR", "answer": symbolic_name}]
    host = start({"adapters": [{"kind": "fc-hba", "ports": [{}, {}]}], "faults": faults})
    expected = ["<&]]>??\u00e9?'"] * 2
    assert [port["Caption"] for port in host.pywbem.EnumerateInstances("ZEMLAR_FCPort")] == expected
    assert [port["Caption"] for port in host.wbemcli.enumerate_instances("ZEMLAR_FCPort")] == expected
