"""Which CIM servers are asked, and how they are connected to."""

import ipaddress
import ssl
from pathlib import Path
from urllib.parse import urlsplit

from .values import visible

HTTP_PORT, HTTPS_PORT = 5988, 5989


class UsageError(Exception):
    """Something that the person at the command line has to put right."""


def url_of(text, plain_http=False):
    """The URL of a host: "name", "name:port" or a URL. TLS, unless the host is this machine; unencrypted elsewhere only when allowed."""
    given = text if "://" in text else f"//{text}"
    try:
        parts = urlsplit(given)
        name, port = parts.hostname, parts.port
    except ValueError as error:
        raise UsageError(f"{_without_login(text)!r} is no host: {error}") from None
    if "@" in parts.netloc:
        raise UsageError(f"{_without_login(text)!r}: a user or password does not belong in an address; use --user or --credentials")
    is_name = name and " " not in name and visible(given) == given
    if not is_name or parts.path not in ("", "/") or parts.query or parts.fragment or parts.scheme not in ("", "http", "https"):
        raise UsageError(f"{text!r} is no host: NAME, NAME:PORT, http://NAME:PORT or https://NAME:PORT")
    scheme = parts.scheme or ("http" if is_loopback(name) and port != HTTPS_PORT else "https")
    if scheme == "http" and not is_loopback(name) and not plain_http:
        raise UsageError(f"{text!r}: http sends everything readable, passwords too; use https, or allow it with --plain-http")
    host = f"[{name}]" if ":" in name else name
    return f"{scheme}://{host}:{port or (HTTPS_PORT if scheme == 'https' else HTTP_PORT)}"


def _without_login(text):
    return text.rpartition("@")[2]


def is_loopback(name):
    try:
        return ipaddress.ip_address(name).is_loopback
    except ValueError:
        return name in ("localhost", "ip6-localhost")


def name_of(url):
    return urlsplit(url).hostname


def label_of(url):
    """What is short and still tells a host from the others: the port only where it is not the usual one."""
    return urlsplit(url).netloc.removesuffix(f":{HTTP_PORT}").removesuffix(f":{HTTPS_PORT}")


def urls_of(arguments, hosts_file, plain_http):
    """The URLs of all hosts, each once, in the order in which they were named; this machine when none is."""
    named = list(arguments)
    if hosts_file:
        named += read_hosts(hosts_file)
    if not named and not hosts_file:
        named = ["localhost"]
    urls = list(dict.fromkeys(url_of(text, plain_http) for text in named))
    if not urls:
        raise UsageError(f"{hosts_file} names no host")
    return urls


def read_hosts(path):
    """The hosts of a file: one a line; what follows a "#" is a remark."""
    try:
        lines = Path(path).read_text(encoding="utf-8").splitlines()
    except (OSError, UnicodeError) as error:
        raise UsageError(f"the hosts of {path} cannot be read: {error}") from None
    return [host for line in lines if (host := line.partition("#")[0].strip())]


def connect(url, options, credentials):
    """A connection that has not asked anything yet."""
    import pywbem

    connection = pywbem.WBEMConnection(
        url,
        credentials.of(name_of(url)),
        ca_certs=options.ca or _system_certificates(),
        no_verification=options.insecure,
        timeout=options.timeout,
    )
    connection.session.trust_env = False  # neither a login of ~/.netrc nor a proxy of the environment that nobody named here
    return connection


def _system_certificates():
    """Where the machine keeps the authorities that it trusts; pywbem's own list where there is no such place."""
    paths = ssl.get_default_verify_paths()
    return paths.cafile or paths.capath
