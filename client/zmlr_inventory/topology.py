"""The inventory as a picture: adapters with their ports on the left, remote targets with their units on the right.

Units are drawn as the rows that their numbers make, so a target stays one small table however many it has. A target that several ports,
also of several hosts, see is drawn once; where they see different units, each view has rows of its own. Targets that the same ports see are drawn
together, so the lines are as few as the ports where every port sees every target.
"""

import html
import shutil
import subprocess
import textwrap

from .values import BAD, GOOD, IDLE, colons, level, ranges, speed, status_words, visible

FILLS = {GOOD: "#c9e7cb", BAD: "#f3bdb8", IDLE: "#d9d9d9", None: "#f6e3a9"}
FILL_NAMES = {GOOD: "in service", BAD: "lost or in error", IDLE: "stopped", None: "unknown or other"}
TARGET_COLOURS = ["#1f6fb4", "#c2571a", "#2e8b4f", "#8e4ea8", "#a8324a", "#6b7a1e", "#17848c", "#8a5a2b"]  # of a target and its lines
COLUMNS = [18, 165, 125, 125]  # least widths of a port's cells
FONT = "Helvetica,Arial,sans-serif"
LONGEST_TEXT = 40  # characters of a device's text
NUMBERS_WIDTH = 30  # characters of a line of unit numbers
MOST_NUMBERS = 4  # such lines
MOST_ROWS = 8  # rows of units in one view of a target
TIME_LIMIT = 300  # seconds for Graphviz

HEAD = f"""digraph inventory {{
  graph [rankdir=LR, ranksep=2.2, nodesep=0.25, fontname="{FONT}", fontsize=11, pad=0.3, outputorder=edgesfirst]
  node [shape=plain, fontname="{FONT}", fontsize=11]
  edge [arrowhead=none, penwidth=1.4]
"""


def svg(inventory):
    """The picture as SVG (bytes). Raises OSError when Graphviz is missing or fails."""
    if not shutil.which("dot"):
        raise OSError("Graphviz draws the picture, and its program dot is missing: install the package graphviz")
    try:
        drawn = subprocess.run(["dot", "-Tsvg"], input=dot_text(inventory).encode(), capture_output=True, timeout=TIME_LIMIT, check=False)
    except subprocess.TimeoutExpired:
        raise OSError(f"Graphviz has not drawn the picture within {TIME_LIMIT} s") from None
    if drawn.returncode != 0:
        raise OSError(f"Graphviz cannot draw the picture: {drawn.stderr.decode(errors='replace').strip()}")
    return drawn.stdout


def dot_text(inventory):
    """The picture in Graphviz's language. Node names are numbers of ours; what devices say stands in escaped labels only."""
    lines, seen_by = [HEAD, f"  label=<{_legend()}>"], {}  # targets by WWN: the ports that see them, as (node, level, target)
    for number, host in enumerate(inventory.hosts):
        lines.append(f"  h{number} [label=<{_host(host)}>]")
        for row, adapter in enumerate(host.adapters):
            for index, port in enumerate(adapter.ports):
                for target in port.targets:
                    seen_by.setdefault(target.wwn, []).append((f"h{number}:a{row}p{index}:e", level(port.status), target))
    for number, (ends, views_of) in enumerate(_together(seen_by)):
        lines += _targets(f"t{number}", TARGET_COLOURS[number % len(TARGET_COLOURS)], ends, views_of)
    return "\n".join([*lines, "}", ""])


def _together(seen_by):
    """Targets that the same ports see, each with one view: a line from each port leads to all of them. (ends of the lines, views by WWN)"""
    groups = {}
    for wwn, seers in seen_by.items():
        views = list(dict.fromkeys(_view(target) for _, _, target in seers))
        several = len(views) > 1
        ends = tuple((port, state, f"v{views.index(_view(target))}" if several else None) for port, state, target in seers)
        groups.setdefault((wwn if several else None, ends), {})[wwn] = views
    return [(ends, wwns) for (_, ends), wwns in groups.items()]


def _legend():
    return _table([_row("<td>ports:</td>", *(f'<td bgcolor="{FILLS[key]}">{name}</td>' for key, name in FILL_NAMES.items()))])


def _host(host):
    """A table of tables: Graphviz may not put adapters into another order."""
    adapters = [f"<tr><td>{_adapter(row, adapter)}</td></tr>" for row, adapter in enumerate(host.adapters)]
    title = f'<tr><td><font point-size="16"><b>{_safe(host.name)}</b></font></td></tr>'
    rows = "".join([title, *(adapters or ["<tr><td>no adapters</td></tr>"])])
    return (
        f'<table border="1" style="rounded" cellborder="0" cellspacing="0" cellpadding="5" color="#b0b8c4" bgcolor="#f4f6f9">{rows}</table>'
    )


