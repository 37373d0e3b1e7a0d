"""What there is to register: the module, its classes and who provides them. Written at build time, read on the host."""

import json
import re
from dataclasses import asdict, dataclass, field

_BLOCK = re.compile(r"^\[.*?^class (\w+).*?^\};\n", re.MULTILINE | re.DOTALL)


@dataclass(frozen=True)
class Served_Class:
    name: str
    needs: list  # the superclass and the classes referred to, which must be there before
    provider: str = ""  # what the names of its factory functions begin with; empty when nobody provides it
    kinds: list = field(default_factory=list)  # of "instance", "association", "indication", "method"
    interop: bool = False  # served in the interop name space too


@dataclass(frozen=True)
class Catalogue:
    module: str  # what the module is called in registrations
    vendor: str
    version: str
    location: str  # the library's name without "lib" and ".so"
    file: str  # the library, relative to the folder of the data
    name_space: str
    classes: list  # a class stands after those that it needs
    inherited: dict = field(default_factory=dict)  # standard superclass -> the names of what the module's classes inherit from it

    @property
    def library(self):
        return f"lib{self.location}.so"


def to_json(catalogue):
    return json.dumps(asdict(catalogue), indent=1) + "\n"


def from_json(text):
    fields = json.loads(text)
    return Catalogue(**{**fields, "classes": [Served_Class(**cls) for cls in fields["classes"]]})


@dataclass(frozen=True)
class Selection:
    """The classes of each name space that the server's schema has everything for, and what the others lack."""

    name_space: str
    interop: str
    served: list
    in_interop: list
    left_out: list  # (name space, class, what it needs and the server lacks)

    def name_spaces(self, cls):
        spaces = ((self.name_space, self.served), (self.interop, self.in_interop))
        return [name_space for name_space, chosen in spaces if cls in chosen]

    @property
    def provided(self):
        """The classes to register, each once."""
        rest = [cls for cls in self.in_interop if cls not in self.served]
        return [cls for cls in self.served + rest if cls.provider]


def select(catalogue, interop, known, known_in_interop):
    """known: the names of the classes that the server has in a name space."""
    left_out = []
    served = _possible(catalogue.classes, known, catalogue.name_space, left_out)
    candidates = [cls for cls in catalogue.classes if cls.interop]
    in_interop = _possible(candidates, known_in_interop, interop, left_out)
    return Selection(catalogue.name_space, interop, served, in_interop, left_out)


def select_all(catalogue, interop):
    """As if the server's schema had everything."""
    everything = {name for cls in catalogue.classes for name in cls.needs}
    return select(catalogue, interop, everything, everything)


def _possible(classes, known, name_space, left_out):
    there = {name.lower() for name in known}
    possible = []
    for cls in classes:
        missing = [name for name in cls.needs if name.lower() not in there]
        if missing:
            left_out.append((name_space, cls, missing))
        else:
            possible.append(cls)
            there.add(cls.name.lower())
    return possible


def mof_blocks(mof):
    """class name -> its declaration, in their order, of a MOF text in which every class begins with qualifiers."""
    return {match[1]: match[0] for match in _BLOCK.finditer(mof)}


def mof_of(mof, classes):
    """The declarations of some classes of a MOF text."""
    blocks = mof_blocks(mof)
    return "\n".join(blocks[cls.name] for cls in classes)
