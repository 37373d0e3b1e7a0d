"""Boot code through InstallFromURI, from files and from a real TFTP server."""

import io
import os
import re
import shutil
import socket
import subprocess
import sys
import tarfile
import time
from concurrent.futures import ThreadPoolExecutor
from pathlib import Path

import pytest
import pywbem
from conftest import wait_until

ADDRESS = f"127.69.{os.getpid() >> 8 & 255}.{os.getpid() & 255}"  # the client knows no other port than 69
SOCKET = f"{int.from_bytes(socket.inet_aton(ADDRESS), sys.byteorder):08X}:0045"
IMAGE = b"\r\n\r\0\n\r" * 2 + bytes(range(256)) * 30  # what a transfer of text could spoil
SCENARIO = {
    "adapters": [{"kind": "fc-hba", "flash": [{"type": "bootovl", "status": state}]} for state in ("empty", "bad")],
    "faults": [{"command": "IOCMD_FLASH_UPDATE_PART", "delay": 300}],
}
SERVICE = "ZEMLAR_HBASoftwareInstallationService"


def archive():
    buffer = io.BytesIO()
    with tarfile.open(fileobj=buffer, mode="w", format=tarfile.USTAR_FORMAT) as tar:
        for name, data in (("boot.txt", b"IMAGE\nTYPE = L\nID = 13, 14, 17, 21\n"), ("overlay.bin", IMAGE)):
            member = tarfile.TarInfo(name)
            member.size = len(data)
            tar.addfile(member, io.BytesIO(data))
    return buffer.getvalue()


class Site:
    """A server in a working directory of its own, and the end of its log."""

    def __init__(self, host, folder, log):
        self.pywbem = host.pywbem
        self.folder = folder
        self._log = log
        self.service = self.pywbem.EnumerateInstanceNames(SERVICE)[0]
        self.good, self.bad = self.pywbem.EnumerateInstanceNames("ZEMLAR_PortController")
        self.nobody = self.good.copy()
        self.nobody["SystemName"] = "elsewhere"
        self.lines()

    def call(self, uri, target, options):
        given = [("URI", "string", uri), ("Target", "reference", target), ("InstallOptions", "uint16", options)]
        parameters = [pywbem.CIMParameter(name, kind, value=value, is_array=isinstance(value, list)) for name, kind, value in given]
        code, out = self.pywbem.copy().InvokeMethod("InstallFromURI", self.service, parameters)
        assert out == {}
        return code

    def install(self, uri, target, options):
        """The return value, and what was logged on the way."""
        return self.call(uri, target, options), self.lines()

    def lines(self):
        """Level and message of the lines that are new, without those of the enumerations."""
        lines = re.findall(r"^\S+ \S+ (\w+): (\w+)\(\d+\): (.*)$", self._log.read(), re.MULTILINE)
        return [(level, text) for level, source, text in lines if "Software" in source]

    def listing(self):
        return {path.name: path.is_dir() or path.read_bytes() for path in self.folder.iterdir()}

    def boot_codes(self):
        return len([name for name in self.pywbem.EnumerateInstanceNames("ZEMLAR_AdapterSoftwareIdentity") if name["InstanceID"].endswith("_bios")])


@pytest.fixture
def site(start, tmp_path, monkeypatch):
    folder = tmp_path / "work"
    folder.mkdir()
    (tmp_path / ".cimplerc").write_text("LOG_LEVEL = INFO\n", encoding="utf-8")
    monkeypatch.chdir(folder)
    host = start(SCENARIO, {"HOME": str(tmp_path)})
    with open(tmp_path / ".cimple/messages", encoding="utf-8") as log:
        yield Site(host, folder, log)


@pytest.fixture
def remote(tmp_path):
    """The folder that a TFTP server serves at ADDRESS."""
    folder = tmp_path / "remote"
    folder.mkdir(mode=0o755)
    command = [shutil.which("in.tftpd", path="/usr/sbin:/usr/local/sbin"), "--foreground", "--secure", "--address", f"{ADDRESS}:69", folder]
    assert os.geteuid() == 0, "TFTP has port 69: run as root"
    with subprocess.Popen(command) as server:
        try:
            wait_until(lambda: SOCKET in Path("/proc/net/udp").read_text(encoding="ascii"))
            yield folder
        finally:
            server.terminate()


def refused(error, *lines):
    errors = [("INFO" if line.startswith("file=") else "ERR", line) for line in lines]
    return 2, [*errors, ("ERR", "InstallFromURI : ERROR - " + error), ("INFO", "return value = 2")]


