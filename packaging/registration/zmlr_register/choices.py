"""The options that a registration was made with: later runs go by them, so that an update or a removal finds what was registered."""

import argparse
import json

from .steps import Holder

_NAMES = ("interop", "schema", "provider_folder", "staging", "module")


class Choices(Holder):
    """Noted from before the first change of an installation until after the last one of a removal."""

    def __init__(self, store, server):
        super().__init__("options of the registration")
        self._store = store
        self._file = f"{server}.json"

    def look(self):
        return self._store.read(self._file)

    def put(self, text):
        self._store.write(self._file, text)

    def drop(self, text):
        self._store.remove(self._file)

    def added_to(self, options):
        """The options of this run; what it does not say is as it was chosen before."""
        before = json.loads(self.look() or "{}")
        said = {name: value for name, value in vars(options).items() if value is not None}
        return argparse.Namespace(**{**dict.fromkeys(_NAMES), **before, **said})

    @staticmethod
    def text_of(options):
        return json.dumps({name: getattr(options, name) for name in _NAMES if getattr(options, name) is not None}) + "\n"
