"""Writes the manual pages (mdoc, section 3) of the access library's public headers, from the headers' own text.

usage: header_pages.py --output DIRECTORY [--version TEXT] FOLDER

FOLDER is the access library's: hxal.h there says which headers are public, by including them. hxal/port.h becomes
hxal_port.3, hxal/config/model.h hxal_config_model.3, hxal.h itself hxal.3. A header is read as this house writes it:

    // purpose, in paragraphs, before #pragma once
    // what the declarations below it do, then the declarations, a blank line    (a group)
    declaration; // what this one does

The date of a page is SOURCE_DATE_EPOCH's, else that of its header.
"""

import argparse
import os
import pathlib
import re
import sys
import time

import comment_text

SEE_INSIDE = "hxal.h"


class Header_Error(Exception):
    """A header that is not written in the form that this program reads."""


def main(arguments):
    parser = argparse.ArgumentParser(usage="header_pages.py --output DIRECTORY [--version TEXT] FOLDER")
    parser.add_argument("--output", type=pathlib.Path, required=True)
    parser.add_argument("--version", default="")
    parser.add_argument("folder", type=pathlib.Path)
    options = parser.parse_args(arguments)
    try:
        pages = write_pages(options.folder, options.version)
    except (Header_Error, OSError) as error:
        print(f"header_pages.py: {error}", file=sys.stderr)
        return 1
    options.output.mkdir(parents=True, exist_ok=True)
    for name, text in pages.items():
        (options.output / f"{name}.3").write_text(text)
    return 0


def write_pages(folder, version=""):
    """The pages by their names."""
    manual = Header(folder, SEE_INSIDE)
    headers = [manual] + [Header(folder, include.removeprefix("hxal/")) for include in manual.includes]
    statuses = Statuses(folder)
    return {header.page: Page(header, headers, statuses, version).text() for header in headers}


# ----------------------------------------------------------------------
# Reading
# ----------------------------------------------------------------------


class Statuses:
    """The message of every status, as hxal_status_to_string() has them."""

    def __init__(self, folder):
        table = (folder / "status_messages.cpp").read_text()
        self.texts = {name: text.strip() for name, text in re.findall(r'\{(HXA_STATUS_\w+), +"([^"]*)"\}', table)}


class Group:
    """Declarations that one comment tells of; or a comment by itself."""

    def __init__(self, comment, code):
        self.comment = comment  # lines
        self.declarations = [declaration for declaration in _declarations(code) if not declaration.text.startswith("static_assert")]
        self.functions = [declaration for declaration in self.declarations if declaration.function]
        silent = [declaration.function for declaration in self.functions if not comment and not declaration.remark]
        if silent:
            raise Header_Error(f"nothing is said about {', '.join(silent)}")


class Declaration:
    def __init__(self, source, remark):
        self.source = source  # lines, as they stand in the header
        self.text = " ".join(line.split("//")[0].strip() for line in source).strip()
        self.remark = remark
        match = re.fullmatch(r"((?:const )?\w+ ?\**) *(\w+)\((.*)\);", self.text)
        self.function = None if match is None or self.text.startswith("typedef") else match[2]
        if self.function:
            self.type = match[1].replace("*", " *").replace("  ", " ").strip()
            self.arguments = [] if match[3] == "void" else [_pointer(argument) for argument in match[3].split(", ")]

    @property
    def asks_a_driver(self):
        """A request names what it is about, and answers a status."""
        return self.type == "hxa_status_t" and bool(re.match(r"(const )?hxal_(adapter_)?t |int ad$", " ".join(self.arguments[:1])))


def _pointer(argument):
    """The star beside the name, as manual pages have it."""
    return re.sub(r"(\*+) (\w+)$", r" \1\2", argument).replace("  ", " ")


def _declarations(code):
    """The declarations in the lines of a group, with their trailing comments."""
    result, source, remark, depth = [], [], [], 0
    for line in code:
        statement, _, comment = line.partition("//")
        source.append(line)
        depth += statement.count("{") - statement.count("}")
        if comment and depth == 0:
            remark.append(comment.strip())
        if line.startswith("#") or (depth == 0 and statement.rstrip().endswith(";")):
            result.append(Declaration(source, " ".join(remark)))
            source, remark = [], []
    if source:
        raise Header_Error(f"no end of the declaration that begins with: {source[0]}")
    return result


class Header:
    def __init__(self, folder, name):
        self.name = f"hxal/{name}"
        self.page = "hxal" if name == SEE_INSIDE else "hxal_" + name.removesuffix(".h").replace("/", "_")
        file = folder / name
        self.date = int(os.environ.get("SOURCE_DATE_EPOCH", file.stat().st_mtime))
        before, mark, after = file.read_text().partition("#pragma once\n")
        if not mark or not before.startswith("// "):
            raise Header_Error(f"{file}: a purpose and #pragma once are expected before everything else")
        self.purpose = [_uncommented(line) for line in before.rstrip().split("\n")]
        includes = re.findall(r'^#include "(.*)"$', after, re.MULTILINE)
        self.includes = [include for include in includes if "/records/" not in include]
        self.records = [include for include in includes if "/records/" in include]
        self.record_purposes = {record: _first_sentence(folder / record.removeprefix("hxal/")) for record in self.records}
        try:
            self.groups = [_group(block) for block in _blocks(after)]
        except Header_Error as error:
            raise Header_Error(f"{file}: {error}") from error

    @property
    def functions(self):
        return [function for group in self.groups for function in group.functions]


def _first_sentence(file):
    lines = file.read_text().split("\n#pragma once")[0].split("\n")
    return comment_text.first_sentence([_uncommented(line) for line in lines if line.startswith("//")])


