"""What the program says, and to whom."""

import contextlib
import os
import re
import sys

from .tree import Style
from .values import visible

HTTP_CLIENT = re.compile(r"HTTPS?Connection(Pool)?\([^)]*\): ")  # the host stands before the reason already


def prepare_output():
    """Streams that take any text; one that the caller has closed leads nowhere."""
    for name in ("stdout", "stderr"):
        stream = getattr(sys, name) or open(os.devnull, "w", encoding="utf-8")
        stream.reconfigure(errors="backslashreplace")
        setattr(sys, name, stream)


def say(text):
    """A line on standard error, if anybody takes it."""
    with contextlib.suppress(OSError):
        print(f"zmlr-inventory: {visible(text)}", file=sys.stderr, flush=True)


def reason(error):
    """Why a host told nothing, in a line."""
    import pywbem

    if isinstance(error, pywbem.AuthError):
        return "the server wants another login; give it with --credentials FILE or --user NAME"
    if isinstance(error, pywbem.CIMError):
        return f"{error.status_code_name}: {error.status_description}"
    text = " ".join(HTTP_CLIENT.sub("", str(error)).split())
    return text if isinstance(error, (pywbem.Error, OSError)) else f"its answer is not understood: {type(error).__name__}: {text}"


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
