"""Writes the tables of metric families and port states as C++: generate.py FOLDER-OF-TABLES OUTPUT."""

import csv
import sys
from pathlib import Path


def rows_of(path):
    with path.open(encoding="utf-8", newline="") as file:
        return list(csv.DictReader(file, delimiter="\t", quoting=csv.QUOTE_NONE))


def cell(text):
    return "" if text == "-" else text


def literal(text):
    return '"' + text.replace("\\", "\\\\").replace('"', '\\"') + '"'


def texts(words):
    return "{" + ", ".join(map(literal, words)) + "}"


def counted(source):
    """A counter as the names of those that it sums up, and the factor: "A+B" or "A*4"."""
    if not source.startswith("stats: "):
        return "{}"
    names, _, factor = source.removeprefix("stats: ").partition("*")
    return f"{{{texts(names.split('+'))}, {factor or 1}}}"


def family(row):
    labels = [label for label in cell(row["labels"]).split(",") if label]
    parts = [literal(row["family"]), f"Type::{row['type']}", literal(cell(row["unit"])), texts(labels), literal(row["help"])]
    return f"    {{{', '.join(parts)}, {counted(row['fc'])}, {counted(row['fcoe'])}}},"


def state(row):
    """The last state is that of every other number."""
    numbers = [f"HXA_PPORT_ST_{name}" for name in row["driver"].split(",") if name != "*"]
    return f"    {{{literal(row['state'])}, {{{', '.join(numbers)}}}}},"


def main(tables, output):
    lines = [
        "// Generated from the tables of metric families and port states.",
        "#pragma once",
        "",
        '#include "cli/openmetrics_table.h"',
        '#include "hxal/records/port.h"',
        "",
        "namespace hxa::openmetrics",
        "{",
        "",
        "inline constexpr Family families[] = {",
        *map(family, rows_of(tables / "families.tsv")),
        "};",
        "",
        "inline constexpr Port_State port_states[] = {",
        *map(state, rows_of(tables / "port_states.tsv")),
        "};",
        "",
        "} // namespace hxa::openmetrics",
        "",
    ]
    output.parent.mkdir(parents=True, exist_ok=True)
    output.write_text("\n".join(lines), encoding="utf-8")


if __name__ == "__main__":
    main(Path(sys.argv[1]), Path(sys.argv[2]))
