"""Everything that a server on a simulated host serves, as text for a person to read: `python -m tools.inventory_text SCENARIO`.

One paragraph a class, in the order of registration. The first instance is told whole, its nulls last; of the others only what differs from the one
before. An association is a line: what it joins, by the keys that tell one instance of the class from another, and what else it says. Of a long row that
differs from each to the next only by numbers one higher, as the units behind a target do, the first two are told. What depends on the machine that runs
the simulation is put into angle brackets.
"""

import argparse
import re
import socket
import textwrap

import pywbem

from tools.simulated_server import ROOT, SimulatedServer

NAME_SPACE = "root/zemlar"
NULL = "-"
LONG_ROW = 10
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
            told = [{"": self._association(instance)} for instance in instances]
            yield from without_counting(told, [[texts[""]] for texts in told])
        else:
            told = [{name: self._text(class_name, name, instance[name]) for name in instance.keys()} for instance in instances]
            yield from without_counting(told, list(paragraphs(told)))
        yield ""

    def _association(self, instance):
        told = (f"{name}={value_text(value)}" for name, value in instance.items() if value is not None)
        return "  " + self._without_host(" ".join(told)).replace(', SystemName="<host>"', "")

    def _text(self, class_name, name, value):
        if class_name == "ZEMLAR_ComputerSystem" and name in OF_THE_MACHINE:
            return f"<{'a list' if isinstance(value, list) else 'a text'}>"
        return self._without_host(value_text(value))

    def _without_host(self, text):
        own_name = "zmlr-cimserver:"  # of the server that serves here
        return text.replace(own_name + socket.gethostname(), own_name + "<name>").replace(self._host, "<host>")


def paragraphs(instances):
    """The lines of each instance, given as its properties' texts."""
    before = {}
    for number, properties in enumerate(instances, 1):
        lines = [f"  {number}" + (", as the one before" if before else "") + (" but for" if before and properties != before else "")]
        nulls = [name for name, text in properties.items() if text == NULL and name not in before]
        lines += [f"    {name} = {text}" for name, text in properties.items() if before.get(name) != text and name not in nulls]
        lines += textwrap.wrap("null: " + ", ".join(nulls), 120, initial_indent="    ", subsequent_indent="      ") if nulls else []
        yield lines
        before = properties


def without_counting(instances, lines):
    """Their lines, but for those of rows that count on as they began."""
    at = 0
    while at < len(instances):
        yield from lines[at]
        at += 1
        step = counted(instances[at - 2], instances[at - 1]) if at > 1 else None
        end = at
        while step and end < len(instances) and counted(instances[end - 1], instances[end]) == step:
            end += 1
        if end - at >= LONG_ROW:
            yield f"  and {end - at} more, each counted on from the one before"
            at = end


def counted(before, now):
    """Where they differ, if they do so only by numbers one higher."""
    places = []
    for name, text in now.items():
        old_parts, new_parts = (re.split("([0-9A-F]+)", of) for of in (before[name], text))
        if len(old_parts) != len(new_parts):
            return None
        for place, (old, new) in enumerate(zip(old_parts, new_parts)):
            if old != new and not follows(old, new):
                return None
            places += [(name, place)] if old != new else []
    return places


def follows(old, new):
    """Whether a number is the next one. Long ones may be hexadecimal."""
    bases = [10, 16] if len(old) == len(new) >= 8 else [10]
    return any(re.fullmatch("[0-9]+" if base == 10 else "[0-9A-F]+", old + new) and int(new, base) == int(old, base) + 1 for base in bases)


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
