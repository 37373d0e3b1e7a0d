"""Keeps the embedded server busy: many clients that mix all operations, some of them ill-mannered, for a given time.

    python -m tools.soak [--seconds N] [--clients N] [--scenario NAME] [--seed N]

Fails when an operation answers what it should not, when memory, threads or descriptors grow, or when the server does not stop
cleanly. The operations of a run follow from its seed; their order among the clients does not.
"""

import argparse
import collections
import http.client
import random
import socket
import statistics
import sys
import threading
import time
from pathlib import Path

import pywbem

from tools.simulated_server import SimulatedServer

NAME_SPACE = "root/zemlar"
INTEROP = "root/PG_InterOp"
ALERTS = "SELECT * FROM ZEMLAR_AlertIndication"
MEMORY_ALLOWANCE = 4096  # kB that the memory may grow from the second quarter of the run to the last: the allocator's play
PATIENCE = 45  # seconds; the server waits 30 for the rest of a request
MALFORMED = [b"", b"\x00\xff", b"<CIM", b"<?xml version='1.0'?><HELLO/>", b"<!DOCTYPE x [<!ENTITY a 'b'>]><x>&a;</x>", b"<a>" * 9999]


class Client(threading.Thread):
    """One client with connections of its own; `counts` and `failures` tell what it did."""

    def __init__(self, server, seed, deadline):
        super().__init__()
        self.counts = collections.Counter()
        self.failures = []
        self._server = server
        self._random = random.Random(seed)
        self._deadline = deadline
        self._cim = pywbem.WBEMConnection(server.url, default_namespace=NAME_SPACE, timeout=120)
        self._interop = pywbem.WBEMConnection(server.url, default_namespace=INTEROP, timeout=120)
        self._classes = self._cim.EnumerateClassNames(DeepInheritance=True)
        self._served = [name for name in self._classes if name.startswith("ZEMLAR_")]
        self._paths = self._cim.EnumerateInstanceNames("CIM_ManagedElement")

    def run(self):
        # operation, the CIM codes that are as good as success
        operations = [
            (self._class_operation, ()),
            (self._enumerate, ()),
            (self._get_instance, ()),
            (self._get_nothing, (pywbem.CIM_ERR_NOT_FOUND,)),
            (self._traverse, ()),
            (self._change, (pywbem.CIM_ERR_NOT_SUPPORTED,)),
            (self._call_method, (pywbem.CIM_ERR_NOT_SUPPORTED,)),
            (self._ask_in_vain, (pywbem.CIM_ERR_NOT_SUPPORTED,)),
            (self._discover, ()),
            (self._subscribe, ()),
            (self._post_nonsense, ()),
            (self._leave_early, ()),
        ]
        while time.monotonic() < self._deadline and len(self.failures) < 10:
            operation, tolerated = self._random.choice(operations)
            try:
                operation()
            except pywbem.CIMError as error:
                if error.status_code not in tolerated:
                    self.failures.append(f"{operation.__name__}: {error}")
            except Exception as error:  # pylint: disable=broad-except
                self.failures.append(f"{operation.__name__}: {error!r}")
            self.counts[operation.__name__] += 1
        self._cim.close()
        self._interop.close()

    def _class_operation(self):
        name = self._random.choice(self._classes)
        self._random.choice(
            [
                lambda: self._cim.GetClass(name, LocalOnly=False, IncludeClassOrigin=True),
                lambda: self._cim.EnumerateClassNames(ClassName=name, DeepInheritance=True),
                lambda: self._cim.EnumerateClasses(ClassName=name),
            ]
        )()

    def _enumerate(self):
        name = self._random.choice(self._served)
        self._random.choice([self._cim.EnumerateInstances, self._cim.EnumerateInstanceNames])(name)

    def _get_instance(self):
        path = self._random.choice(self._paths)
        instance = self._cim.GetInstance(path, PropertyList=self._random.choice([None, [], ["Name", "Caption"]]))
        if instance.classname != path.classname:
            raise AssertionError(f"{path} answered a {instance.classname}")

    def _get_nothing(self):
        path = self._random.choice(self._paths).copy()
        key = self._random.choice(list(path.keybindings))
        path.keybindings[key] = "<none>"
        self._cim.GetInstance(path)
        raise AssertionError(f"{path} exists")

    def _traverse(self):
        traversal = self._random.choice(
            [self._cim.Associators, self._cim.AssociatorNames, self._cim.References, self._cim.ReferenceNames]
        )
        traversal(self._random.choice(self._paths))

    def _change(self):
        path = self._random.choice(self._paths)
        self._random.choice(
            [
                lambda: self._cim.DeleteInstance(path),
                lambda: self._cim.ModifyInstance(pywbem.CIMInstance(path.classname, {"Caption": "x"}, path=path)),
                lambda: self._cim.CreateInstance(pywbem.CIMInstance(path.classname, path.keybindings)),
            ]
        )()

    def _call_method(self):
        ports = [path for path in self._paths if path.classname == "ZEMLAR_FCPort"]
        state = pywbem.Uint16(self._random.choice([2, 3]))
        self._cim.InvokeMethod("RequestStateChange", self._random.choice(ports), [("RequestedState", state)])

    def _ask_in_vain(self):
        name = self._random.choice(self._served)
        self._random.choice(
            [
                lambda: self._cim.ExecQuery("WQL", f"SELECT * FROM {name}"),
                lambda: self._cim.OpenEnumerateInstances(name),
                lambda: self._cim.DeleteQualifier("Key"),
            ]
        )()
        raise AssertionError("an operation that is not offered was answered")

    def _discover(self):
        manager = self._interop.EnumerateInstances("CIM_ObjectManager")
        if len(manager) != 1:
            raise AssertionError(f"{len(manager)} object managers")
        for profile in self._interop.EnumerateInstanceNames("CIM_RegisteredProfile"):
            self._interop.AssociatorNames(profile, AssocClass="CIM_ElementConformsToProfile", ResultRole="ManagedElement")

    def _subscribe(self):
        name = f"{self._random.random()}"
        url = f"http://127.0.0.1:{self._server.port}/{name}"  # a listener that refuses
        event_filter = self._make("CIM_IndicationFilter", Name=name, Query=ALERTS, QueryLanguage="WQL")
        destination = self._make("CIM_ListenerDestinationCIMXML", Name=name, Destination=url)
        subscription = self._make("CIM_IndicationSubscription", Filter=event_filter, Handler=destination)
        self._interop.ReferenceNames(destination)
        for path in (subscription, event_filter, destination):
            self._interop.DeleteInstance(path)

    def _make(self, class_name, **properties):
        return self._interop.CreateInstance(pywbem.CIMInstance(class_name, properties))

    def _post_nonsense(self):
        connection = http.client.HTTPConnection("127.0.0.1", self._server.port, timeout=120)
        connection.request("POST", "/cimom", self._random.choice(MALFORMED), {"CIMOperation": "MethodCall"})
        status = connection.getresponse().status
        connection.close()
        if status != 400:
            raise AssertionError(f"nonsense was answered with {status}")

    def _leave_early(self):
        with socket.create_connection(("127.0.0.1", self._server.port), timeout=120) as connection:
            connection.sendall(b"POST /cimom HTTP/1.1\r\nHost: x\r\nContent-Length: 1000\r\n\r\n<?xml"[: self._random.randrange(60)])