def _adapter(row, adapter):
    """A table: the adapter, and a row for each port with its two sides."""
    ethernet = {port.number: port for port in adapter.ethernet_ports}
    rows = [_port_row(port, ethernet.pop(port.number, None), f' port="a{row}p{index}"') for index, port in enumerate(adapter.ports)]
    rows += [_row(_number(port), *_cells([], _status(port), _side(port))) for port in ethernet.values()]
    told = [adapter.serial_number] if level(adapter.status) == GOOD else [adapter.serial_number, *_status(adapter)]
    fill = f'bgcolor="{FILLS[level(adapter.status)]}"'
    name = f'<td colspan="2" align="left" {fill}><b>{_safe(f"{adapter.kind} {adapter.model}")}</b></td>'
    return _table([_row(name, f'<td colspan="2" align="left" {fill}>{_safe(", ".join(filter(None, told)))}</td>'), *rows])


def _port_row(port, ethernet, place):
    at = [speed(port.speed)] if level(port.status) == GOOD and port.speed else _status(port)
    return _row(_number(port), *_cells([colons(port.wwn), port.name], at, _side(ethernet) if ethernet else _module(port), place))


def _number(port):
    """The number of a port, in the colour of its state."""
    return f'<td width="{COLUMNS[0]}" bgcolor="{FILLS[level(port.status)]}"><b>{"?" if port.number is None else port.number}</b></td>'


def _cells(name, at, side, place=""):
    """The rest of a port's row; lines start at its last cell."""
    attributes = [f' width="{width}"' for width in COLUMNS[1:]]
    return [_text(name, attributes[0]), _text(at, attributes[1]), _text(side, attributes[2] + place)]


def _side(ethernet):
    return [ethernet.interface, *_module(ethernet)]


def _module(port):
    return [f"{port.module.kind} {port.module.part_number}"] if port.module else []


def _status(port):
    return status_words(port.status, getattr(port, "state", None))


def _targets(node, colour, ends, views_of):
    """A table: the targets, each with rows for the units of its views; and the lines from the ports that have them."""
    rows = []
    for wwn, views in views_of.items():
        rows.append(f'<tr><td colspan="2" align="left" bgcolor="{colour}"><font color="white"><b>{_safe(colons(wwn))}</b></font></td></tr>')
        for number, view in enumerate(views):
            rows += _view_rows(view, f' port="v{number}"' if len(views) > 1 else "")
    lines = [
        f'  {port} -> {node}{":" + view if view else ""}:w [color="{colour}"{"" if state == GOOD else ", style=dashed"}]'
        for port, state, view in ends
    ]
    return [f"  {node} [label=<{_table(rows)}>]", *lines]


def _view(target):
    """What there is to draw of a target's units: runs of one kind, model and state."""
    groups = {}
    for lun in target.luns:
        groups.setdefault((lun.kind, lun.model, lun.status), []).append(lun.number)
    return tuple((*group, tuple(numbers)) for group, numbers in groups.items())


def _view_rows(view, place):
    if not view:
        return [f'<tr><td colspan="2" align="left"{place}>no logical units</td></tr>']
    rows = []
    for kind, model, status, numbers in view[:MOST_ROWS]:
        told = textwrap.wrap(f"LUN {ranges(numbers)}", NUMBERS_WIDTH)
        told = told[:MOST_NUMBERS] + ["..."] * (len(told) > MOST_NUMBERS)
        what = f"{len(numbers)} {kind}s" if len(numbers) > 1 else kind
        if level(status) != GOOD:
            what += ", " + status_words(status)[0]
        rows.append(_row(_text(told, "" if rows else place), _text([what, model])))
    if len(view) > MOST_ROWS:
        rest = sum(len(numbers) for *_, numbers in view[MOST_ROWS:])
        rows.append(f'<tr><td colspan="2" align="left">and {rest} more of other kinds</td></tr>')
    return rows


def _table(rows):
    return f'<table border="0" cellborder="1" cellspacing="0" cellpadding="4" color="#8a94a3" bgcolor="white">{"".join(rows)}</table>'


def _row(*cells):
    return f"<tr>{''.join(cells)}</tr>"


def _text(lines, attributes=""):
    """A cell of lines; empty ones are left out."""
    told = "".join(f'{_safe(line)}<br align="left"/>' for line in lines if line.strip())
    return f'<td align="left" balign="left"{attributes}>{told or " "}</td>'


def _safe(text):
    """A device's text for a label: its beginning, without anything that Graphviz or SVG could take for more than text."""
    cut = text if len(text) <= LONGEST_TEXT else text[: LONGEST_TEXT - 3] + "..."
    return html.escape(visible(cut))
