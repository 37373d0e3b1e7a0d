"""The program zmlr-inventory: reads hosts and shows what they have."""

import sys
import time
import warnings
from pathlib import Path

from . import credentials, hosts, parallel
from .exits import INTERRUPTED, NO_PYWBEM, NOT_WRITTEN, NOTHING, PARTLY, USAGE, WELL
from .files import write_atomically
from .hosts import UsageError
from .json_text import json_text
from .model import Failure, Inventory
from .openmetrics import write_openmetrics
from .options import parse
from .output import give_up_output, prepare_output, reason, say, style_of
from .topology import svg
from .tree import tree_text

WHOLE_ANSWER = 3  # how many times the limit of a silence it may take, its reading included


def main(arguments=None):
    if not sys.warnoptions:
        warnings.simplefilter("ignore")  # they are for developers
    try:
        prepare_output()
        return run(parse(arguments))
    except KeyboardInterrupt:
        return INTERRUPTED
    except OSError as error:
        give_up_output()
        if not isinstance(error, BrokenPipeError):
            say(f"the output is lost: {error.strerror}")
        return NOT_WRITTEN


def run(options):
    try:
        urls = hosts.urls_of(options.host, options.hosts, options.plain_http)
        logins = credentials.Credentials(options.credentials, credentials.ask(options.user) if options.user else None)
    except UsageError as error:
        say(str(error))
        return USAGE
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

    if options.watch:
        from .watch import watch

        return watch(urls, connect, options)
    return show(read(urls, connect, options), options)


def read(urls, connect, options):
    """All hosts; what fails is told as it comes."""
    from .reading import read_host

    progress = parallel.Progress(sys.stderr, len(urls))
    asked = {}  # when the answer that a host owes was asked for

    def read_one(url):
        def on_class(name, number, count):
            asked[url] = time.monotonic()
            progress.step(hosts.label_of(url), f"reading {name} ({number} of {count} classes)")

        return read_host(connect(url), on_class)

    def is_late(url):
        """The connection limits the silence between two pieces of an answer, and a server may send one byte at a time."""
        return url in asked and time.monotonic() > asked[url] + WHOLE_ANSWER * options.timeout

    found, failures = {}, {}
    try:
        for url, host, error in parallel.each(read_one, urls, options.parallel, progress.show, is_late):
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
