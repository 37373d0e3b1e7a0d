"""The program zmlr-inventory: reads hosts and shows what they have."""

import re
import sys
from pathlib import Path

from . import credentials, hosts, parallel
from .exits import INTERRUPTED, NO_PYWBEM, NOT_WRITTEN, NOTHING, PARTLY, USAGE, WELL
from .files import write_atomically
from .hosts import UsageError
from .json_text import json_text
from .model import Failure, Inventory
from .openmetrics import write_openmetrics
from .options import parse
from .output import give_up_output, say, style_of
from .topology import svg
from .tree import tree_text

HTTP_CLIENT = re.compile(r"HTTPS?Connection(Pool)?\([^)]*\): ")  # the host stands before the reason already


def main(arguments=None):
    for stream in (sys.stdout, sys.stderr):
        stream.reconfigure(errors="backslashreplace")
    options = parse(arguments)
    try:
        urls = hosts.urls_of(options.host, options.hosts, options.plain_http)
        logins = credentials.Credentials(options.credentials, credentials.ask(options.user) if options.user else None)
    except UsageError as error:
        say(str(error))
        return USAGE
    except KeyboardInterrupt:
        return INTERRUPTED
    try:
        import pywbem  # noqa: F401
    except ImportError:
        venv = Path(__file__).resolve().parent.parent / "venv"
        install = f"python3 -m venv {venv} && {venv}/bin/pip install pywbem"
        say(f"pywbem, the CIM client that this needs, is missing; to have it for this program alone: {install}")
        return NO_PYWBEM
    if options.insecure:
        say("warning: the identity of servers is not checked; whoever sits between can read and change everything, passwords too")

    def connect(url):
        return hosts.connect(url, options, logins)

    try:
        if options.watch:
            from .watch import watch

            return watch(urls, connect, options)
        inventory = read(urls, connect, options.parallel)
        return show(inventory, options)
    except KeyboardInterrupt:
        return INTERRUPTED
    except BrokenPipeError:
        give_up_output()
        return NOT_WRITTEN


def read(urls, connect, at_once):
    """All hosts; what fails is told as it comes."""
    from .reading import read_host

    progress = parallel.Progress(sys.stderr, len(urls))

    def read_one(url):
        def on_class(name, number, count):
            progress.step(hosts.label_of(url), f"reading {name} ({number} of {count} classes)")

        return read_host(connect(url), on_class)

    found, failures = {}, {}
    try:
        for url, host, error in parallel.each(read_one, urls, at_once, progress.show):
            progress.finish(hosts.label_of(url))
            progress.clear()
            if error:
                failures[url] = Failure(url, reason(error))
                say(f"{url}: {failures[url].reason}")
            else:
                found[url] = host
                for text in host.unread:
                    say(f"{url}: {text}")
    finally:
        progress.clear()
    return Inventory([found[url] for url in urls if url in found], [failures[url] for url in urls if url in failures])


def reason(error):
    """Why a host told nothing, in a line."""
    import pywbem

    if isinstance(error, pywbem.AuthError):
        return "the server wants another login; give it with --credentials FILE or --user NAME"
    if isinstance(error, pywbem.CIMError):
        return f"{error.status_code_name}: {error.status_description}"
    text = " ".join(HTTP_CLIENT.sub("", str(error)).split())
    return text if isinstance(error, (pywbem.Error, OSError)) else f"its answer is not understood: {type(error).__name__}: {text}"


def show(inventory, options):
    """Prints or writes what was asked for; the exit code."""
    try:
        if options.openmetrics:
            write_openmetrics(options.openmetrics, inventory)
        if options.svg and inventory.hosts:
            write_atomically(options.svg, svg(inventory))
    except OSError as error:
        say(str(error))
        return NOT_WRITTEN
    if options.json:
        print(json_text(inventory))
    elif inventory.hosts and not options.svg and not options.openmetrics:
        print(tree_text(inventory, style_of(sys.stdout), options.all))
    sys.stdout.flush()
    if not inventory.hosts:
        return NOTHING
    return PARTLY if inventory.failures or any(host.unread for host in inventory.hosts) else WELL
