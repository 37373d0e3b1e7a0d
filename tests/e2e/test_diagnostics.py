"""Diagnostic tests as clients run them: what is refused, a run from its start to its records, and a server that stops in the middle."""

import signal
import time

import pytest
import pywbem
from conftest import wait_until

FC, ETHERNET, ADAPTER = "ZEMLAR_FCPort", "ZEMLAR_EthernetPort", "ZEMLAR_PortController"
CARDS = {"adapters": [{"kind": "cna", "ports": [{}]}, {"kind": "fc-hba", "ports": [{}]}]}
CNA_PORT, HBA_PORT = 0, 1  # among the FC ports
STARTED = 4096


def path_of_test(host, class_name, name=None):
    path = host.pywbem.EnumerateInstanceNames(f"ZEMLAR_{class_name}DiagnosticTest")[0]
    path["Name"] = f"Zemlar:{name or class_name}Test"
    return path


def element_path(host, class_name, device):
    """An element by its number, or one with that DeviceID."""
    names = host.pywbem.EnumerateInstanceNames(class_name)
    if isinstance(device, int):
        return names[device]
    names[0]["DeviceID"] = device
    return names[0]


def run(host, test, element):
    arguments = [("ManagedElement", element)] if element else []
    code, out = host.pywbem.InvokeMethod("RunDiagnostic", test, arguments)
    return code, out.get("Job")


def walk(host, source, **filters):
    """The names at the other ends, as enumerations tell them."""
    names = host.pywbem.AssociatorNames(source, **filters)
    for name in names:
        name.host = None
    return names


def outcomes(host):
    return host.pywbem.EnumerateInstances("ZEMLAR_DiagnosticCompletionRecord")


@pytest.fixture(scope="module")
def idle(module_start):
    """A server on which no test runs."""
    return module_start("cna")


# test class, test, element class, element, what RunDiagnostic returns
REFUSALS = [
    ("Loopback", "InternalLoopback", FC, 0, 1),
    ("Loopback", "NoLoopback", FC, 0, 5),
    ("Loopback", "SerdesLoopback", FC, "1000000000000000", 4),
    ("Loopback", "SerdesLoopback", FC, "00051E999999", 4),
    ("Loopback", "SerdesLoopback", FC, "100000051E", 5),
    ("Loopback", "NoLoopback", FC, "1000000000000000", 4),
    ("Loopback", "SerdesLoopback", FC, "", 5),
    ("Loopback", "SerdesLoopback", ETHERNET, 0, 5),
    ("Loopback", "SerdesLoopback", None, None, 5),
    ("EthLoopback", "SerdesEthLoopback", FC, 0, 5),
    ("EthLoopback", "SerdesLoopback", ETHERNET, 0, 5),
    ("EthLoopback", "SerdesEthLoopback", ETHERNET, "00051E999999", 4),
    ("EthLoopback", "SerdesEthLoopback", ETHERNET, "1000000000000000", 5),
    ("Loopback", "SerdesLoopback", "ZEMLAR_ComputerSystem", 0, 5),
    ("PCILoopback", None, ADAPTER, 0, 5),
    ("PCILoopback", None, ETHERNET, "1000000000000000", 4),
    ("PCILoopback", None, FC, "x", 5),
    ("Memory", None, FC, 0, 5),
    ("Memory", None, ADAPTER, "1000000000000000", 4),
    ("Memory", None, ADAPTER, "x", 4),
]


@pytest.mark.parametrize("test_class,name,element_class,device,code", REFUSALS)
def test_what_is_refused_leaves_nothing(idle, test_class, name, element_class, device, code):
    element = element_path(idle, element_class, device) if element_class else None
    assert run(idle, path_of_test(idle, test_class, name), element) == (code, None)
    for left in ("ConcreteJob", "DiagnosticServiceRecord", "DiagnosticCompletionRecord", "AffectedJobElement", "OwningJobElement"):
        assert idle.pywbem.EnumerateInstanceNames(f"ZEMLAR_{left}") == []


