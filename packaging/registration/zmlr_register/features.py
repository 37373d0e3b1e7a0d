"""What a class of the server's CIM schema has, by its MOF: the names of its properties, references and methods."""

import re

_NO_WORDS = re.compile(r'/\*.*?\*/|//[^\n]*|"(?:[^"\\]|\\.)*"', re.DOTALL)
_QUALIFIERS = re.compile(r"\[[^\]]*\]")
_ARRAY_DEFAULT = re.compile(r"=\s*{[^}]*}")  # ends as a class does
_CLASS = r"\bclass\s+{}\s*(?::\s*(\w+)\s*)?{{(.*?)}}\s*;"
_FEATURE = re.compile(r"\s*\w+\s+(?:ref\s+)?(\w+)", re.IGNORECASE)


def lacking(name_space, classes, catalogue, mof_of):
    """(name space, standard class, what it lacks, the classes below it) for each that has not all that the module's classes inherit.
    mof_of(class): a text with its declaration, empty when there is none; of what cannot be read nothing is said."""
    below = {}
    for cls in classes:
        below.setdefault(cls.needs[0], []).append(cls.name)
    found = []
    for standard, names in below.items():
        there = _features(standard, mof_of)
        missing = [name for name in catalogue.inherited.get(standard, []) if there is not None and name.lower() not in there]
        found += [(name_space, standard, missing, names)] if missing else []
    return found


def _features(cls, mof_of):
    """In lower case, of the class and its ancestors; None when one of them cannot be read."""
    features = set()
    while cls:
        text = _ARRAY_DEFAULT.sub("", _QUALIFIERS.sub("", _NO_WORDS.sub("", mof_of(cls))))
        declared = re.search(_CLASS.format(re.escape(cls)), text, re.DOTALL | re.IGNORECASE)
        if not declared:
            return None
        cls, body = declared.groups()
        features.update(found[1].lower() for found in map(_FEATURE.match, body.split(";")) if found)
    return features
