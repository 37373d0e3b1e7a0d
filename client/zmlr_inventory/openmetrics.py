"""The inventory as samples of the metric families in families.tsv: OpenMetrics 1.0, or the form that the textfile collector of the
Prometheus node exporter reads, which names counters and infos differently."""

import csv
import errno
import functools
import os
import time
from collections import Counter
from pathlib import Path
from urllib.parse import urlsplit

from .files import write_atomically
from .model import Host

BITS_OF_BYTE = 8
ENABLED = 2
COLLECTED = ".prom"  # the collector reads no other files


@functools.cache
def _table(name):
    with (Path(__file__).resolve().parent / name).open(encoding="utf-8", newline="") as file:
        return list(csv.DictReader(file, delimiter="\t", quoting=csv.QUOTE_NONE))


def write_openmetrics(path, inventory):
    """Writes the file, unless no host was read whole: then an old one stays. Raises OSError."""
    if all(host.unread for host in inventory.hosts):
        return
    if os.path.lexists(path) and (os.path.islink(path) or not os.path.isfile(path)):
        raise FileExistsError(errno.EEXIST, "is no regular file", path)
    text = openmetrics_text(inventory, str(path).endswith(COLLECTED))
    write_atomically(path, text.encode(), mode=0o644)  # the collector is another user


def openmetrics_text(inventory, for_collector):
    """Samples of several hosts carry the label `host`. A host that was not read whole tells nothing, since what was not read looks
    like what is not there; of several hosts hxa_host_up tells which ones these are."""
    several = len(inventory.hosts) + len(inventory.failures) > 1
    samples = []
    for host in [*inventory.failures, *inventory.hosts]:
        label = {"host": urlsplit(host.url).netloc} if several else {}
        is_up = isinstance(host, Host) and not host.unread
        samples += [("hxa_host_up", label, int(is_up))] if several else []
        samples += [(family, {**label, **labels}, value) for family, labels, value in (_samples(host) if is_up else [])]
    lines = [line for family in _table("families.tsv") for line in _lines(family, samples, for_collector)]
    return "\n".join([*lines, "# EOF", ""])


def _lines(family, samples, for_collector):
    """A collector refuses a text that has a series twice: the first one stays."""
    series = {}
    for name, labels, value in samples:
        if name == family["family"] and value is not None:
            series.setdefault(name + _braces(labels), value)
    if not series:
        return []
    name, kind = family["family"], family["type"]
    if not for_collector:
        name = name.removesuffix("_total").removesuffix("_info")
    elif kind == "info":
        kind = "gauge"
    head = [f"# HELP {name} {family['help']}", f"# TYPE {name} {kind}"]
    head += [f"# UNIT {name} {family['unit']}"] if family["unit"] != "-" and not for_collector else []
    return head + [f"{key} {value}" for key, value in series.items()]


def _braces(labels):
    told = [f'{name}="{_escaped(value)}"' for name, value in labels.items() if value != ""]
    return "{" + ",".join(told) + "}" if told else ""


def _escaped(value):
    text = str(value).encode("utf-8", "replace").decode("utf-8")
    return text.replace("\\", "\\\\").replace("\n", "\\n").replace('"', '\\"')


def _samples(host):
    yield "hxa_adapters", {}, len(host.adapters)
    yield "hxa_last_read_timestamp_seconds", {}, int(time.time())
    serial_numbers = Counter(adapter.serial_number for adapter in host.adapters)
    for adapter in host.adapters:
        label = {"adapter": _adapter_label(adapter, serial_numbers)}
        firmware = [software.version for software in adapter.software if software.identity.endswith("_firmware")]
        about = {"kind": adapter.kind, "model": adapter.model, "firmware_version": next(iter(firmware), "")}
        yield "hxa_adapter_info", {**label, **about}, 1
        if adapter.state is not None:
            yield "hxa_adapter_enabled", label, int(adapter.state == ENABLED)
        for port in adapter.ports:
            yield from _port_samples(port, {**label, "port_wwn": port.wwn}, adapter.kind == "CNA")
        for port in adapter.ethernet_ports:
            labels = {**label, "mac": port.mac}
            yield "hxa_ethernet_port_info", {**labels, "port": _told(port.number), "interface": port.interface}, 1
            yield from _states("hxa_ethernet_port_state", labels, port.status)


def _adapter_label(adapter, serial_numbers):
    """The serial number, and where several cards of the host have it, the address too."""
    told = [adapter.serial_number] if serial_numbers[adapter.serial_number] == 1 else [adapter.serial_number, adapter.address]
    return "_".join(filter(None, told))


def _port_samples(port, labels, is_fcoe):
    about = {"node_wwn": port.node_wwn, "port": _told(port.number), "symbolic_name": port.name}
    yield "hxa_port_info", {**labels, **about}, 1
    yield from _states("hxa_port_state", labels, port.status)
    yield "hxa_port_speed_bytes_per_second", labels, _bytes(port.speed)
    yield "hxa_port_max_speed_bytes_per_second", labels, _bytes(port.max_speed)
    is_answering = port.status is not None and _state(port.status) not in ("error", "unknown")
    if is_answering:  # else the controller may be out of service, and nobody knows of the module
        yield "hxa_port_module_present", labels, int(port.module is not None)
    if is_answering and port.module:
        module = {name: getattr(port.module, name) for name in ("vendor", "part_number", "serial_number", "revision")}
        yield "hxa_port_module_info", {**labels, **module}, 1
    if port.statistics:
        yield from _counters(port.statistics, labels, "fcoe" if is_fcoe else "fc")


def _counters(statistics, labels, side):
    """What a side does not count is 0 in its statistics, and left out here."""
    from .reading import COUNTERS

    for name, told in COUNTERS.items():
        for family in _table("families.tsv"):
            if family["cim"] == f"FCPortStatistics.{told}" and family[side] != "-":
                yield family["family"], labels, getattr(statistics, name)


def _states(family, labels, status):
    if status is not None:
        for row in _table("port_states.tsv"):
            yield family, {**labels, "state": row["state"]}, int(row["state"] == _state(status))


def _state(status):
    """The word of an OperationalStatus; the last row is for all others."""
    rows = _table("port_states.tsv")
    return next((row["state"] for row in rows if row["cim"] == str(status)), rows[-1]["state"])


def _told(number):
    return "" if number is None else number


def _bytes(bits):
    return None if bits is None else bits // BITS_OF_BYTE