def resident(pid):
    """The process's memory in kB."""
    status = Path(f"/proc/{pid}/status").read_text(encoding="utf-8")
    return int(status.partition("VmRSS:")[2].split()[0])


def count(pid, what):
    return sum(1 for _ in Path(f"/proc/{pid}/{what}").iterdir())


def watch(server, clients, deadline):
    """Samples of the server's memory, once a second for as long as the clients run."""
    samples = []
    while time.monotonic() < deadline and all(client.is_alive() for client in clients):
        time.sleep(min(1, max(0, deadline - time.monotonic())))
        samples.append(resident(server.pid))
    return samples


def grown(samples):
    """How much more memory the last quarter took than the second one, in kB."""
    quarter = max(1, len(samples) // 4)
    return statistics.median(samples[-quarter:]) - statistics.median(samples[quarter : 2 * quarter] or samples)


def settled(pid, what, wanted):
    """The count once it has come down to what is wanted, or when there has been time enough for that."""
    deadline = time.monotonic() + PATIENCE
    while count(pid, what) > wanted and time.monotonic() < deadline:
        time.sleep(0.1)
    return count(pid, what)


def soak(server, options):
    """The complaints about one run."""
    before = {what: count(server.pid, what) for what in ("task", "fd")}
    deadline = time.monotonic() + options.seconds
    clients = [Client(server, options.seed * 1000 + i, deadline) for i in range(options.clients)]
    for client in clients:
        client.start()
    samples = watch(server, clients, deadline)
    for client in clients:
        client.join()

    total = sum((client.counts for client in clients), collections.Counter())
    for operation, times in sorted(total.items()):
        print(f"  {operation.strip('_'):16} {times:8}")
    print(f"  {'together':16} {sum(total.values()):8}, {sum(total.values()) / options.seconds:.0f} a second")
    print(f"  memory {samples[0]} kB at first, {samples[-1]} kB at last, {max(samples)} kB at most")

    complaints = [failure for client in clients for failure in client.failures]
    if grown(samples) > MEMORY_ALLOWANCE:
        complaints.append(f"the memory grew by {grown(samples):.0f} kB")
    for what, at_first in before.items():
        at_last = settled(server.pid, what, at_first)
        if at_last > at_first:
            complaints.append(f"/proc/{server.pid}/{what}: {at_first} at first, {at_last} at last")
    return complaints


def main():
    parser = argparse.ArgumentParser(prog="tools.soak", description="Keeps the embedded server busy and watches it.")
    parser.add_argument("--seconds", type=int, default=60, help="how long [60]")
    parser.add_argument("--clients", type=int, default=16, metavar="NUMBER", help="clients at once [16]")
    parser.add_argument("--scenario", default="mixed", metavar="NAME", help="one of sim/scenarios, or a file [mixed]")
    parser.add_argument("--seed", type=int, default=1, metavar="NUMBER", help="what the operations follow from [1]")
    options = parser.parse_args()

    server = SimulatedServer(options.scenario, environment={"HXASIM_JOURNAL": "0"})
    try:
        complaints = soak(server, options)
    finally:
        code = server.stop()
    if code != 0:
        complaints.append(f"the server ended with {code}: " + "\n".join(server.lines[-5:]))
    for complaint in complaints:
        print("soak:", complaint, file=sys.stderr)
    return 1 if complaints else 0


if __name__ == "__main__":
    sys.exit(main())
