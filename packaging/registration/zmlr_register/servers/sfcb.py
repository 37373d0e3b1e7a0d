"""sfcb: the module's registration and classes are staged; then the server's repository is made anew from all that is staged."""

import pathlib
import re

from ..catalogue import mof_of, select, select_all
from ..features import lacking
from ..heading import heading, tell_another_module
from ..provider_link import link_of
from ..schema_files import declarations, declared_classes, find_schema
from ..steps import Failed, Holder, Refresh, Replace

INTEROP = "root/interop"
_STAGING = "/var/lib/sfcb/stage"
_SETTINGS = ("/etc/sfcb/sfcb.cfg", "/usr/local/etc/sfcb/sfcb.cfg")
_SCHEMA_FOLDERS = ("/usr/share/sfcb/CIM", "/usr/local/share/sfcb/CIM", "/usr/share/mof/cim-current")
_UNITS = ("sfcb", "sblim-sfcb")  # distributions differ

# One group: one process, in which all providers share jobs, records and the event thread; it must not end while a run goes on.
_SECTION = """[{cls}]
   provider: {provider}
   location: {location}
   type: {kinds}
   namespace: {name_spaces}
   group: {location}
   unload: never
"""


def registration_text(catalogue, selection, library=None):
    sections = [_SECTION.format(cls=cls.name, provider=cls.provider, location=catalogue.location, kinds=" ".join(cls.kinds),
                                name_spaces=" ".join(selection.name_spaces(cls))) for cls in selection.provided]
    return f"# {heading(catalogue, library)}#\n" + "#\n".join(sections)


def full_registration(catalogue):
    """With every class, in the name spaces that every sfcb has."""
    return registration_text(catalogue, select_all(catalogue, INTEROP))


class Sfcb:
    name = "sfcb"
    title = "sfcb"
    programs = ("sfcbstage", "sfcbunstage", "sfcbrepos")
    _PENDING = "sfcb-repository-to-be-made"

    def __init__(self, tools, store, catalogue, options):
        self.tools = tools
        self.store = store
        self.catalogue = catalogue
        self._options = options
        self.interop = options.interop or INTEROP
        self.staging = pathlib.Path(options.staging or _STAGING)
        if not self.staging.is_dir():
            raise Failed(f"sfcb's folder {self.staging} is not there: name it with --staging")

    def changes(self, mof, library):
        """(the changes that register, what has to be left out, what it lacks). mof: the declarations of all classes."""
        schema = find_schema(self._options.schema, _SCHEMA_FOLDERS)
        known = declared_classes(schema)
        selection = select(self.catalogue, self.interop, known, known)
        registration = registration_text(self.catalogue, selection, library)
        registered = Staged(self, self.catalogue.name_space).look() or {}
        tell_another_module(self.tools, library, registered.get("zmlr.reg"), registration)
        plan = self._plan(library, str(library), {"zmlr.reg": registration, "zemlar.mof": mof_of(mof, selection.served)},
                          {"zemlar.mof": mof_of(mof, selection.in_interop)} if selection.in_interop else None)
        return plan, selection.left_out, lacking(self.catalogue.name_space, selection.served, self.catalogue, declarations(schema))

    def removal(self, library):
        return self._plan(library, None, None, None)

    def _plan(self, library, link_target, served, in_interop):
        link = link_of(self.tools, library, self._provider_folders())
        staged = [Replace(self.tools, Staged(self, self.catalogue.name_space), served),
                  Replace(self.tools, Staged(self, self.interop), in_interop)]
        return [*([Replace(self.tools, link, link_target)] if link else []),
                Refresh(self._make_repository, staged, undoing=True), *staged,
                Refresh(self._make_repository, staged, undoing=False)]

    def stage(self, program, *words):
        # The mark survives whatever ends this run before the repository is made.
        if self.store.read(self._PENDING) is None:
            self.store.write(self._PENDING, "")
        self.tools.change(program, "-s", self.staging, *words)

    def _make_repository(self, changed):
        if not changed and self.store.read(self._PENDING) is None:
            return
        self.tools.say("repository of sfcb: making it anew")
        self.tools.change("sfcbrepos", "-f", "-s", self.staging)
        self._restart()
        self.store.remove(self._PENDING)

    def _restart(self):
        """A running server reads its repository when it starts."""
        for unit in _UNITS:
            if self._is_running(unit):
                self.tools.change("systemctl", "restart", unit)
                return
        self.tools.say("  sfcb is no running service of systemd: start it again if it runs")

    def _is_running(self, unit):
        try:
            self.tools.ask("systemctl", "is-active", "--quiet", unit)
            return True
        except Failed:
            return False

    def _provider_folders(self):
        if self._options.provider_folder:
            return [self._options.provider_folder]
        for file in map(pathlib.Path, _SETTINGS):
            if file.is_file():
                found = re.findall(r"^\s*providerDirs\s*:(.*)$", file.read_text(encoding="utf-8", errors="replace"), re.MULTILINE)
                return found[-1].split() if found else []
        return []


class Staged(Holder):
    """What is staged of ours for one name space: file name -> text."""

    def __init__(self, server, name_space):
        super().__init__(f"staged for {name_space}")
        self._server = server
        self._name_space = name_space

    def look(self):
        mof = self._server.staging / "mofs" / self._name_space / "zemlar.mof"
        files = [mof]
        if self._name_space == self._server.catalogue.name_space:
            files.append(self._server.staging / "regs" / "zmlr.reg")
        return {file.name: file.read_text(encoding="utf-8") for file in files if file.is_file()} or None

    def put(self, text):
        self._server.tools.with_files(text, lambda folder: self._server.stage("sfcbstage", *self._words(text, folder)))

    def drop(self, text):
        there = self.look()
        if there:
            self._server.stage("sfcbunstage", *self._words(there, pathlib.Path()))

    def _words(self, names, folder):
        registrations = [word for name in names if name.endswith(".reg") for word in ("-r", folder / name)]
        return ["-n", self._name_space, *registrations, *(folder / name for name in names if name.endswith(".mof"))]
