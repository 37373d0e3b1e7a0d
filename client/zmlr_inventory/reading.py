"""Reads one host: every class is enumerated once, and the objects find each other here, by their keys.

The work grows with the answer: a logical unit costs its own instance and nothing else. The paths between initiators, targets and
units are not asked for, since the keys of a unit tell them, and the server would question every unit once more.
"""

from __future__ import annotations

import re
from urllib.parse import urlsplit

import pywbem

from .model import Adapter, EthernetPort, Host, Lun, Module, Port, Software, Statistics, Target

NAME_SPACE = "root/zemlar"

# Counters: our name and the property.
COUNTERS = {
    "bytes_transmitted": "BytesTransmitted",
    "bytes_received": "BytesReceived",
    "packets_transmitted": "PacketsTransmitted",
    "packets_received": "PacketsReceived",
    "error_frames": "ErrorFrames",
    "dumped_frames": "DumpedFrames",
    "crc_errors": "CRCErrors",
    "link_failures": "LinkFailures",
    "losses_of_signal": "LossOfSignalCounter",
    "losses_of_sync": "LossOfSyncCounter",
    "primitive_sequence_protocol_errors": "PrimitiveSeqProtocolErrCount",
    "invalid_transmission_words": "InvalidTransmissionWords",
    "lip_count": "LIPCount",
    "nos_count": "NOSCount",
}

# What is asked of each class, in this order; None is everything (associations).
PROPERTIES = {
    "ComputerSystem": ["Name", "OperationalStatus"],
    "PortController": ["DeviceID", "Name", "OtherControllerType", "EnabledState", "OperationalStatus"],
    "PhysicalPackage": ["Tag", "Manufacturer", "Model", "SerialNumber", "FRUNumber"],
    "AdapterSoftwareIdentity": ["InstanceID", "Name", "VersionString"],
    "FCPort": "DeviceID Name Caption PortNumber EnabledState OperationalStatus Speed MaxSpeed PortType SupportedMaximumTransmissionUnit".split(),
    "ControlledBy": None,
    "FCPortStatistics": ["InstanceID", *COUNTERS.values()],
    "AlarmDevice": ["DeviceID", "AlarmState"],
    "EthernetPort": ["DeviceID", "ElementName", "PortNumber", "OperationalStatus", "PortType"],
    "EthernetPortControlledBy": None,
    "LANEndpoint": ["MACAddress", "MaxDataSize"],
    "PhysicalConnector": ["Tag", "Model", "Manufacturer", "PartNumber", "SerialNumber", "Version", "Description"],
    "PhysicalConnectorContainer": None,
    "SCSIProtocolEndpoint": ["Name", "Role"],
    "StorageExtent": ["DeviceID", "Name", "OperationalStatus"],
    "TapeDrive": ["DeviceID", "Name", "OperationalStatus"],
}

TARGET_ROLE = 3
ALARM_OFF, ALARM_UNKNOWN = 1, 0
UNIT = re.compile(r"(?P<port>[^_]*)_(?P<target>[^_]*)_(?P<model>.*)_LUN_(?P<number>[0-9]{1,19})", re.DOTALL)


def read_host(connection, on_class=None):
    """All that a server tells; `on_class(name, number, count)` is called before each class is read.

    A class that cannot be read is told in `unread`; the host as a whole raises pywbem.Error when it cannot be reached, refuses the
    login, or tells nothing at all."""
    host = Host(connection.url, name=urlsplit(connection.url).hostname or connection.url)
    answers, first_error = {}, None
    for number, class_name in enumerate(PROPERTIES, 1):
        if on_class:
            on_class(class_name, number, len(PROPERTIES))
        try:
            answers[class_name] = _instances(connection, class_name)
        except pywbem.CIMError as error:
            first_error = first_error or error
            answers[class_name] = []
            host.unread.append(f"ZEMLAR_{class_name}: {error.status_code_name}: {error.status_description}")
    if len(host.unread) == len(PROPERTIES):
        raise first_error
    _Joining(host, answers).join()
    return host


