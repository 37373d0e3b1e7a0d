"""OpenPegasus: what it takes to know the module, and how its programs are asked and told."""

import functools
import os
import re

from ..catalogue import mof_of, select
from ..features import lacking
from ..heading import tell_another_module
from ..provider_link import link_of
from ..schema_files import declarations, find_schema
from ..steps import Failed, Replace
from .openpegasus_holders import Classes, Module, Schema
from .openpegasus_registration import registration_mof

_INTEROP_NAMES = ("root/PG_InterOp", "root/interop", "interop")  # builds differ
_SCHEMA_FOLDERS = ("/usr/share/Pegasus/mof", "/usr/share/mof/cim-current", "/usr/local/share/Pegasus/mof",
                   "/opt/tog-pegasus/share/mof")


class Open_Pegasus:
    name = "openpegasus"
    title = "OpenPegasus"
    programs = ("cimmof", "cimprovider", "cimcli")

    def __init__(self, tools, store, catalogue, options):
        self.tools = tools
        self.store = store
        self.catalogue = catalogue
        self._options = options
        self.interop = options.interop or self._find_interop()

    def changes(self, mof, library):
        """(the changes that register, what has to be left out, what it lacks). mof: the declarations of all classes."""
        schema, module = Schema(self, self.catalogue.name_space), Module(self)
        schema_text, known = schema.look(), self.classes(self.catalogue.name_space)
        declaration = self._declarations(self.catalogue.name_space)
        if not schema_text:
            schema_file = find_schema(self._options.schema, _SCHEMA_FOLDERS)
            schema_text, declaration = schema.text_of(schema_file), declarations(schema_file)
            known = schema_text.splitlines()[1:]
        selection = select(self.catalogue, self.interop, known, self.classes(self.interop))
        registration, registered = registration_mof(self.catalogue, selection, library), module.look()
        tell_another_module(self.tools, library, registered, registration)

        changes = [
            self._change(self._link(library), str(library)),
            self._change(schema, schema_text),
            self._change(Classes(self, self.catalogue.name_space), mof_of(mof, selection.served) or None),
            self._change(Classes(self, self.interop), mof_of(mof, selection.in_interop) or None),
        ]
        # Classes are not replaced under a module that serves them.
        removal = self._change(module, None) if registered not in (None, registration) else None
        changes = [removal, *changes, Replace(self.tools, module, registration, removal)]
        lacks = [*lacking(self.catalogue.name_space, selection.served, self.catalogue, declaration),
                 *lacking(self.interop, selection.in_interop, self.catalogue, self._declarations(self.interop))]
        return [change for change in changes if change], selection.left_out, lacks

    def removal(self, library):
        schema = Schema(self, self.catalogue.name_space)
        changes = [
            self._change(Module(self), None),
            self._change(Classes(self, self.interop), None),
            self._change(Classes(self, self.catalogue.name_space), None),
            self._change(schema if schema.is_ours else None, None),
            self._change(self._link(library), None),
        ]
        return [change for change in changes if change]

    def _change(self, holder, wanted):
        return Replace(self.tools, holder, wanted) if holder else None

    def classes(self, name_space):
        """The names of the classes of a name space; none when there is no such name space."""
        try:
            return self.tools.ask("cimcli", "nc", "-di", "-n", name_space).split()
        except Failed:
            if self.path_of(name_space):
                raise
            return []

    def _declarations(self, name_space):
        """A function that finds the declaration of a class in a name space; empty when the server does not tell it."""
        @functools.cache
        def declaration(cls):
            try:
                return self.tools.ask("cimcli", "gc", cls, "-n", name_space)
            except Failed:
                return ""

        return declaration

    def path_of(self, name_space):
        """The object path of the name space in the interop name space; empty when there is none."""
        named = re.compile(rf'\bName="{re.escape(name_space)}"', re.IGNORECASE)
        return next((path for path in self._name_spaces(self.interop) if named.search(path)), "")

    def load(self, name_space, file_name, text):
        self.tools.with_files({file_name: text}, lambda folder: self.tools.change("cimmof", "-n", name_space, folder / file_name))

    def delete_classes(self, name_space, names):
        """Those of them that are there, the last one first."""
        there = {name.lower() for name in self.classes(name_space)}
        for name in reversed(names):
            if name.lower() in there:
                self.tools.change("cimcli", "dc", name, "-n", name_space)

    def _name_spaces(self, interop):
        return self.tools.ask("cimcli", "ni", "CIM_Namespace", "-n", interop).splitlines()

    def _find_interop(self):
        reasons = []
        for name in _INTEROP_NAMES:
            try:
                self._name_spaces(name)
                return name
            except Failed as error:
                reasons.append(str(error))
        raise Failed(f"OpenPegasus does not answer; does cimserver run? {reasons[0]}")

    def _link(self, library):
        return link_of(self.tools, library, self._provider_folders())

    def _provider_folders(self):
        if self._options.provider_folder:
            return [self._options.provider_folder]
        folders = self._setting("providerDir").split(":")
        home = "" if all(map(os.path.isabs, folders)) else self._setting("home")
        return [os.path.join(home, folder) for folder in folders if folder]

    def _setting(self, name):
        """An option of the running server. The program answers "Current value: ..."."""
        return self.tools.ask("cimconfig", "-g", name, "-c").partition(":")[2].strip()