GOOD, NOBODY = "the first controller", "a controller that is not there"
EMPTY = "empty input parameters"
NO_OPTIONS = refused(EMPTY, "InstallOptions.value.size() is  0")
WRONG_OPTION = refused("invalid option type", "InstallOptions[0] validation failed. throw invalide option type")
MALFORMED = refused("malformed URI", "malformed uri. Throw error")
REFUSALS = [
    (None, None, None, refused(EMPTY, "URI.value is empty")),
    ("", None, [3], refused(EMPTY, "URI.value is empty")),
    ("ftp://x/f", None, None, refused(EMPTY, "Target is empty")),
    ("ftp://x/f", NOBODY, None, NO_OPTIONS),
    ("ftp://x/f", NOBODY, [], NO_OPTIONS),
    ("ftp://x/f", NOBODY, [3, 4], WRONG_OPTION),
    ("ftp://x/f", NOBODY, [6], WRONG_OPTION),
    *((uri, NOBODY, [5, 3], MALFORMED) for uri in ("ftp://x/f", "FILE:///f", "file:/", "f")),
    ("file://", NOBODY, [4], refused("malformed file URI", "file=")),
    ("file://nowhere\nERR: forged\x85", NOBODY, [4], refused("File not exists", "file=nowhere?ERR: forged?", "File doesnt exist")),
    ("file://f", NOBODY, [4], refused("Could not find target controller", "file=f", "Couldnt find the matching port controller.")),
]
SERVER = ADDRESS + "/"
ADDRESSES = ["", ADDRESS, "/f", "h/f", SERVER, "-h/f", "h\x7fh/f", SERVER + "d/f", SERVER + "/f", SERVER + "127.0.0.1:f"]
ADDRESSES += [SERVER + name for name in (".", ".f", "..", "f..", "-f", "f\n", "\u0085f", "f" * 1000, "'" * 300)]
REFUSALS += [("tftp://" + address, GOOD, [4], refused("malformed tftp URI")) for address in ADDRESSES]


def test_refusals_come_in_their_order_and_touch_nothing(site):
    for name in ("f", "-f", "h"):
        (site.folder / name).write_text("mine", encoding="utf-8")
    before = site.listing()
    for uri, target, options, expected in REFUSALS:
        target = {GOOD: site.good, NOBODY: site.nobody}.get(target)
        assert site.install(uri, target, options) == expected, uri
    assert site.listing() == before


def other_targets(good):
    """Target paths and whether they are the controller's."""
    keys = dict(good.keybindings)
    yield pywbem.CIMInstanceName("CIM_PortController", keys, "elsewhere", "root/zemlar"), True
    yield pywbem.CIMInstanceName("ZEMLAR_FCPort", keys), True
    yield pywbem.CIMInstanceName("ZEMLAR_FCPort", {**keys, "DeviceID": keys["DeviceID"].lower()}), False
    yield pywbem.CIMInstanceName("ZEMLAR_ComputerSystem", {"Name": keys["SystemName"], "CreationClassName": "ZEMLAR_ComputerSystem"}), False
    yield pywbem.CIMInstanceName("CIM_ManagedElement", {}), False


@pytest.mark.filterwarnings("ignore::pywbem.MissingKeybindingsWarning")
def test_files_reach_the_flash(site):
    image = site.folder / "boot code\n.tar"
    image.write_bytes(archive())
    (site.folder / "none.tar").write_bytes(IMAGE)
    assert site.boot_codes() == 0
    code, lines = site.install(f"file://{image}", site.good, [4, 99])
    assert code == 0
    path = str(image).replace("\n", "?")
    device = site.good["DeviceID"]
    assert [text for _, text in lines] == [
        *[f"file={path}", f"UpdatePortControllerSoftware portType=4 deviceid={device} file={path}"],
        *[f"calling hxal_boot_fwupdate() file={path}", "return from hxal_boot_fwupdate() - 0", "status=0"],
        *["Software update is success", "return value = 0"],
    ]
    assert site.boot_codes() == 1
    for target, is_controller in other_targets(site.good):
        assert site.install("file://boot code\n.tar", target, [5])[0] == (0 if is_controller else 2), target

    failed = refused("controller update failed", "UpdatePortControllerSoftware method failed")[1]
    for uri, target, status in [(image, site.bad, 1), (image.parent / "none.tar", site.good, 79), (image.parent, site.good, 79)]:
        code, lines = site.install(f"file://{uri}", target, [4])
        assert code == 2 and lines[-4:] == [("INFO", f"status={status}"), *failed]
    assert site.boot_codes() == 1


def test_tftp_fetches_before_it_installs(site, remote):
    name = "it's `touch a` $(touch b); \"touch c\" & *.tar"
    for file, data in {name: archive(), "none.tar": IMAGE, "other": archive()}.items():
        (remote / file).write_bytes(data)
    assert site.install(f"tftp://{ADDRESS}/{name}", site.good, [4])[0] == 0
    assert site.boot_codes() == 1
    assert site.listing() == {}

    failed = refused("tftp command failed")
    (site.folder / "stale").write_bytes(archive())
    (site.folder / "folder").mkdir()
    site.lines()
    assert site.install(f"tftp://{ADDRESS}/stale", site.good, [4]) == failed, "the old copy is none"
    assert site.install(f"tftp://{ADDRESS}/folder", site.good, [4]) == failed
    assert site.install(f"tftp://{ADDRESS}/none.tar", site.good, [4])[0] == 2
    assert site.install(f"tftp://{ADDRESS}/other", site.nobody, [4])[0] == 2
    assert site.listing() == {"folder": True}


def test_installations_run_one_after_the_other(site, remote):
    (remote / "twice.tar").write_bytes(archive())
    with ThreadPoolExecutor() as threads:
        installations = [threads.submit(site.call, f"tftp://{ADDRESS}/twice.tar", site.good, [4]) for _ in range(2)]
    assert [installation.result() for installation in installations] == [0, 0]
    steps = [text.split()[0] for _, text in site.lines() if "hxal_boot_fwupdate" in text]
    assert steps == ["calling", "return"] * 2


def test_a_server_that_is_not_there_holds_nobody_up(site):
    # The client's own time is 25 s; the connection's is 60 s. "00" is 0.0.0.0, this host, in the two letters that a server needs.
    start = time.monotonic()
    assert site.install("tftp://00/no-such-file", site.good, [4]) == refused("tftp command failed")
    assert time.monotonic() - start < 55