def _instances(connection, class_name):
    return connection.EnumerateInstances(
        f"ZEMLAR_{class_name}",
        namespace=NAME_SPACE,
        LocalOnly=False,
        DeepInheritance=False,
        IncludeQualifiers=False,
        IncludeClassOrigin=False,
        PropertyList=PROPERTIES[class_name],
    )


class _Joining:
    """The answers about one host on their way into its tree."""

    def __init__(self, host, answers):
        self._host, self._answers = host, answers
        self._adapters, self._ports, self._targets = {}, {}, {}  # by their keys

    def join(self):
        for system in self._answers["ComputerSystem"]:
            self._host.name = _text(system, "Name") or self._host.name
            self._host.status = _status(system)
        self._add_adapters()
        self._add_cards()
        self._add_software()
        self._add_ports()
        self._add_ethernet_ports()
        self._add_modules()
        self._add_targets()
        self._add_units()

    def _add_adapters(self):
        for controller in self._answers["PortController"]:
            adapter = Adapter(
                address=_text(controller, "DeviceID"),
                kind="CNA" if _text(controller, "OtherControllerType").startswith("CNA") else "FC HBA",
                serial_number=_text(controller, "Name"),
                state=_number(controller, "EnabledState"),
                status=_status(controller),
            )
            self._adapters[adapter.address] = adapter
            self._host.adapters.append(adapter)

    def _add_cards(self):
        """A card's tag ends with its adapter's address."""
        for card in self._answers["PhysicalPackage"]:
            adapter = self._adapter_of_card(_text(card, "Tag"))
            if adapter:
                adapter.vendor, adapter.model = _text(card, "Manufacturer"), _text(card, "Model")
                adapter.fru_number = _text(card, "FRUNumber")

    def _adapter_of_card(self, tag):
        digits = tag.replace("-", "")
        return self._adapters.get(digits[-16:]) or self._adapters.get(digits[-12:])

    def _add_software(self):
        """An adapter's own software is named after its address."""
        for identity in self._answers["AdapterSoftwareIdentity"]:
            software = Software(_text(identity, "InstanceID"), _text(identity, "Name"), _text(identity, "VersionString"))
            owner = self._adapters.get(software.identity.rpartition("_")[0], self._host)
            owner.software.append(software)

    def _add_ports(self):
        adapter_of = self._adapters_by("ControlledBy")
        statistics = {_text(counts, "InstanceID"): counts for counts in self._answers["FCPortStatistics"]}
        beacons = {_text(beacon, "DeviceID"): _number(beacon, "AlarmState") for beacon in self._answers["AlarmDevice"]}
        for found in self._answers["FCPort"]:
            wwn = _text(found, "DeviceID")
            beacon = beacons.get(wwn) or ALARM_UNKNOWN
            port = Port(
                wwn=wwn,
                node_wwn=_text(found, "Name").partition(":")[0],
                number=_number(found, "PortNumber"),
                name=_text(found, "Caption"),
                state=_number(found, "EnabledState"),
                status=_status(found),
                speed=_number(found, "Speed"),
                max_speed=_number(found, "MaxSpeed"),
                port_type=_number(found, "PortType"),
                max_frame_size=_number(found, "SupportedMaximumTransmissionUnit"),
                beacon=None if beacon == ALARM_UNKNOWN else beacon != ALARM_OFF,
            )
            if wwn in statistics:
                port.statistics = Statistics(**{name: _number(statistics[wwn], told) for name, told in COUNTERS.items()})
            self._ports[wwn] = port
            self._place(adapter_of.get(wwn), "ports", port, f"FC port {wwn}")

    def _add_ethernet_ports(self):
        adapter_of = self._adapters_by("EthernetPortControlledBy")
        mtus = {_text(end, "MACAddress"): _number(end, "MaxDataSize") for end in self._answers["LANEndpoint"]}
        for found in self._answers["EthernetPort"]:
            mac = _text(found, "DeviceID")
            port = EthernetPort(
                mac=mac,
                number=_number(found, "PortNumber"),
                interface=_text(found, "ElementName"),
                status=_status(found),
                port_type=_number(found, "PortType"),
                mtu=mtus.get(mac),
            )
            self._place(adapter_of.get(mac), "ethernet_ports", port, f"Ethernet port {mac}")

    def _adapters_by(self, association):
        """The adapters by the DeviceID of the ports that they control."""
        rows = self._answers[association]
        return {_key(row, "Dependent", "DeviceID"): self._adapters.get(_key(row, "Antecedent", "DeviceID")) for row in rows}

    def _place(self, adapter, where, port, told_as):
        if adapter:
            getattr(adapter, where).append(port)
        else:
            self._host.notes.append(f"{told_as} belongs to no adapter that the host tells of")

    def _add_modules(self):
        """A module sits in a card; the end of its tag is the number of its port there."""
        cards = {
            _key(row, "PartComponent", "Tag"): _key(row, "GroupComponent", "Tag") for row in self._answers["PhysicalConnectorContainer"]
        }
        for found in self._answers["PhysicalConnector"]:
            module = Module(
                tag=_text(found, "Tag"),
                kind=_text(found, "Model"),
                vendor=_text(found, "Manufacturer"),
                part_number=_text(found, "PartNumber"),
                serial_number=_text(found, "SerialNumber"),
                revision=_text(found, "Version"),
                made_for=_text(found, "Description"),
            )
            adapter = self._adapter_of_card(cards.get(module.tag, ""))
            number = module.tag.rpartition("_")[2]
            sides = [port for port in [*adapter.ports, *adapter.ethernet_ports] if str(port.number) == number] if adapter else []
            for side in sides:
                side.module = module
            if not sides:
                self._host.notes.append(f"module {module.tag} ({module.kind}) sits in no port that the host tells of")

    def _add_targets(self):
        for end in self._answers["SCSIProtocolEndpoint"]:
            if _number(end, "Role") == TARGET_ROLE:
                port, _, wwn = _text(end, "Name").partition("_")
                self._target(port, wwn)

    def _target(self, port, wwn):
        if (port, wwn) not in self._targets:
            self._targets[port, wwn] = Target(wwn)
            if port in self._ports:
                self._ports[port].targets.append(self._targets[port, wwn])
            else:
                self._host.notes.append(f"target {wwn} is behind FC port {port}, which the host does not tell of")
        return self._targets[port, wwn]

    def _add_units(self):
        """A unit's key names its port, its target, its model and its number. A target may list a unit more than once."""
        unplaced, seen = 0, set()
        for class_name, kind in (("StorageExtent", "disk"), ("TapeDrive", "tape")):
            for unit in self._answers[class_name]:
                key = _text(unit, "DeviceID")
                if key in seen:
                    continue
                seen.add(key)
                told = UNIT.fullmatch(key)
                if not told:
                    unplaced += 1
                    continue
                lun = Lun(int(told["number"]), kind, told["model"].replace("_", " ", 1), _text(unit, "Name"), _status(unit))
                self._target(told["port"], told["target"]).luns.append(lun)
        for target in self._targets.values():
            target.luns.sort(key=lambda lun: lun.number)
        if unplaced:
            self._host.notes.append(f"{unplaced} logical units have keys that name no port and target")


def _text(instance, name):
    value = instance.get(name)  # of an instance or a path
    return value if isinstance(value, str) else ""


def _number(instance, name):
    value = instance.get(name)
    return int(value) if isinstance(value, int) else None


def _status(instance):
    """The first of the operational states, which is the main one."""
    states = instance.get("OperationalStatus")
    return int(states[0]) if isinstance(states, list) and states and isinstance(states[0], int) else None


def _key(association, role, key):
    path = association.get(role)
    return _text(path, key) if isinstance(path, pywbem.CIMInstanceName) else ""