TEST_METHODS = "RunTest ClearResults DiscontinueTest RunDiagnosticService StartService StopService RequestStateChange".split()
JOB = pywbem.CIMInstanceName("ZEMLAR_ConcreteJob", {"InstanceID": "Zemlar:MemoryTest"}, namespace="root/zemlar")


@pytest.mark.parametrize("method,job", [*((name, None) for name in TEST_METHODS), ("KillJob", JOB), ("GetError", JOB)])
def test_other_methods_are_not_supported(idle, method, job):
    with pytest.raises(pywbem.CIMError) as caught:
        idle.pywbem.InvokeMethod(method, job or path_of_test(idle, "Memory"))
    assert caught.value.status_code == 7


def test_a_run_from_its_start_to_its_records(start):
    held = [{"command": "IOCMD_DIAG_LOOPBACK", "delay": 3000}]
    host = start({**CARDS, "faults": held}, {"HXASIM_TIME_SCALE": "0"})
    client = host.pywbem
    port = element_path(host, FC, HBA_PORT)
    test = path_of_test(host, "Loopback", "InternalLoopback")
    code, job = run(host, test, port)
    assert (code, job["InstanceID"]) == (STARTED, "Zemlar:InternalLoopbackTest")
    running = client.GetInstance(job)
    assert (running["JobState"], running["PercentComplete"]) == (4, 0)
    assert str(running["TimeBeforeRemoval"]) == "00000000000500.000000:000" and str(running["ElapsedTime"]).startswith("00000000000000")
    wait_until(lambda: client.GetInstance(port)["EnabledState"] == 3)
    assert run(host, path_of_test(host, "Memory"), element_path(host, ADAPTER, 0)) == (4, None)
    assert run(host, test, element_path(host, FC, "x")) == (4, None)  # whatever else is wrong

    wait_until(lambda: outcomes(host))
    done = client.GetInstance(job)
    assert (done["JobState"], done["PercentComplete"], done["StartTime"]) == (7, 100, running["StartTime"])
    assert client.GetInstance(port)["EnabledState"] == 2

    (outcome,) = outcomes(host)
    notes = client.EnumerateInstances("ZEMLAR_DiagnosticServiceRecord")
    name = client.GetInstance(port)["ElementName"]
    assert [record["InstanceID"] for record in [*notes, outcome]] == [f"Zemlar:InternalLoopbackTest:{i}" for i in range(1, 8)]
    assert {record["ManagedElementName"] for record in [*notes, outcome]} == {name}
    assert (outcome["CompletionState"], outcome["RecordFormat"], outcome["ExpirationDate"]) == (2, "", None)
    for record in (notes[2], outcome):
        assert client.GetInstance(record.path) == record
        assert walk(host, record.path, ResultClass=FC) == [port]
    assert test in walk(host, port, AssocClass="ZEMLAR_AvailableDiagnosticServiceForFCPort")
    assert walk(host, test, AssocClass="ZEMLAR_OwningJobElement") == [job]
    assert walk(host, job, AssocClass="ZEMLAR_AffectedJobElement") == [port]
    assert len(client.ReferenceNames(port, ResultClass="ZEMLAR_ServiceRecordAppliesToElement")) == len(notes)

    second = path_of_test(host, "Memory")
    assert run(host, second, element_path(host, ADAPTER, 0))[0] == STARTED
    wait_until(lambda: len(outcomes(host)) == 2)
    numbers = [int(record["InstanceID"].split(":")[-1]) for record in client.EnumerateInstances("ZEMLAR_DiagnosticServiceRecord")]
    assert numbers == [*range(1, 7), *range(8, 15)]
    assert [path["InstanceID"] for path in client.EnumerateInstanceNames("ZEMLAR_ConcreteJob")] == ["Zemlar:MemoryTest"]


def test_records_of_a_port_that_is_gone(start):
    host = start({**CARDS, "faults": [{"command": "IOCMD_ETHPORT_GET_ATTR", "error": "EIO", "skip": 1}]})
    assert run(host, path_of_test(host, "PCILoopback"), element_path(host, ETHERNET, 0))[0] == STARTED
    wait_until(lambda: outcomes(host))
    assert outcomes(host)[0]["ManagedElementName"] == ""
    assert host.pywbem.EnumerateInstanceNames("ZEMLAR_CompletionRecordAppliesToElement") == []
    assert host.pywbem.EnumerateInstanceNames("ZEMLAR_AffectedJobElement") == []


