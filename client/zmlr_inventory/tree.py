"""The inventory as a tree for a terminal."""

from dataclasses import dataclass, field
from itertools import groupby

from .values import (
    BAD,
    ETHERNET_PORT_TYPE,
    FC_PORT_TYPE,
    GOOD,
    IDLE,
    colons,
    level,
    ranges,
    speed,
    status_words,
    visible,
    word,
)

FEW = 8  # units of a kind that are told one by one

COLOURS = {GOOD: "32", BAD: "1;31", IDLE: "33", "title": "1", "remark": "31"}
UNTOLD_PORT_TYPES = (None, 0)


class Style:
    """How a tree is drawn: with colours or without, with lines or their next of kin in ASCII."""

    def __init__(self, colour=False, ascii_only=False):
        self._colour = colour
        self.branch, self.last, self.through = ("|-- ", "`-- ", "|   ") if ascii_only else ("├─ ", "└─ ", "│  ")

    def paint(self, kind, text):
        return f"\x1b[{COLOURS[kind]}m{text}\x1b[0m" if self._colour and kind in COLOURS else text


@dataclass
class Node:
    text: str
    children: list = field(default_factory=list)


def tree_text(inventory, style, everything=False):
    """All hosts; `everything` tells each unit of a long row too."""
    drawing = _Drawing(style, everything)
    return "\n\n".join("\n".join(_lines(drawing.host(host), style)) for host in inventory.hosts)


def _lines(node, style):
    yield node.text
    for number, child in enumerate(node.children, 1):
        last = number == len(node.children)
        first, *rest = _lines(child, style)
        yield (style.last if last else style.branch) + first
        indent = " " * len(style.through) if last else style.through
        yield from (indent + line for line in rest)


class _Drawing:
    def __init__(self, style, everything):
        self._paint, self._everything = style.paint, everything

    def host(self, host):
        children = [Node(visible(_words(f"driver {driver.identity}", driver.version))) for driver in host.software]
        children += map(self._adapter, host.adapters)
        if not host.adapters:
            children.append(Node("no adapters"))
        children += [Node(self._paint("remark", "not read: " + visible(text))) for text in host.unread]
        children += [Node(visible(text)) for text in host.notes]
        return Node(_words(self._paint("title", visible(host.name)), visible(host.url), self._status(host.status)), children)

    def _adapter(self, adapter):
        software = ", ".join(f"{one.identity.rpartition('_')[2]} {one.version}" for one in adapter.software)
        text = _words(
            self._paint("title", visible(f"{adapter.kind} {adapter.model or colons(adapter.address)}")),
            visible(f"serial {adapter.serial_number}") if adapter.serial_number else "",
            self._status(adapter.status, adapter.state),
            visible(software),
        )
        ethernet = {port.number: port for port in adapter.ethernet_ports}
        children = [self._port(port, ethernet.pop(port.number, None)) for port in adapter.ports]
        return Node(text, children + [self._ethernet(port, f"port {port.number}  ") for port in ethernet.values()])

    def _port(self, port, ethernet):
        text = _words(
            self._paint("title", f"port {'?' if port.number is None else port.number}"),
            visible(colons(port.wwn)),
            self._status(port.status, port.state),
            speed(port.speed),
            f"{word(FC_PORT_TYPE, port.port_type)} port" if port.port_type not in UNTOLD_PORT_TYPES else "",
            visible(port.name),
            "beacon on" if port.beacon else "",
        )
        children = [self._ethernet(ethernet)] if ethernet else []
        if port.module and not ethernet:
            children.append(_module(port.module))
        return Node(text, children + [self._target(target) for target in port.targets])

    def _ethernet(self, port, before=""):
        text = _words(
            f"{before}Ethernet {visible(port.interface)}",
            visible(colons(port.mac)),
            self._status(port.status),
            word(ETHERNET_PORT_TYPE, port.port_type) if port.port_type not in UNTOLD_PORT_TYPES else "",
            f"MTU {port.mtu}" if port.mtu else "",
        )
        return Node(text, [_module(port.module)] if port.module else [])

    def _target(self, target):
        children = []
        for (kind, model, status), units in groupby(target.luns, lambda lun: (lun.kind, lun.model, lun.status)):
            units = list(units)
            if len(units) > FEW and not self._everything:
                numbers = ranges(unit.number for unit in units)
                children.append(Node(_words(f"LUN {numbers}", f"{len(units)} {kind}s", visible(model), self._status(status))))
            else:
                children += [
                    Node(_words(f"LUN {unit.number}", kind, visible(model), visible(unit.name), self._status(status))) for unit in units
                ]
        return Node(_words("target " + visible(colons(target.wwn)), "" if target.luns else "no logical units"), children)

    def _status(self, status, state=None):
        return self._paint(level(status), ", ".join(status_words(status, state)))


def _module(module):
    serial = f"serial {module.serial_number}" if module.serial_number else ""
    made_for = f"for {module.made_for}" if module.made_for else ""
    return Node(visible(_words(f"module {module.kind}", module.vendor, module.part_number, serial, made_for)))


def _words(*texts):
    return "  ".join(text for text in texts if text)
