"""Shows the alerts of a CIM server as they come, until it is interrupted; the subscription goes with it.

    python -m tools.alerts [--url URL] [--user NAME] [--query QUERY] [--listen ADDRESS] [--port N]
"""

import argparse
import getpass
import os
import signal
import socket
import sys
import threading
from urllib.parse import urlsplit

import pywbem

NAME_SPACE = "root/zemlar"
QUERY = "SELECT * FROM ZEMLAR_AlertIndication"
SEVERITIES = {0: "Unknown", 2: "Information", 3: "Warning", 4: "Minor", 5: "Major", 6: "Critical", 7: "Fatal"}


class Subscription:
    """A listener with a subscription of its own; both are there for the length of a `with` statement."""

    def __init__(self, connection, on_alert, query=QUERY, address=None, port=0):
        """`on_alert` is called with each alert, on a thread of the listener's; the server is told to send them to `address`."""
        self._server = pywbem.WBEMServer(connection)
        self._query = query
        address = address or own_address(connection.url)
        self._listener = pywbem.WBEMListener(address, http_port=port or free_port(address))
        self._listener.add_callback(lambda alert, _: on_alert(alert))
        self._manager = pywbem.WBEMSubscriptionManager(f"alerts-{socket.gethostname()}-{os.getpid()}-{id(self)}")
        host = f"[{address}]" if ":" in address else address
        self.url = f"http://{host}:{self._listener.http_port}"

    def __enter__(self):
        self._listener.start()
        try:
            server = self._manager.add_server(self._server)
            destination = self._manager.add_destination(server, self.url, destination_id="listener")
            alert_filter = self._manager.add_filter(server, [NAME_SPACE], self._query, "WQL", filter_id="alerts")
            self._manager.add_subscriptions(server, alert_filter.path, destination.path)
        except BaseException:
            self.__exit__()
            raise
        return self

    def __exit__(self, *_):
        try:
            self._manager.remove_all_servers()
        finally:
            self._listener.stop()


def own_address(url):
    """The address of this machine from which it reaches a server."""
    server = urlsplit(url)
    family, kind, protocol, _, remote = socket.getaddrinfo(server.hostname, server.port or 5988, type=socket.SOCK_DGRAM)[0]
    with socket.socket(family, kind, protocol) as probe:
        probe.connect(remote)  # sends nothing
        return probe.getsockname()[0]


def free_port(address):
    with socket.create_server((address, 0), family=socket.AF_INET6 if ":" in address else socket.AF_INET) as probe:
        return probe.getsockname()[1]


def line_of(alert):
    """What there is of an alert, in one line; the action only where there is something to do."""
    when, severity = alert.get("EventTime"), alert.get("PerceivedSeverity")
    fields = [
        when.datetime.strftime("%Y-%m-%d %H:%M:%S") if when else "",
        "" if severity is None else SEVERITIES.get(severity, str(severity)).ljust(11),
        (alert.get("MessageID") or alert.get("EventID") or "").ljust(10),
        alert.get("Message") or "",
        *(action for action in alert.get("RecommendedActions") or [] if action != "No action required."),
    ]
    return "  ".join(field for field in fields if field.strip())


def main():
    parser = argparse.ArgumentParser(description="Shows the alerts of a CIM server until it is interrupted.")
    parser.add_argument("--url", default="http://localhost:5988", help="of the server (default: %(default)s)")
    parser.add_argument("--user", help="who asks; the password is asked for, or taken from WBEM_PASSWORD")
    parser.add_argument("--ca", help="file with the certificates that vouch for an HTTPS server")
    parser.add_argument("--query", default=QUERY, help="which alerts, in WQL (default: %(default)s)")
    parser.add_argument("--listen", help="address of this machine that the server shall send to")
    parser.add_argument("--port", type=int, default=0, help="to listen on (default: a free one)")
    options = parser.parse_args()

    credentials = None
    if options.user:
        credentials = (options.user, os.environ.get("WBEM_PASSWORD") or getpass.getpass())
    connection = pywbem.WBEMConnection(options.url, credentials, default_namespace=NAME_SPACE, ca_certs=options.ca, timeout=60)
    ended = threading.Event()
    for number in (signal.SIGINT, signal.SIGTERM, signal.SIGHUP):
        signal.signal(number, lambda *_: ended.set())

    def show(alert):
        try:
            print(line_of(alert), flush=True)
        except OSError:  # nobody reads it any more
            ended.set()

    try:
        with Subscription(connection, show, options.query, options.listen, options.port) as subscription:
            print(f"alerts: {options.url} sends them to {subscription.url}; Ctrl-C ends", file=sys.stderr, flush=True)
            ended.wait()
    except (pywbem.Error, OSError) as error:
        print(f"alerts: {options.url}: {error}", file=sys.stderr)
        return 1
    return 0


if __name__ == "__main__":
    sys.exit(main())