def test_an_adapter_whose_ports_cannot_be_read_ends_what_is_available(start):
    unreadable = [{"command": "IOCMD_PORT_GET_ATTR", "instance": 1, "error": "EIO"}]
    host = start({"adapters": [{"kind": "cna", "ports": [{}]}, *[{"kind": "fc-hba", "ports": [{}]}] * 2], "faults": unreadable})
    available = host.pywbem.EnumerateInstances("ZEMLAR_AvailableDiagnosticServiceForFCPort")
    assert [instance["ServiceProvided"]["Name"][7:-4] for instance in available] == ["ExternalLoopback", "SerdesLoopback", "PCILoopback"]
    assert len(host.pywbem.EnumerateInstanceNames("ZEMLAR_AvailableDiagnosticServiceForAdapter")) == 3


def test_without_adapters_there_is_nothing_to_run(start, tmp_path):
    (tmp_path / ".cimplerc").write_text("LOG_LEVEL=INFO\n", encoding="utf-8")
    host = start({"adapters": []}, {"HOME": str(tmp_path)})
    for superclass in ("CIM_DiagnosticTest", "CIM_SoftwareIdentity", "CIM_Job", "CIM_RecordForLog", "CIM_ServiceAvailableToElement"):
        assert not [path for path in host.pywbem.EnumerateInstanceNames(superclass) if "Diagnostic" in str(path)]
    assert host.pywbem.EnumerateInstanceNames("ZEMLAR_DiagnosticElementSoftwareIdentity") == []
    log = (tmp_path / ".cimple/messages").read_text(encoding="utf-8")
    assert "WARN: DiagnosticHelper" in log and "No adapters in the system for running diagnostics." in log
    assert "No diagnostic softwares are installed." in log


def test_wbemcli_runs_a_test(start):
    host = start(CARDS)

    def local(path):
        return path.split(":", 2)[-1]

    (test,) = host.wbemcli.enumerate_instance_names("ZEMLAR_PCILoopbackDiagnosticTest")
    port = host.wbemcli.enumerate_instance_names(FC)[HBA_PORT]
    printed = host.wbemcli.run("cm", local(test), f"RunDiagnostic.ManagedElement={local(port)}")
    assert any(str(STARTED) in line for line in printed), printed
    wait_until(lambda: outcomes(host))


# Each of the port's two functions takes 1.5 s to come back.
@pytest.mark.parametrize(
    "command,delay,seconds,told",
    [("IOCMD_PORT_ENABLE", 1500, (3, 8), False), ("IOCMD_DIAG_LOOPBACK", 60_000, (8, 20), True)],
    ids=["in a pause", "in a test that takes minutes"],
)
def test_the_server_stops_in_the_middle_of_a_run(start, tmp_path, command, delay, seconds, told):
    (tmp_path / ".cimplerc").write_text("LOG_LEVEL=INFO\n", encoding="utf-8")
    leaks = {"ASAN_OPTIONS": "detect_leaks=0"}  # nobody can look for them while a thread runs on
    slow = {**CARDS, "faults": [{"command": command, "delay": delay}]}
    host = start(slow, {"HOME": str(tmp_path), "HXASIM_TIME_SCALE": "0.9", **leaks})
    assert run(host, path_of_test(host, "Loopback", "SerdesLoopback"), element_path(host, FC, CNA_PORT))[0] == STARTED
    time.sleep(2.5 if told else 1)
    begin = time.monotonic()
    assert host.server.stop(signal.SIGTERM) == 0
    assert seconds[0] <= time.monotonic() - begin < seconds[1]
    log = (tmp_path / ".cimple/messages").read_text(encoding="utf-8")
    assert ("Enabling the port" in log) != told
    assert ("The process ends while a diagnostic test runs" in log) == told
