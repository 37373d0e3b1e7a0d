"""A listener for alerts with a subscription of its own, for the length of a `with` statement."""

import os
import socket
from urllib.parse import urlsplit

import pywbem

from .options import QUERY
from .reading import NAME_SPACE


class Subscription:
    """The server keeps sending until the statement ends, however it ends; then its subscription, filter and destination are gone."""

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
