"""The demonstration: what real clients see of a simulated host. Fails loudly when a step fails or the clients disagree."""

import sys

import pywbem

from tools.simulated_server import SimulatedServer
from tools.wbemcli import Wbemcli

NAME_SPACE = "root/zemlar"

ENABLED_STATES = {1: "Other", 2: "Enabled", 3: "Disabled", 4: "Shutting Down", 6: "Enabled but Offline", 9: "Starting"}
STATUSES = {
    0: "Unknown",
    2: "OK",
    6: "Error",
    8: "Starting",
    9: "Stopping",
    10: "Stopped",
    11: "In Service",
    13: "Lost Communication",
}


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


def show(title, columns, rows):
    table = [columns] + [[str(cell) for cell in row] for row in rows]
    widths = [max(len(row[i]) for row in table) for i in range(len(columns))]
    print(f"\n{title}\n")
    for row in [table[0], ["-" * width for width in widths], *table[1:]]:
        print("  " + "  ".join(cell.ljust(width) for cell, width in zip(row, widths)).rstrip())


def speed(bits_per_second):
    return f"{bits_per_second // 1_000_000_000} Gbit/s" if bits_per_second else "-"


def kind(controller_type, other):
    return other if controller_type == 1 else "FC"


def demonstrate(server):
    clients = Clients(server)
    print(f"The embedded CIM server runs on {server.url}, its host has the simulated adapters of scenario 'mixed'.")
    print("Every table below was fetched twice, by wbemcli and by pywbem, and is the same for both.")

    hosts = clients.instances("ZEMLAR_ComputerSystem", ["Name", "ElementName", "StatusDescriptions"])
    show("The host", ["Name", "What", "Status"], [[name, what, status[0]] for name, what, status in hosts])

    adapters = clients.instances(
        "ZEMLAR_PortController",
        ["DeviceID", "Name", "ControllerType", "OtherControllerType", "EnabledState", "StatusDescriptions"],
    )
    show(
        "Its adapters",
        ["Address", "Serial number", "Kind", "State", "Status"],
        [
            [address, serial, kind(type_, other), ENABLED_STATES[state], status[0]]
            for address, serial, type_, other, state, status in adapters
        ],
    )

    ports = clients.instances("ZEMLAR_FCPort", ["DeviceID", "PortNumber", "OperationalStatus", "EnabledState", "Speed", "Caption"])
    show(
        "Their FC ports",
        ["Port WWN", "Port", "Status", "State", "Speed", "Symbolic name"],
        [
            [wwn, number, STATUSES[status[0]], ENABLED_STATES[state], speed(bits), caption]
            for wwn, number, status, state, bits, caption in ports
        ],
    )

    path = clients.pywbem.EnumerateInstanceNames("ZEMLAR_FCPort")[0]
    show(
        f"One port by its path, three properties\n  {path.to_wbem_uri(format='historical')}",
        ["Property", "Value"],
        clients.instance(path, ["ElementName", "MaxSpeed", "SupportedMaximumTransmissionUnit"]),
    )


def main():
    server = SimulatedServer("mixed")
    try:
        demonstrate(server)
    finally:
        code = server.stop()
    if code != 0:
        raise SystemExit(f"demo: the server ended with {code}:\n" + "\n".join(server.lines))
    print("\nThe server has stopped. Done.")


if __name__ == "__main__":
    sys.exit(main())
