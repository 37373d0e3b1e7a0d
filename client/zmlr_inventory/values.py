"""The words of CIM's codes, and texts that devices filled made safe to show."""

import unicodedata

OPERATIONAL_STATUS = {
    0: "Unknown",
    1: "Other",
    2: "OK",
    3: "Degraded",
    4: "Stressed",
    5: "Predictive Failure",
    6: "Error",
    7: "Non-Recoverable Error",
    8: "Starting",
    9: "Stopping",
    10: "Stopped",
    11: "In Service",
    12: "No Contact",
    13: "Lost Communication",
    14: "Aborted",
    15: "Dormant",
    16: "Supporting Entity in Error",
    17: "Completed",
    18: "Power Mode",
}
ENABLED_STATE = {
    0: "Unknown",
    1: "Other",
    2: "Enabled",
    3: "Disabled",
    4: "Shutting Down",
    5: "Not Applicable",
    6: "Enabled but Offline",
    7: "In Test",
    8: "Deferred",
    9: "Quiesce",
    10: "Starting",
}
FC_PORT_TYPE = {
    0: "Unknown",
    1: "Other",
    10: "N",
    11: "NL",
    12: "F/NL",
    13: "Nx",
    14: "E",
    15: "F",
    16: "FL",
    17: "B",
    18: "G",
}
ETHERNET_PORT_TYPE = {
    0: "Unknown",
    1: "Other",
    50: "10BaseT",
    51: "10-100BaseT",
    52: "100BaseT",
    53: "1000BaseT",
    54: "2500BaseT",
    55: "10GBaseT",
    56: "10GBase-CX4",
    100: "100Base-FX",
    101: "100Base-SX",
    102: "1000Base-SX",
    103: "1000Base-LX",
    104: "1000Base-CX",
    105: "10GBase-SR",
    106: "10GBase-SW",
    107: "10GBase-LX4",
    108: "10GBase-LR",
    109: "10GBase-LW",
    110: "10GBase-ER",
    111: "10GBase-EW",
}
PERCEIVED_SEVERITY = {0: "Unknown", 2: "Information", 3: "Warning", 4: "Minor", 5: "Major", 6: "Critical", 7: "Fatal"}

GOOD, BAD, IDLE = "good", "bad", "idle"
_SAYING_NOTHING = (None, 0, 1, 2, 5)  # unknown, other, enabled, not applicable
_LEVELS = {2: GOOD, 11: GOOD, 17: GOOD, 6: BAD, 7: BAD, 12: BAD, 13: BAD, 14: BAD, 16: BAD, 9: IDLE, 10: IDLE, 15: IDLE}


def word(table, code):
    """The word of a code; a code of nobody's is told as it is."""
    return table.get(0, "Unknown") if code is None else table.get(code, f"code {code}")


def level(status):
    """How an OperationalStatus looks at a glance: GOOD, BAD, IDLE (on purpose out of service), or None for anything else."""
    return _LEVELS.get(status)


def status_words(status, state=None):
    """What an element is at: its operational status, and its enabled state where that says more."""
    words = [word(OPERATIONAL_STATUS, status)]
    return words if state in _SAYING_NOTHING else [*words, word(ENABLED_STATE, state)]


def speed(bits_per_second):
    if not bits_per_second:
        return ""
    gigabits = bits_per_second / 1_000_000_000
    return f"{gigabits:g} Gbit/s"


def colons(digits):
    """A world wide name or MAC address as people write it; anything else as it is."""
    if len(digits) not in (12, 16) or digits.strip("0123456789abcdefABCDEF"):
        return digits
    return ":".join(digits[i : i + 2] for i in range(0, len(digits), 2)).lower()


def ranges(numbers):
    """ "0-3, 300" of the numbers in their order, each told once."""
    runs = []
    for number in sorted(set(numbers)):
        if runs and runs[-1][1] == number - 1:
            runs[-1][1] = number
        else:
            runs.append([number, number])
    return ", ".join(str(first) if first == last else f"{first}-{last}" for first, last in runs)


def visible(text):
    """A device's text without anything that a terminal could take for a command: control, format and unassigned characters are escaped."""
    return "".join(c if c == " " or unicodedata.category(c)[0] not in "CZ" else _escaped(c) for c in text)


def _escaped(character):
    code = ord(character)
    return f"\\x{code:02x}" if code < 0x100 else f"\\u{code:04x}" if code < 0x10000 else f"\\U{code:08x}"