def _uncommented(line):
    return line.strip().removeprefix("//").removeprefix(" ").rstrip()


def _blocks(text):
    """What blank lines part, without the frame of the header and its includes; braces hold a block together."""
    frame = re.compile(r"#include .*|#ifdef __cplusplus|#endif|extern \"C\"|\{|\}")
    block, depth = [], 0
    for line in [*text.split("\n"), ""]:
        statement = line.split("//")[0]
        if depth == 0 and (not line.strip() or frame.fullmatch(line)):
            if block:
                yield block
            block = []
            continue
        depth += statement.count("{") - statement.count("}")
        block.append(line.removeprefix("    "))


def _group(block):
    comment = []
    while block and block[0].startswith("//"):
        comment.append(_uncommented(block.pop(0)))
    return Group(comment, block)


# ----------------------------------------------------------------------
# Writing
# ----------------------------------------------------------------------


class Page:
    def __init__(self, header, headers, statuses, version):
        self.header, self.headers, self.statuses, self.version = header, headers, statuses, version
        self.prose = comment_text.Prose({other.name: other.page for other in headers}, own_page=header.page)
        self.lines = []

    def text(self):
        date = time.strftime("%B %-d, %Y", time.gmtime(self.header.date))
        self._add(f".Dd {date}", f".Dt {self.header.page.upper()} 3", f".Os hxal {self.version}".rstrip())
        self._name()
        self._add(".Sh LIBRARY", "Adapter access library (libhxal, \\-lhxal)")
        self._synopsis()
        self._description()
        self._return_values()
        self._files()
        self._errors()
        self._see_also()
        return "\n".join(comment_text.without_idle_breaks(self.lines)) + "\n"

    def _add(self, *lines):
        self.lines += [line for line in lines if line]

    def _name(self):
        names = [self.header.page, *(declaration.function for declaration in self.header.functions)]
        self._add(".Sh NAME", *(f".Nm {name} ," for name in names[:-1]), f".Nm {names[-1]}")
        sentence = comment_text.first_sentence(self.header.purpose)
        self._add(".Nd " + comment_text.escaped(sentence[0].lower() + sentence[1:] if sentence[1].islower() else sentence))

    def _synopsis(self):
        self._add(".Sh SYNOPSIS", f".In {self.header.name}")
        for declaration in self.header.functions:
            self._add(f".Ft {declaration.type}", f".Fo {declaration.function}",
                      *(f'.Fa "{argument}"' for argument in declaration.arguments or ["void"]), ".Fc")

    def _description(self):
        self._add(".Sh DESCRIPTION", *self.prose.paragraphs(self.header.purpose))
        for group in self.header.groups:
            self._group(group)

    def _group(self, group):
        text = self.prose.paragraphs(group.comment)
        others = [declaration for declaration in group.declarations if not declaration.function]
        if not group.functions:
            self._add(".Pp", *text)
            self._literal(others)
        elif any(declaration.remark for declaration in group.functions):
            self._add(".Pp", *text)
            self._items(group.functions)
            self._literal(others)
        else:
            self._add(".Pp", ".Bl -tag -width Ds -compact", *map(_item, group.functions), *text)
            self._literal(others)
            self._add(".El")

    def _items(self, functions):
        self._add(".Pp", ".Bl -tag -width Ds -compact")
        for declaration in functions:
            self._add(_item(declaration), *self.prose.paragraphs([declaration.remark] if declaration.remark else []))
        self._add(".El")

    def _literal(self, declarations):
        if declarations:
            source = [comment_text.escaped(line) for declaration in declarations for line in declaration.source]
            self._add(".Bd -literal -offset indent", *source, ".Ed")

    def _return_values(self):
        """What every status means is told once, in the manual of the whole library."""
        if self.header.page == "hxal" or not any(function.asks_a_driver for function in self.header.functions):
            return
        statuses = comment_text.tagged(self.headers[0].purpose)["Statuses"]
        self._add(".Sh RETURN VALUES", "Of functions that return", ".Vt hxa_status_t :", *self.prose.paragraphs([statuses]))

    def _errors(self):
        """The statuses that the page speaks of, with their messages."""
        told = "\n".join([*self.header.purpose, *(line for group in self.header.groups for line in group.comment),
                          *(function.remark for function in self.header.functions)])
        names = sorted(set(re.findall(r"HXA_STATUS_\w+", told)) & set(self.statuses.texts) - {"HXA_STATUS_OK"})
        if not names:
            return
        library = ".Fn hxal_status_to_string" if self.header.page == "hxal_library" else ".Xr hxal_library 3"
        self._add(".Sh ERRORS", "The statuses that are told of above, as", library, "puts them into words:",
                  ".Pp", ".Bl -tag -width Ds -compact")
        for name in names:
            self._add(f".It Dv {name}", comment_text.escaped(self.statuses.texts[name]))
        self._add(".El")

    def _files(self):
        if self.header.records:
            self._add(".Sh FILES", ".Bl -tag -width Ds -compact")
            for record, purpose in self.header.record_purposes.items():
                self._add(f".It In {record}", comment_text.escaped(purpose + "."))
            self._add(".El")

    def _see_also(self):
        by_name = {header.name: header.page for header in self.headers}
        pages = {by_name[include] for include in self.header.includes} | self.prose.pages
        pages = sorted((pages | {"hxal"}) - {self.header.page})
        self._add(".Sh SEE ALSO", *(f".Xr {page} 3 ," for page in pages[:-1]), f".Xr {pages[-1]} 3")


def _item(declaration):
    arguments = " ".join(re.search(r"\w+$", argument)[0] for argument in declaration.arguments)
    return f".It Fn {declaration.function} {arguments}".rstrip()


if __name__ == "__main__":
    sys.exit(main(sys.argv[1:]))
