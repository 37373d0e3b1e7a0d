"""The demonstration: what real clients see of a simulated host. Fails loudly when a step fails or the clients disagree."""

import argparse
import json
import queue
import subprocess
import sys
import time

import pywbem

from tools.demo_tables import ALARM_STATES, RUN_TABLES, TABLES, count
from tools.simulated_server import ROOT, SimulatedServer
from tools.wbemcli import Wbemcli
from zmlr_inventory.subscription import Subscription
from zmlr_inventory.watch import line_of

NAME_SPACE = "root/zemlar"
SCENARIO = "mixed"

STARTED = 4096  # what RunDiagnostic returns for a job that runs
RUN_TIMEOUT = 60  # seconds


class Clients:
    """Both clients on one server; every answer is fetched by both and must be the same."""

    def __init__(self, server):
        self.wbemcli = Wbemcli(server.port)
        self.pywbem = pywbem.WBEMConnection(server.url, default_namespace=NAME_SPACE)

    def instances(self, class_name, properties):
        seen = self.pywbem.EnumerateInstances(class_name)
        rows = [[instance[name] for name in properties] for instance in seen]
        other = [[instance[name] for name in properties] for instance in self.wbemcli.enumerate_instances(class_name)]
        same(class_name, [[text(value) for value in row] for row in rows], other)
        if not rows:
            raise SystemExit(f"demo: {class_name} has no instances")
        return rows

    def instance(self, path, properties):
        wanted = self.pywbem.GetInstance(path, PropertyList=properties)
        if sorted(wanted.keys(), key=str.lower) != sorted(properties, key=str.lower):
            raise SystemExit(f"demo: asked for {properties}, got {wanted.keys()}")
        names = self.wbemcli.enumerate_instance_names(path.classname)
        other = next(self.wbemcli.get_instance(name, *properties) for name in names if path["DeviceID"] in name)
        same(path.classname, [text(wanted[name]) for name in properties], [other[name] for name in properties])
        return [[name, wanted[name]] for name in properties]


def same(what, mine, other):
    if mine != other:
        raise SystemExit(f"demo: the clients disagree on {what}:\n  pywbem:  {mine}\n  wbemcli: {other}")


def text(value):
    """A value as wbemcli prints it."""
    if isinstance(value, list):
        return ",".join(text(element) for element in value)
    return "" if value is None else str(value)


def show(title, columns, rows, right=()):
    table = [columns] + [[str(cell) for cell in row] for row in rows]
    widths = [max(len(row[i]) for row in table) for i in range(len(columns))]
    print(f"\n{title}\n")
    for row in [table[0], ["-" * width for width in widths], *table[1:]]:
        cells = (cell.rjust(width) if name in right else cell.ljust(width) for cell, width, name in zip(row, widths, columns))
        print("  " + "  ".join(cells).rstrip())


def show_class(clients, title, class_name, columns):
    rows = clients.instances(class_name, [property_name for _, property_name, _ in columns])
    show(
        title,
        [heading for heading, _, _ in columns],
        [[tell(value) for value, (_, _, tell) in zip(row, columns)] for row in rows],
        right=[heading for heading, _, tell in columns if tell is count],
    )


def show_one_port(clients):
    path = clients.pywbem.EnumerateInstanceNames("ZEMLAR_FCPort")[0]
    show(
        f"One port by its path, three properties\n  {path.to_wbem_uri(format='historical')}",
        ["Property", "Value"],
        clients.instance(path, ["ElementName", "MaxSpeed", "SupportedMaximumTransmissionUnit"]),
    )


def switch_a_beacon(clients):
    path = clients.pywbem.EnumerateInstanceNames("ZEMLAR_AlarmDevice")[0]
    for state in (3, 1):
        code, _ = clients.pywbem.InvokeMethod("SetAlarmState", path, State=pywbem.Uint16(state))
        seen = clients.pywbem.GetInstance(path)["AlarmState"]
        if (code, seen) != (0, state):
            raise SystemExit(f"demo: SetAlarmState {state} gave {code}, and the beacon shows {seen}")
        print(f"\nSetAlarmState {state}: the beacon of {path['DeviceID']} is {ALARM_STATES[seen]}.")


def show_the_tree(server):
    print("\nThe same, as zmlr-inventory shows it\n", flush=True)
    subprocess.run([sys.executable, ROOT / "client/zmlr-inventory", server.url], check=True)


def pull_a_module(server, clients):
    """Subscribes, pulls the module out of the first port of the HBA, shows the alert, puts it back and unsubscribes."""
    alerts = queue.Queue()
    wanted = "SELECT * FROM ZEMLAR_AlertIndication WHERE EventID = 'HXA_AEN_PORT_SFP_REMOVE'"
    with Subscription(clients.pywbem, alerts.put, wanted) as subscription:
        print(f"\nA listener on {subscription.url} subscribes for modules that are removed. One is pulled; the alert:\n")
        server.hxasim("sfp", 1, 0, "remove")
        try:
            alert = alerts.get(timeout=10)
        except queue.Empty:
            raise SystemExit("demo: no alert came") from None
        print("  " + line_of(alert))
        print(f"  {alert['AlertingManagedElement']}")
        server.hxasim("sfp", 1, 0, "insert")
    if clients.pywbem.EnumerateInstanceNames("CIM_IndicationSubscription", namespace="root/PG_InterOp"):
        raise SystemExit("demo: a subscription is left")


def run_a_test(clients):
    port = clients.pywbem.EnumerateInstanceNames("ZEMLAR_FCPort")[0]
    test = clients.pywbem.AssociatorNames(port, AssocClass="ZEMLAR_AvailableDiagnosticServiceForFCPort")[0]
    code, out = clients.pywbem.InvokeMethod("RunDiagnostic", test, [("ManagedElement", port)])
    if code != STARTED:
        raise SystemExit(f"demo: RunDiagnostic gave {code}")
    print(f"\n{test['Name']} runs on {port['DeviceID']}: job {out['Job']['InstanceID']}.", flush=True)
    deadline = time.monotonic() + RUN_TIMEOUT
    while not clients.pywbem.EnumerateInstanceNames("ZEMLAR_DiagnosticCompletionRecord"):
        if time.monotonic() > deadline:
            raise SystemExit("demo: the test has not completed")
        time.sleep(0.1)
    for title, class_name, columns in RUN_TABLES:
        show_class(clients, title, class_name, columns)


def demonstrate(server):
    clients = Clients(server)
    scenario = json.loads((ROOT / f"sim/scenarios/{SCENARIO}.json").read_text(encoding="utf-8"))
    print(f"The simulated host \"{SCENARIO}\", as the CIM server on {server.url} shows it to storage management in {NAME_SPACE}:")
    print(scenario["description"])
    print("\nEvery table below was fetched twice, by wbemcli and by pywbem, and is the same for both.")
    for title, class_name, columns in TABLES:
        show_class(clients, title, class_name, columns)
    show_one_port(clients)
    switch_a_beacon(clients)
    show_the_tree(server)
    pull_a_module(server, clients)
    run_a_test(clients)


def main():
    argparse.ArgumentParser(prog="tools.demo", description=__doc__).parse_args()
    server = SimulatedServer(SCENARIO)
    try:
        demonstrate(server)
    finally:
        code = server.stop()
    if code != 0:
        raise SystemExit(f"demo: the server ended with {code}:\n" + "\n".join(server.lines))
    print(f"\nThe server has stopped. Done: script/server --scenario {SCENARIO} keeps one running for any client.")


if __name__ == "__main__":
    sys.exit(main())
