"""The class reference, docs/classes.md: `python -m tools.class_reference > docs/classes.md`.

Classes, superclasses, features and value texts are the MOF's (schema/), the order and grouping too. What the properties hold is
taken from the golden inventories: a property that is null in all of them is only named.
"""

import collections
import re
import sys

from tools.inventory_text import NULL, served_classes
from tools.simulated_server import ROOT

sys.path.insert(0, str(ROOT / "schema"))
import mof_model  # noqa: E402  (beside the MOF that it reads)
from mof_model import FLAGS  # noqa: E402

INTRODUCTION = """\
# Class reference

What the module serves in the name space `root/zemlar`: its {count} classes by theme, then the associations between them. A class has
all properties of its superclasses; what is told here of each is

- its **keys** in bold, its type, and an example of what it holds, as the simulated hosts have it; `[]` marks an array. Properties that
  are null on all of them are only named.
- the methods that do something. All other methods answer "not supported".
- where the associations lead from it: the association, and the class at its other end.

Numbers that have words link to [the list of them](#value-texts). `script/golden` rewrites this page from the MOF in `schema/` and the
inventories in `tests/e2e/golden/`.
"""
METHODS = {"SetAlarmState", "InstallFromURI", "RunDiagnostic"}  # those that a provider answers
EXAMPLE = 60  # characters of one


class Inventories:
    """What the golden inventories tell: a value of each property that one has, and the classes that each association joins."""

    def __init__(self, folder):
        self.examples = collections.defaultdict(dict)
        self.ends = collections.defaultdict(lambda: collections.defaultdict(set))
        for scenario in ("mixed", "cna", "fc-hba", "odd"):
            self._read((folder / f"{scenario}.txt").read_text(encoding="utf-8"))

    def _read(self, text):
        for line in text.split("\n"):
            heading = re.match(r"(\w+): ", line)
            value = re.match(r"    (\w+) = (.*)", line)
            if heading:
                name = heading[1]
            elif value and value[2] != NULL:
                self.examples[name].setdefault(value[1], value[2])
            for role, end in re.findall(r"(\w+)=(ZEMLAR_\w+)\(", line):
                self.ends[name][role].add(end)


