"""What a host has: plain data, as the CIM server told it, joined to a tree.

World wide names and MAC addresses are upper case digits without separators, as in the keys of the classes. Codes (`status`, `state`)
are those of CIM's OperationalStatus and EnabledState; `values` has their words. A fact that was not told is None.
"""

from __future__ import annotations

from dataclasses import dataclass, field


@dataclass
class Statistics:
    """The counters of an FC port since its driver was loaded or they were reset."""

    bytes_transmitted: int | None = None
    bytes_received: int | None = None
    packets_transmitted: int | None = None
    packets_received: int | None = None
    error_frames: int | None = None
    dumped_frames: int | None = None
    crc_errors: int | None = None
    link_failures: int | None = None
    losses_of_signal: int | None = None
    losses_of_sync: int | None = None
    primitive_sequence_protocol_errors: int | None = None
    invalid_transmission_words: int | None = None
    lip_count: int | None = None
    nos_count: int | None = None


@dataclass
class Module:
    """The pluggable transceiver of a port."""

    tag: str
    kind: str = ""  # "SFP", ...
    vendor: str = ""
    part_number: str = ""
    serial_number: str = ""
    revision: str = ""
    made_for: str = ""  # compliance codes or speeds


@dataclass
class Lun:
    """A logical unit as one FC port sees it."""

    number: int
    kind: str  # "disk" or "tape"; media changers are told as tapes
    model: str  # vendor and product
    name: str  # its identification: of the unit, the same through every port
    status: int | None = None


@dataclass
class Target:
    """A remote port with logical units, as one FC port sees it."""

    wwn: str
    luns: list[Lun] = field(default_factory=list)


@dataclass
class Port:
    """The FC side of an adapter's port."""

    wwn: str
    node_wwn: str = ""
    number: int | None = None
    name: str = ""  # symbolic
    status: int | None = None
    state: int | None = None
    speed: int | None = None  # bit/s; 0 without a link
    max_speed: int | None = None  # bit/s
    port_type: int | None = None
    max_frame_size: int | None = None  # bytes
    beacon: bool | None = None
    statistics: Statistics | None = None
    module: Module | None = None
    targets: list[Target] = field(default_factory=list)


@dataclass
class EthernetPort:
    """The Ethernet side of a converged adapter's port; the FC side of the same port has the same number."""

    mac: str
    number: int | None = None
    interface: str = ""
    status: int | None = None
    port_type: int | None = None
    mtu: int | None = None  # bytes
    module: Module | None = None


@dataclass
class Software:
    """A driver, a firmware or a boot code."""

    identity: str
    name: str = ""
    version: str = ""


@dataclass
class Adapter:
    address: str  # MAC of a converged adapter, node WWN of an FC HBA
    kind: str  # "CNA" or "FC HBA"
    model: str = ""
    serial_number: str = ""
    fru_number: str = ""
    vendor: str = ""
    status: int | None = None
    state: int | None = None
    software: list[Software] = field(default_factory=list)
    ports: list[Port] = field(default_factory=list)
    ethernet_ports: list[EthernetPort] = field(default_factory=list)


@dataclass
class Host:
    url: str  # of its CIM server
    name: str
    status: int | None = None
    software: list[Software] = field(default_factory=list)  # the drivers, which all adapters share
    adapters: list[Adapter] = field(default_factory=list)
    unread: list[str] = field(default_factory=list)  # what could not be read of it, a sentence each
    notes: list[str] = field(default_factory=list)  # what belongs to nothing above, a sentence each


@dataclass
class Failure:
    """A host that told nothing."""

    url: str
    reason: str


@dataclass
class Inventory:
    hosts: list[Host] = field(default_factory=list)
    failures: list[Failure] = field(default_factory=list)
