"""A text for administrators: what the served classes take from the CIM schema of a server."""

from mof_model import FLAGS

_HEAD = """What the classes of the module take from the CIM schema of the server
======================================================================

The classes were written against the features of the DMTF schema 2.23 with its experimental classes, and are declared on any
schema from 2.19 on that has the classes below. zmlr-register asks the server before it changes anything: a class whose standard
class is missing is left out and named, the others are registered. Clients do not see a property that the server's standard class
does not have, which is named too; what is marked experimental is missing from the DMTF's final schemas of some versions.

"""
_EXPERIMENTAL = "experimental: "


def schema_report(served):
    """Per standard class that served ones derive from or refer to: which these are, its ancestors, what is experimental."""
    names = {cls.name for cls in served}
    users = {}
    for cls in served:
        for standard in _standard_classes(cls, names):
            users.setdefault(standard, []).append(cls.name)
    ancestors = {cls.superclass.name: cls.superclass for cls in served if cls.superclass.name not in names}
    return _HEAD + "\n".join(_entry(name, users[name], ancestors.get(name)) for name in sorted(users))


def _standard_classes(cls, served_names):
    named = [cls.superclass.name, *(feature.type for feature in cls.fields if feature.is_reference and cls.is_local(feature))]
    return dict.fromkeys(name for name in named if name not in served_names)


def _entry(name, users, cls):
    lines = [name, f"    for {', '.join(users)}"]
    if cls:
        line = _ancestors(cls)
        if line:
            lines.append(f"    below {', '.join(line)}")
        lines += _experimental(cls)
    return "\n".join(lines) + "\n"


def _ancestors(cls):
    return [cls.superclass.name, *_ancestors(cls.superclass)] if cls.superclass else []


def _experimental(cls):
    marked = [f"{feature.owner}.{feature.name}" for feature in cls.features if feature.flags & FLAGS["Experimental"]]
    return [f"    {_EXPERIMENTAL}{', '.join(marked)}"] if marked else []
