"""What the program says, and to whom."""

import os
import sys

from .tree import Style
from .values import visible


def say(text):
    """A line on standard error."""
    print(f"zmlr-inventory: {visible(text)}", file=sys.stderr, flush=True)


def style_of(stream):
    """Colours on a terminal whose owner has nothing against them, lines where the character set has them."""
    coloured = stream.isatty() and not os.environ.get("NO_COLOR") and os.environ.get("TERM") != "dumb"
    try:
        "├─└│".encode(stream.encoding)
    except UnicodeEncodeError:
        return Style(coloured, ascii_only=True)
    return Style(coloured)


def give_up_output():
    """Standard output leads nowhere any more: what is still in its buffer shall not fail at the end of the program."""
    os.dup2(os.open(os.devnull, os.O_WRONLY), sys.stdout.fileno())
