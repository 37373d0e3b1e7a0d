"""The command line."""

import argparse
import os

from . import __version__

QUERY = "SELECT * FROM ZEMLAR_AlertIndication"


def parse(arguments):
    parser = argparse.ArgumentParser(
        prog="zmlr-inventory",
        description="Shows the Zemlar adapters of hosts, their ports, remote targets and logical units, as the hosts' CIM servers tell them.",
        epilog="Exit status: 0 all well, 1 some hosts or parts failed, 2 wrong usage, 3 no host answered, 4 pywbem is missing, "
        "5 a file could not be written.",
    )
    parser.add_argument("host", nargs="*", metavar="HOST", help="NAME, NAME:PORT or a URL of a CIM server (default: localhost)")
    parser.add_argument("--hosts", metavar="FILE", help="more hosts, one a line")
    parser.add_argument("--version", action="version", version=f"%(prog)s {__version__}")

    shown = parser.add_argument_group("what is shown (default: a tree)")
    shown.add_argument("--all", action="store_true", help="each unit in the tree, also of long rows")
    shown.add_argument("--json", action="store_true", help="the whole inventory as JSON")
    shown.add_argument("--svg", metavar="FILE", help="draw the topology, with Graphviz")
    shown.add_argument("--openmetrics", metavar="FILE", help="write states and counters for a metrics collector")
    shown.add_argument("--watch", action="store_true", help="alerts as they come, until interrupted")

    alerts = parser.add_argument_group("alerts")
    alerts.add_argument("--query", metavar="WQL", default=QUERY, help="which (default: %(default)s)")
    alerts.add_argument(
        "--listen", metavar="ADDRESS", help="of this machine, that servers shall send to (default: that which reaches them)"
    )
    alerts.add_argument(
        "--listen-port", metavar="N", type=_port, default=0, help="of the first host; the next ones take the next ones (default: free ones)"
    )

    asking = parser.add_argument_group("how hosts are asked")
    asking.add_argument("--user", metavar="NAME", help="who asks; the password is asked for")
    asking.add_argument("--credentials", metavar="FILE", help="users and passwords, in the form of netrc; only its owner may read it")
    asking.add_argument(
        "--ca", metavar="FILE", type=_existing, help="the certificates that vouch for servers (default: those that the system trusts)"
    )
    asking.add_argument("--insecure", action="store_true", help="do not check who the servers are")
    asking.add_argument("--plain-http", action="store_true", help="allow unencrypted http to other machines")
    asking.add_argument("--timeout", metavar="SECONDS", type=_positive, default=60, help="that a server may keep silent (default: %(default)s)")
    asking.add_argument("--parallel", metavar="N", type=_positive, default=16, help="hosts that are asked at once (default: %(default)s)")

    options = parser.parse_args(arguments)
    outputs = [name for name in ("json", "svg", "openmetrics", "all") if getattr(options, name)]
    if options.watch and outputs:
        parser.error(f"--watch and --{outputs[0]} exclude each other")
    return options


def _existing(path):
    if not os.path.exists(path):
        raise argparse.ArgumentTypeError(f"{path} is not there")
    return path


def _positive(text):
    return _number(text, 1, 1_000_000)


def _port(text):
    return _number(text, 0, 65535)


def _number(text, least, most):
    number = int(text) if text.isascii() and text.isdecimal() and len(text) < 10 else -1
    if not least <= number <= most:
        raise argparse.ArgumentTypeError(f"{text!r} is no number from {least} to {most}")
    return number
