"""The prose of header comments as mdoc.

Paragraphs are parted by blank lines. Inside one, lines that are indented by two blanks or more are a block:

    word      what it means, when every line of the block has two columns     (a list)
    anything else, such as a piece of program                                 (as it stands)

A paragraph whose lines begin with "Word. " and go on indented is a list too. `name` is an argument or a field.
"""

import re

_ROW = re.compile(r"( {2,})(\S+(?: \S+)*?) {2,}(\S.*)")
_TAGGED = re.compile(r"([A-Z][a-z-]+)\. +(\S.*)")


def escaped(text):
    """A text that mdoc takes for no macro and no escape."""
    text = text.replace("\\", "\\e").replace("-", "\\-")
    return "\\&" + text if text[:1] in (".", "'") else text


def first_sentence(lines):
    """Without its full stop."""
    text = " ".join(line.strip() for line in lines[:lines.index("")] if line) if "" in lines else " ".join(lines)
    return re.split(r"\.(?: |$)", text)[0]


def tagged(lines):
    """The items of the lists of "Word. text" among the lines."""
    items, word = {}, None
    for line in lines:
        match = _TAGGED.fullmatch(line)
        if match:
            word = match[1]
            items[word] = match[2]
        elif word and line.startswith("    "):
            items[word] += " " + line.strip()
        else:
            word = None
    return items


def without_idle_breaks(lines):
    """Without paragraph breaks before what breaks by itself, and at the end of an item or a section."""
    breaking = re.compile(r"\.(Sh|It|El|Pp|Bd)\b|\.Bl (?!.*-compact)")
    return [line for line, after in zip(lines, [*lines[1:], ".Sh"]) if line != ".Pp" or not breaking.match(after)]


class Prose:
    """Remembers the pages that it refers to."""

    def __init__(self, pages, own_page):
        self._names, self._own_page = pages, own_page
        self.pages = set()

    def paragraphs(self, lines):
        result, paragraph = [], []
        for line in [*lines, ""]:
            if line:
                paragraph.append(line)
            elif paragraph:
                result += [".Pp"] * bool(result) + self._paragraph(paragraph)
                paragraph = []
        return result

    def _paragraph(self, lines):
        items = tagged(lines)
        if items and _TAGGED.fullmatch(lines[0]) and len(items) > 1:
            return [".Bl -tag -width Ds", *(part for word, text in items.items() for part in (f".It {word}", *self._flow(text))), ".El"]
        result, flow = [], []
        while lines:
            if lines[0].startswith("  "):
                result += self._flow(" ".join(flow))
                flow, block = [], []
                while lines and lines[0].startswith("  "):
                    block.append(lines.pop(0))
                result += self._block(block)
            else:
                flow.append(lines.pop(0))
        return result + self._flow(" ".join(flow))

    def _block(self, lines):
        """A table of two columns as a list; anything else as it stands."""
        rows, indent = [], len(lines[0]) - len(lines[0].lstrip())
        for line in lines:
            match = _ROW.fullmatch(line)
            if match and len(match[1]) == indent and "  " not in match[3]:
                rows.append([match[2], match[3]])
            elif rows and len(line) - len(line.lstrip()) > indent + 2:
                rows[-1][1] += " " + line.strip()
            else:
                return [".Bd -literal -offset indent", *(escaped(line[indent:]) for line in lines), ".Ed"]
        parts = [part for tag, text in rows for part in (".It " + self._inline(tag).replace('"', "\\(dq"), *self._flow(text))]
        return [".Bl -tag -width Ds -offset indent -compact", *parts, ".El"]

    def _flow(self, text):
        """A sentence a line, as mdoc wants it."""
        return [self._inline(sentence) for sentence in re.sub(r"([.?!][)\"`]*) (?=[A-Z`\"(])", r"\1\n", text).split("\n") if sentence]

    def _inline(self, text):
        text = escaped(text)
        text = re.sub(r"`([^`]+)`", r"\\fI\1\\fP", text)
        text = re.sub(r"\b(h?w?[a-zA-Z_]\w*)\(\)", r"\\fB\1\\fP()", text)
        text = re.sub(r"\b(HXAL?_[A-Z0-9_.]+[A-Z0-9_])", r"\\fB\1\\fP", text)
        return re.sub(r"\bhxal/(?:config/)?[a-z_]+\.h\b", self._reference, text)

    def _reference(self, match):
        page = self._names.get(match[0])
        if page is None or page == self._own_page:
            return f"<{match[0]}>"
        self.pages.add(page)
        return f"\\fB{page}\\fP(3)"
