"""The module in a folder of the server's own: a link, when the server does not look where the module is installed."""

import os
import pathlib

from .steps import Failed, Holder


class Provider_Link(Holder):
    """Holds the path of the module that the link leads to."""

    def __init__(self, tools, path):
        super().__init__(f"link {path}")
        self._tools = tools
        self._path = path

    def look(self):
        if self._path.is_symlink():
            return os.readlink(self._path)
        if self._path.exists():
            raise Failed(f"{self._path} is there and no link: move it away, then run this again")
        return None

    def put(self, text):
        def link():
            if self._path.is_symlink():
                self._path.unlink()
            self._path.symlink_to(text)

        self._tools.change_file(f"link {self._path} to {text}", link)

    def drop(self, text):
        if self._path.is_symlink():
            self._tools.change_file(f"remove {self._path}", self._path.unlink)


def link_of(tools, library, folders):
    """The link that a server needs which looks for modules in these folders; None when it finds the library as it is."""
    folders = [pathlib.Path(folder) for folder in folders]
    if any(folder.exists() and folder.resolve() == library.parent.resolve() for folder in folders):
        return None
    there = [folder for folder in folders if folder.is_dir()]
    if not there:
        raise Failed("the server's provider folder is not there: " + (" ".join(map(str, folders)) or "it names none")
                     + "; name one with --provider-folder")
    cmpi = [folder for folder in there if folder.name == "cmpi"]
    return Provider_Link(tools, (cmpi or there)[0] / library.name)
