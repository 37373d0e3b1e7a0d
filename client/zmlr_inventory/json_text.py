"""The inventory as JSON; inventory.schema.json describes it."""

import dataclasses
import datetime
import json

from . import model
from .values import ENABLED_STATE, ETHERNET_PORT_TYPE, FC_PORT_TYPE, OPERATIONAL_STATUS, word

FORMAT = 1  # of the document; raised when something goes or changes its meaning, not when something is added

WORDS = {"status": OPERATIONAL_STATUS, "state": ENABLED_STATE}
PORT_TYPES = {model.Port: FC_PORT_TYPE, model.EthernetPort: ETHERNET_PORT_TYPE}


def json_text(inventory, read_at=None):
    """The document; everything beyond ASCII is escaped, so no text in it can steer a terminal."""
    read_at = read_at or datetime.datetime.now(datetime.timezone.utc)
    document = {"format": FORMAT, "read_at": read_at.isoformat(timespec="seconds"), **_plain(inventory)}
    return json.dumps(document, indent=2)


def _plain(value):
    if isinstance(value, list):
        return [_plain(element) for element in value]
    if not dataclasses.is_dataclass(value):
        return value
    members = {}
    for field in dataclasses.fields(value):
        told = getattr(value, field.name)
        table = PORT_TYPES.get(type(value)) if field.name == "port_type" else WORDS.get(field.name)
        members[field.name] = word(table, told) if table else _plain(told)
    return members
