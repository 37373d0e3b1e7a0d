"""Writes the manual page (mdoc) of the simulator's scenarios, from the section "Scenarios" of its README.

usage: scenario_page.py --output FILE README

The date of the page is SOURCE_DATE_EPOCH's, else that of the README.
"""

import argparse
import os
import pathlib
import re
import sys
import time

from comment_text import escaped

HEAD = """\
.Dd {date}
.Dt HXASIM-SCENARIO 5
.Os
.Sh NAME
.Nm hxasim-scenario
.Nd the host that the simulated adapter drivers serve
.Sh DESCRIPTION
A scenario describes the host that
.Pa libhxasim.so
simulates, see
.Xr hxasim 1 .
"""
TAIL = """\
.Sh SEE ALSO
.Xr hxasim 1
"""


def main(arguments):
    parser = argparse.ArgumentParser(usage="scenario_page.py --output FILE README")
    parser.add_argument("--output", type=pathlib.Path, required=True)
    parser.add_argument("readme", type=pathlib.Path)
    options = parser.parse_args(arguments)
    seconds = int(os.environ.get("SOURCE_DATE_EPOCH", options.readme.stat().st_mtime))
    date = time.strftime("%B %-d, %Y", time.gmtime(seconds))
    options.output.write_text(HEAD.format(date=date) + "\n".join(body(options.readme.read_text())) + "\n" + TAIL)


def body(readme):
    section = re.search(r"^### Scenarios\n(.*?)^##", readme, re.MULTILINE | re.DOTALL)[1]
    in_list = False
    for block in section.strip().split("\n\n"):
        if block.startswith("| place"):
            yield from _places(block.split("\n")[2:])
            in_list = True
        elif block.startswith("    "):
            yield from (".Bd -literal -offset indent", *(escaped(line[4:]) for line in block.split("\n")), ".Ed")
        elif "hxasim::" not in block:  # how tests use it
            yield ".Sh EXAMPLES" if in_list else ".Pp"
            in_list = False
            yield from _sentences(block.replace("\n", " "))


def _places(rows):
    """A subsection for each place, in it an item for each key."""
    is_open = False
    for row in rows:
        place, key, kind, default, meaning = (cell.strip() for cell in re.split(r"(?<!\\)\|", row)[1:-1])
        if place:
            yield from [".El"] * is_open + [f".Ss {_inline(place)}", ".Bl -tag -width Ds"]
            is_open = True
        yield f".It {_inline(key)} \\(em {_inline(kind)}"
        if meaning:
            yield from _sentences(meaning[0].upper() + meaning[1:] + ".")
        if default:
            yield "Required." if default == "required" else f"Default: {_inline(default)}."
    yield ".El"


def _sentences(text):
    return [_inline(sentence) for sentence in re.sub(r"([.?!]) (?=[A-Z`])", r"\1\n", text).split("\n") if sentence]


def _inline(text):
    text = escaped(text.replace("\\|", "|")).replace('"', "\\(dq")
    text = re.sub(r"`([^`]+)`", r"\\fB\1\\fP", text)
    return re.sub(r"\*([^*]+)\*", r"\\fI\1\\fP", text)


if __name__ == "__main__":
    sys.exit(main(sys.argv[1:]))
