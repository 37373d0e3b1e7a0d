"""What OpenPegasus holds for the module: its registration, its classes, and the CIM schema below these."""

import pathlib
import re

from ..catalogue import mof_blocks
from ..schema_files import declared_classes
from ..steps import Failed, Holder
from .openpegasus_registration import providers_of


class Module(Holder):
    """The registration of the module."""

    _FILE = "openpegasus.mof"

    def __init__(self, server):
        super().__init__(f"registration of {server.catalogue.module}")
        self._server = server

    def _is_there(self):
        return self._server.catalogue.module in self._server.tools.ask("cimprovider", "-l").split()

    def _missing(self, text):
        """The providers of a registration that the server does not know."""
        known = self._server.tools.ask("cimprovider", "-l", "-m", self._server.catalogue.module).split()
        return [name for name in providers_of(text) if name not in known]

    def look(self):
        if not self._is_there():
            return None
        kept = self._server.store.read(self._FILE) or ""
        return "" if self._missing(kept) else kept

    def put(self, text):
        self._server.load(self._server.interop, self._FILE, text)
        if not self._server.tools.dry_run and self._missing(text):
            raise Failed(f"the server did not take {', '.join(self._missing(text))}")
        self._server.store.write(self._FILE, text)

    def drop(self, text):
        if self._is_there():
            module = self._server.catalogue.module
            try:
                self._server.tools.change("cimprovider", "-d", "-m", module)
            except Failed as error:
                self._server.tools.say(f"  {error}")  # perhaps it is disabled already: removing it decides
            self._server.tools.change("cimprovider", "-r", "-m", module)
        self._server.store.remove(self._FILE)


class Classes(Holder):
    """The module's classes in one name space."""

    def __init__(self, server, name_space):
        super().__init__(f"classes in {name_space}")
        self._server = server
        self._name_space = name_space
        self._file = f"classes-{name_space.replace('/', '-')}.mof"

    def look(self):
        ours = {cls.name for cls in self._server.catalogue.classes}
        there = ours & set(self._server.classes(self._name_space))
        if not there:
            return None
        kept = self._server.store.read(self._file) or ""
        return kept if set(mof_blocks(kept)) == there else ""

    def put(self, text):
        self._server.load(self._name_space, "zemlar.mof", text)
        missing = mof_blocks(text).keys() - set(self._server.classes(self._name_space))
        if missing and not self._server.tools.dry_run:
            raise Failed(f"the server did not take {', '.join(sorted(missing))}")
        self._server.store.write(self._file, text)

    def drop(self, text):
        names = list(mof_blocks(text))
        names += [cls.name for cls in self._server.catalogue.classes if cls.name not in names]
        self._server.delete_classes(self._name_space, names)
        self._server.store.remove(self._file)


class Schema(Holder):
    """The CIM schema in the module's name space. Holds the schema's file and its classes, one a line."""

    _FILE = "schema"
    _NOT_OURS = "an administrator's"

    def __init__(self, server, name_space):
        super().__init__(f"CIM schema in {name_space}")
        self._server = server
        self._name_space = name_space

    @staticmethod
    def text_of(file):
        return "\n".join([str(file), *declared_classes(file)])

    @property
    def is_ours(self):
        return self._server.store.read(self._FILE) is not None

    def look(self):
        there = {name.lower() for name in self._server.classes(self._name_space)}
        kept = self._server.store.read(self._FILE)
        if kept is None:
            return self._NOT_OURS if "cim_managedelement" in there else None
        names = {name.lower() for name in kept.splitlines()[1:]}
        if not names & there:
            return None
        return kept if names <= there else ""

    def put(self, text):
        self._server.store.write(self._FILE, text)  # first: also what was loaded in part is ours
        file = text.splitlines()[0]
        self._server.tools.change("cimmof", "-aE", "-n", self._name_space, "-I", pathlib.Path(file).parent, file)

    def drop(self, text):
        """The name space too, when nothing else is left in it."""
        kept = self._server.store.read(self._FILE) or ""
        self._server.delete_classes(self._name_space, (text or kept).splitlines()[1:])
        path = self._server.path_of(self._name_space)
        if path and not self._server.classes(self._name_space):
            self._drop_qualifiers()
            self._server.tools.change("cimcli", "di", path, "-n", self._server.interop)
        self._server.store.remove(self._FILE)

    def _drop_qualifiers(self):
        declarations = self._server.tools.ask("cimcli", "eq", "-n", self._name_space)
        for name in re.findall(r"^\s*qualifier\s+(\w+)", declarations, re.MULTILINE | re.IGNORECASE):
            self._server.tools.change("cimcli", "dq", name, "-n", self._name_space)
