"""The CIM schema as the DMTF publishes it: a MOF file that includes one file per class."""

import functools
import pathlib
import re

from .steps import Failed

_NAMES = ("CIM_Schema.mof", "cim_schema_*.mof")
_INCLUDE_OR_CLASS = re.compile(r'^\s*#pragma\s+include\s*\(\s*"([^"]+)"\s*\)|^\s*class\s+(\w+)', re.MULTILINE | re.IGNORECASE)
_COMMENT = re.compile(r"/\*.*?\*/", re.DOTALL)


def find_schema(given, folders):
    """The file given by the administrator, else the first of the folders' schemas."""
    if given:
        if not pathlib.Path(given).is_file():
            raise Failed(f"the schema {given} is not there")
        return pathlib.Path(given)
    for folder in folders:
        for name in _NAMES:
            found = sorted(pathlib.Path(folder).rglob(name))
            if found:
                return found[-1]
    raise Failed(f"found no CIM schema below {' '.join(map(str, folders))}: name its file (CIM_Schema.mof) with --schema")


def declared_classes(file):
    """The names of the classes that a MOF file declares, with what it includes, in their order: superclasses first."""
    return list(_class_files(file))


def declarations(file):
    """A function that finds the text with the declaration of a class in a MOF file and what it includes; empty without one."""
    files = {name.lower(): declaring for name, declaring in _class_files(file).items()}
    return lambda cls: _read(files[cls.lower()]) if cls.lower() in files else ""


@functools.cache
def _class_files(file):
    classes = {}
    _collect(pathlib.Path(file), pathlib.Path(file).parent, classes, set())
    return classes


def _read(file):
    return file.read_text(encoding="utf-8", errors="replace")


def _collect(file, root, classes, seen):
    if file in seen:
        return
    seen.add(file)
    try:
        text = _COMMENT.sub("", _read(file))
    except OSError as error:
        raise Failed(f"the schema is not whole: {error}") from error
    for included, name in _INCLUDE_OR_CLASS.findall(text):
        if name:
            classes.setdefault(name, file)
            continue
        # As compilers look for it: beside the file that includes it, then from where the schema begins.
        path = file.parent / included.replace("\\", "/")
        _collect(path if path.is_file() else root / included.replace("\\", "/"), root, classes, seen)