class Reference:
    def __init__(self, classes, inventories, themes):
        self._classes = {cls.name: cls for cls in classes}
        self._inventories = inventories
        self._themes = themes
        self._words = {}  # of the properties that were shown: declaring class and name, and the feature

    def text(self):
        parts = [INTRODUCTION.format(count=sum(map(len, self._themes.values())))]
        for theme, names in self._themes.items():
            parts.append(f"- [{theme}](#{anchor(theme)}): " + ", ".join(map(link, names)))
        for theme, names in self._themes.items():
            parts.append(f"\n## {theme}")
            for name in names:
                parts += self._class(self._classes[name])
        return "\n".join([*parts, *self._value_texts()]) + "\n"

    def _class(self, cls):
        yield f"\n### {cls.name}\n\n{cls.documentation['Description']}\n"
        yield f"Superclasses: {', '.join(self._ancestors(cls.name))}.\n"
        references = [feature for feature in cls.fields if feature.is_reference]
        if references:
            yield from self._association(cls, references)
        else:
            yield from self._properties(cls)
        for method in cls.methods:
            if method.name in METHODS:
                yield "\nMethod: " + signature(method)
        yield from self._ways(cls)

    def _ancestors(self, name):
        superclass = self._classes[name].superclass
        while superclass:
            yield superclass.name
            superclass = superclass.superclass

    def _association(self, cls, references):
        for reference in references:
            ends = sorted(self._inventories.ends[cls.name][reference.name]) or self._served_below(reference.type)
            yield f"- **{reference.name}**: {', '.join(map(link, ends))}"
        others = [feature.name for feature in cls.fields if not feature.is_reference]
        if others:
            yield f"- properties: {', '.join(others)}"

    def _served_below(self, name):
        """The served classes of a superclass of ours, or the only one of any; else the superclass."""
        served = [own for names in self._themes.values() for own in names if own == name or name in self._ancestors(own)]
        return served if name.startswith("ZEMLAR_") or len(served) == 1 else [name]

    def _properties(self, cls):
        examples = self._inventories.examples[cls.name]
        if not examples:
            yield "No simulated host has one when it starts.\n"
        shown = [feature for feature in cls.fields if not examples or feature.name in examples or feature.is_key]
        yield "| property | type | for example |" if examples else "| property | type |"
        yield "|---|---|---|" if examples else "|---|---|"
        for feature in shown:
            cells = [f"**{feature.name}**" if feature.is_key else feature.name, self._type(feature)]
            if examples:
                cells.append(cell(self._with_word(feature, examples.get(feature.name, ""))))
            yield f"| {' | '.join(cells)} |"
        nulls = [feature.name for feature in cls.fields if feature not in shown]
        if nulls:
            yield f"\nNull: {', '.join(nulls)}."

    def _type(self, feature):
        text = feature.type + ("[]" if feature.array else "")
        if "Values" not in feature.documentation:
            return text
        key = f"{feature.owner}.{feature.name}"
        self._words[key] = feature
        return f"[{text}](#{anchor(key)})"

    def _with_word(self, feature, value):
        """A number and its word, or those of a list."""
        words = dict(words_of(feature))
        return re.sub(r"\w+", lambda number: f"{number[0]} {words[number[0]]}" if number[0] in words else number[0], value)

    def _ways(self, cls):
        """Where associations lead."""
        ways = []
        for association, roles in self._inventories.ends.items():
            for role, ends in roles.items():
                if cls.name in ends:
                    others = sorted(set().union(*(other for name, other in roles.items() if name != role)))
                    ways.append(f"{link(association)} to {', '.join(map(link, others))}")
        if ways:
            yield "\nAssociations: " + "; ".join(ways) + "."

    def _value_texts(self):
        if self._words:
            yield "\n## Value texts"
        for key, feature in sorted(self._words.items()):
            yield f"\n### {key}\n\n" + ", ".join(word if word == value else f"{value} {word}" for value, word in words_of(feature))


def words_of(feature):
    values = feature.documentation.get("Values", [])
    return zip(feature.documentation.get("ValueMap", map(str, range(len(values)))), values)


def link(name):
    return f"[{name.removeprefix('ZEMLAR_')}](#{anchor(name)})" if name.startswith("ZEMLAR_") else name


def anchor(heading):
    return re.sub(r"[^\w -]", "", heading.lower()).replace(" ", "-")


def cell(text):
    text = text if len(text) <= EXAMPLE else text[:EXAMPLE] + "..."
    return f"`{text}`".replace("|", "\\|") if text else ""


def signature(method):
    def parameter(feature):
        way = "out" if feature.flags & FLAGS["Out"] else "in"
        return f"{way} {feature.type}{'[]' if feature.array else ''} {feature.name}"

    *parameters, _ = method.parameters
    return f"`{method.return_type} {method.name}({', '.join(map(parameter, parameters))})`"


def themes_of(mof, served):
    """The headings between the classes of a MOF file, and the served classes below each."""
    themes = {}
    for heading, name in re.findall(r"^// -+\n// (.*)\n// -+$|^class (\w+)", mof, re.MULTILINE):
        if heading:
            names = themes.setdefault(heading, [])
        elif name in served:
            names.append(name)
    return {heading: names for heading, names in themes.items() if names}


def page():
    schema = ROOT / "schema"
    served = set(served_classes()) | {"ZEMLAR_AlertIndication"}
    classes = mof_model.load([schema / name for name in ("qualifiers.mof", "cim.mof", "zemlar.mof")])
    themes = themes_of((schema / "zemlar.mof").read_text(encoding="utf-8"), served)
    return Reference(classes, Inventories(ROOT / "tests/e2e/golden"), themes).text()


if __name__ == "__main__":
    sys.stdout.write(page())
