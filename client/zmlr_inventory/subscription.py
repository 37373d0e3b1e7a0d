"""A listener for alerts with a subscription of its own, for the length of a `with` statement."""

import contextlib
import logging
import os
import re
import socket
from urllib.parse import urlsplit

import pywbem

from .options import QUERY
from .reading import NAME_SPACE


logging.getLogger("pywbem.listener").addHandler(logging.NullHandler())  # what strangers send it shall not reach the terminal


class Subscription:
    """The server keeps sending until the statement ends, however it ends; then its subscription, filter and destination are gone."""

    def __init__(self, connection, on_alert, query=QUERY, address=None, port=0):
        """`on_alert` is called with each alert, on a thread of the listener's; the server is told to send them to `address`."""
        self._server = pywbem.WBEMServer(connection)
        self._query = query
        address = address or own_address(connection.url)
        self._address = address
        self._listener = pywbem.WBEMListener(address, http_port=free_port(address, port))
        self._listener.add_callback(lambda alert, _: on_alert(alert))
        self._manager = pywbem.WBEMSubscriptionManager(f"alerts-{socket.gethostname()}-{os.getpid()}-{id(self)}")
        host = f"[{address}]" if ":" in address else address
        self.url = f"http://{host}:{self._listener.http_port}"

    def __enter__(self):
        self._listener.start()
        try:
            remove_left_behind(self._server, self._address)
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
            self.stop()

    def stop(self):
        """Listens no more; what the server has is left there for the next one."""
        self._listener.stop()


def own_address(url):
    """The address of this machine from which it reaches a server."""
    server = urlsplit(url)
    family, kind, protocol, _, remote = socket.getaddrinfo(server.hostname, server.port or 5988, type=socket.SOCK_DGRAM)[0]
    with socket.socket(family, kind, protocol) as probe:
        probe.connect(remote)  # sends nothing
        return probe.getsockname()[0]


def remove_left_behind(server, address):
    """Takes away what this program left at a server when it was killed: subscriptions of this machine to whose listener nobody listens."""
    names = re.compile(rf"pywbemdestination:(?:[^:]*:)*(alerts-{re.escape(socket.gethostname())}-[0-9]+-[0-9]+):listener")
    connection, place = server.conn, server.interop_ns
    for destination in connection.EnumerateInstances("CIM_ListenerDestinationCIMXML", place):
        owner = names.fullmatch(destination.get("Name") or "")
        if not owner or not is_dead(destination.get("Destination") or "", address):
            continue
        subscriptions = connection.EnumerateInstanceNames("CIM_IndicationSubscription", place)
        filters = connection.EnumerateInstanceNames("CIM_IndicationFilter", place)
        for path in [
            *(path for path in subscriptions if path["Handler"].get("Name") == destination["Name"]),
            *(path for path in filters if f":{owner[1]}:" in path.get("Name", "")),
            destination.path,
        ]:
            with contextlib.suppress(pywbem.CIMError):  # somebody else is at it, or has to be
                connection.DeleteInstance(path)


def is_dead(url, address):
    """Whether a listener was at this address of this machine, and is no more."""
    try:
        listener = urlsplit(url)
        if listener.hostname != address or not listener.port:
            return False
        socket.create_connection((address, listener.port), timeout=1).close()
    except ConnectionRefusedError:
        return True
    except (OSError, ValueError):
        pass
    return False


def free_port(address, port=0):
    """The port, if nobody has it; else raises OSError. Any free one for 0."""
    with socket.create_server((address, port), family=socket.AF_INET6 if ":" in address else socket.AF_INET) as probe:
        return probe.getsockname()[1]
