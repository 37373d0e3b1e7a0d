"""What the demonstration shows: a title, a class, and for each column its heading, its property and how a value is told."""

from zmlr_inventory.values import ENABLED_STATE, ETHERNET_PORT_TYPE, FC_PORT_TYPE, OPERATIONAL_STATUS, speed

ALARM_STATES = {1: "off", 3: "blinking"}
JOB_STATES = {4: "Running", 7: "Completed"}
COMPLETION_STATES = {2: "Passed", 5: "Failed"}
HEALTH_STATES = {0: "Unknown", 5: "OK", 10: "Degraded", 15: "Minor failure"}
ROLES = {2: "Initiator", 3: "Target"}
NAME_FORMATS = {0: "Unknown", 1: "Other", 7: "vendor+product+serial", 9: "NAA", 10: "EUI-64", 11: "T10 vendor"}


def status(codes):
    return OPERATIONAL_STATUS[codes[0]]


def count(number):
    return f"{number:,}"


def gigabits(bits_per_second):
    return speed(bits_per_second) or "-"


def part(index):
    """Tells the part of a key "<port WWN>_<target WWN>_<vendor>_<product>_LUN_<number>"; an initiator's key is its port WWN."""
    return lambda key: key.split("_")[index] if "_" in key else "-" if index else key


def device(device_id):
    return " ".join(device_id.split("_")[2:-2])


def place(tag):
    """The adapter and port of a module, by its tag "<serial number>_<adapter>_<port>"."""
    return "adapter {}, port {}".format(*tag.split("_")[-2:])


def media(text):
    """Ethernet media by their names, FC speeds in MB/s."""
    return text.replace(",", ", ") + " MB/s" if text[:1].isdigit() and "BASE" not in text else text


UNIT = [
    ("Port WWN", "DeviceID", part(0)),
    ("Target WWN", "DeviceID", part(1)),
    ("Unit", "ElementName", str),
    ("Device", "DeviceID", device),
    ("Name", "Name", str),
]

TABLES = [
    ("The host", "ZEMLAR_ComputerSystem", [("Name", "Name", str), ("What", "ElementName", str), ("Status", "OperationalStatus", status)]),
    (
        "Its adapters",
        "ZEMLAR_PortController",
        [
            ("Address", "DeviceID", str),
            ("Kind", "Caption", str),
            ("Serial number", "Name", str),
            ("State", "EnabledState", ENABLED_STATE.get),
            ("Status", "OperationalStatus", status),
        ],
    ),
    (
        "Their cards",
        "ZEMLAR_PhysicalPackage",
        [
            ("Tag", "Tag", str),
            ("Manufacturer", "Manufacturer", str),
            ("Model", "Model", str),
            ("Serial number", "SerialNumber", str),
            ("FRU number", "FRUNumber", str),
        ],
    ),
    (
        "Their products",
        "ZEMLAR_Product",
        [("Serial number", "IdentifyingNumber", str), ("What", "ElementName", str), ("Vendor", "Vendor", str), ("Version", "Version", str)],
    ),
    (
        "Their software",
        "ZEMLAR_AdapterSoftwareIdentity",
        [("Identity", "InstanceID", str), ("What", "ElementName", str), ("Version", "VersionString", str)],
    ),
    (
        "Their FC ports",
        "ZEMLAR_FCPort",
        [
            ("Port WWN", "DeviceID", str),
            ("Port", "PortNumber", str),
            ("Status", "OperationalStatus", status),
            ("State", "EnabledState", ENABLED_STATE.get),
            ("Type", "PortType", FC_PORT_TYPE.get),
            ("Speed", "Speed", gigabits),
            ("At most", "MaxSpeed", gigabits),
            ("Symbolic name", "Caption", str),
        ],
    ),
    (
        "What the FC ports have counted",
        "ZEMLAR_FCPortStatistics",
        [
            ("Port WWN", "InstanceID", str),
            ("Bytes sent", "BytesTransmitted", count),
            ("Bytes received", "BytesReceived", count),
            ("Frames sent", "PacketsTransmitted", count),
            ("Frames received", "PacketsReceived", count),
            ("Errored", "ErrorFrames", count),
            ("Dropped", "DumpedFrames", count),
            ("CRC errors", "CRCErrors", count),
            ("Link failures", "LinkFailures", count),
        ],
    ),
    (
        "The SCSI initiators in the ports, and the targets that they see",
        "ZEMLAR_SCSIProtocolEndpoint",
        [("Port WWN", "Name", part(0)), ("Target WWN", "Name", part(1)), ("Role", "Role", ROLES.get), ("Status", "OperationalStatus", status)],
    ),
    ("The disks behind the targets", "ZEMLAR_StorageExtent", [*UNIT, ("Kind of name", "NameFormat", NAME_FORMATS.get)]),
    ("The tapes behind the targets", "ZEMLAR_TapeDrive", UNIT),
    (
        "The Ethernet ports",
        "ZEMLAR_EthernetPort",
        [
            ("MAC", "DeviceID", str),
            ("Interface", "ElementName", str),
            ("Port", "PortNumber", str),
            ("Status", "OperationalStatus", status),
            ("Type", "PortType", ETHERNET_PORT_TYPE.get),
        ],
    ),
    (
        "Their LAN endpoints",
        "ZEMLAR_LANEndpoint",
        [
            ("Interface", "Name", str),
            ("MAC", "MACAddress", str),
            ("MTU", "MaxDataSize", count),
            ("Health", "HealthState", HEALTH_STATES.get),
        ],
    ),
    (
        "The modules in the ports",
        "ZEMLAR_PhysicalConnector",
        [
            ("Where", "Tag", place),
            ("Kind", "Model", str),
            ("Manufacturer", "Manufacturer", str),
            ("Part number", "PartNumber", str),
            ("Revision", "Version", str),
            ("Serial number", "SerialNumber", str),
            ("Made for", "Description", media),
        ],
    ),
    ("The beacons of the ports", "ZEMLAR_AlarmDevice", [("Port WWN", "DeviceID", str), ("Beacon", "AlarmState", ALARM_STATES.get)]),
]

# What a run leaves.
RUN_TABLES = [
    (
        "The job",
        "ZEMLAR_ConcreteJob",
        [("Job", "InstanceID", str), ("State", "JobState", JOB_STATES.get), ("Done", "PercentComplete", "{} %".format)],
    ),
    (
        "What the test did",
        "ZEMLAR_DiagnosticServiceRecord",
        [("Record", "InstanceID", str), ("Element", "ManagedElementName", str), ("Step", "RecordData", str)],
    ),
    (
        "How it went",
        "ZEMLAR_DiagnosticCompletionRecord",
        [("Record", "InstanceID", str), ("State", "CompletionState", COMPLETION_STATES.get), ("Outcome", "RecordData", str)],
    ),
]
