"""Everything that a server on a simulated host serves, as text for a person to read: `python -m tools.inventory_text SCENARIO`.

One paragraph a class, in the order of registration. The first instance is told whole, its nulls last; of the others only what differs from the one
before. An association is a line: what it joins, by the keys that tell one instance of the class from another, and what else it says. What depends on the
machine that runs the simulation is put into angle brackets.
"""

import argparse
import re
import socket
import textwrap

import pywbem

from tools.simulated_server import ROOT, SimulatedServer

NAME_SPACE = "root/zemlar"
NULL = "-"
OF_THE_MACHINE = {"NameFormat", "IdentifyingDescriptions"}  # of ZEMLAR_ComputerSystem: what kind of text names it


def served_classes():
    rows = (ROOT / "providers/providers.def").read_text(encoding="utf-8")
    return re.findall(r"^ZMLR_PROVIDER\((\w+), +(?:INSTANCE|ASSOCIATION)", rows, re.MULTILINE)


class Inventory:
    """Reads one server through pywbem."""

    def __init__(self, url):
        self._client = pywbem.WBEMConnection(url, default_namespace=NAME_SPACE, timeout=120)
        self._host = self._client.EnumerateInstances("ZEMLAR_ComputerSystem")[0]["Name"]

    def lines(self):
        for class_name in served_classes():
            yield from self._of_class(class_name)

    def _of_class(self, class_name):
        instances = self._client.EnumerateInstances(class_name)
        yield f"{class_name}: {len(instances) or 'none'}"
        if any(isinstance(value, pywbem.CIMInstanceName) for instance in instances for value in instance.values()):
            yield from map(self._association, instances)
        else:
            yield from self._objects(class_name, instances)
        yield ""

    def _association(self, instance):
        told = (f"{name}={value_text(value)}" for name, value in instance.items() if value is not None)
        return "  " + self._without_host(" ".join(told)).replace(', SystemName="<host>"', "")

    def _objects(self, class_name, instances):
        before = {}
        for number, instance in enumerate(instances, 1):
            properties = {name: self._text(class_name, name, instance[name]) for name in instance.keys()}
            yield f"  {number}" + (", as the one before" if before else "") + (" but for" if before and properties != before else "")
            nulls = [name for name, text in properties.items() if text == NULL and name not in before]
            told = (name for name, text in properties.items() if before.get(name) != text and name not in nulls)
            yield from (f"    {name} = {properties[name]}" for name in told)
            yield from textwrap.wrap("null: " + ", ".join(nulls), 120, initial_indent="    ", subsequent_indent="      ") if nulls else []
            before = properties

    def _text(self, class_name, name, value):
        if class_name == "ZEMLAR_ComputerSystem" and name in OF_THE_MACHINE:
            return f"<{'a list' if isinstance(value, list) else 'a text'}>"
        return self._without_host(value_text(value))

    def _without_host(self, text):
        own_name = "zmlr-cimserver:"  # of the server that serves here
        return text.replace(own_name + socket.gethostname(), own_name + "<name>").replace(self._host, "<host>")


def value_text(value):
    if value is None:
        return NULL
    if isinstance(value, list):
        return "[" + ", ".join(value_text(element) for element in value) + "]"
    if isinstance(value, pywbem.CIMInstanceName):
        usual = {"CreationClassName": value.classname, "SystemCreationClassName": "ZEMLAR_ComputerSystem"}
        keys = (f"{key}={value_text(value[key])}" for key in sorted(value.keys()) if usual.get(key) != value[key])
        return f"{value.classname}({', '.join(keys)})"
    if isinstance(value, str):
        return '"' + value.replace("\\", "\\\\").replace("\n", "\\n").replace("\t", "\\t").replace("\r", "\\r") + '"'
    return str(value)


def inventory_text(url):
    return "\n".join(Inventory(url).lines())


if __name__ == "__main__":
    parser = argparse.ArgumentParser(prog="tools.inventory_text", description="Prints everything that a simulated host serves.")
    parser.add_argument("scenario", metavar="SCENARIO", help="one of sim/scenarios, or a file")
    with SimulatedServer(parser.parse_args().scenario) as running:
        print(inventory_text(running.url))
