"""zmlr-register against stand-ins for the servers' programs, which record calls and fail on demand."""

import itertools

import pytest

from conftest import PRODUCT, SERVERS, STANDARD


@pytest.mark.parametrize("server", SERVERS)
def test_installs_once_and_removes_everything(host, server):
    host.has(server)
    empty = host.contents()
    assert host.register("--status").returncode == 7
    assert host.register("--install", "--dry-run").returncode == 0
    assert host.contents() == empty

    installed = host.register("--install")
    assert (installed.returncode, installed.stderr) == (0, "")
    assert (host.folder / "notes").is_dir()  # by that the package's scripts see that something is registered
    once = host.contents()
    assert once["host/providers/libzmlrprovider.so"] == str(host.folder / "libzmlrprovider.so")
    assert host.register("--status").returncode == 0
    assert "adding" not in host.register("--install").stdout
    assert host.contents() == once

    (host.folder / "libzmlrprovider.so").write_text("built anew")
    assert host.register("--status").returncode == 7
    assert "libzmlrprovider.so is another one" in host.register("--install").stdout
    assert any("cimprovider -r" in call or "systemctl restart" in call for call in host.calls())  # by which the old one is let go
    assert host.register("--status").returncode == 0

    assert host.register("--remove").returncode == 0
    assert host.contents() == empty and not (host.folder / "notes").exists()


@pytest.mark.parametrize("server, task, fault, status", [
    *((server, task, "FAIL", 1) for server in SERVERS for task in ("--install", "upgrade", "--remove")),
    ("sfcb", "upgrade", "TERM", 128 + 15)])
def test_what_fails_on_the_way_is_undone(host, server, task, fault, status):
    host.has(server)
    if task != "--install":
        host.register("--install")
    if task == "upgrade":
        host.make_product("2.0.0", PRODUCT.replace("One", "Another"))
    before = host.contents()
    host.copy()
    for number in itertools.count(1):
        result = host.register("--update" if task == "upgrade" else task, fault=fault, at=number)
        if result.returncode == 0 and number > len(host.calls()):
            break
        if result.returncode == 0:  # some answers may fail
            host.copy("host-before notes-before", "host notes")
        assert (result.returncode or status, host.contents()) == (status, before), f"{host.calls()[number - 1]}: {result.stderr}"
    assert host.contents() != before


@pytest.mark.parametrize("server", SERVERS)
def test_a_run_that_was_killed_is_resumed(host, server):
    host.has(server).copy()
    host.register("--install")
    whole, calls = host.contents(), host.calls()
    for number, call in enumerate(calls, 1):
        host.copy("host-before notes-before", "host notes")
        assert host.register("--install", fault="KILL", at=number).returncode == -9
        assert (host.register("--install").returncode, host.contents()) == (0, whole), call


@pytest.mark.parametrize("server", SERVERS)
def test_classes_that_the_schema_lacks_are_told_and_left_out(host, server):
    features = "[Description(\"string Lost;\")] uint16 Held[] = {2, 3}; string Kept; string Lost; uint32 Lose();"
    standard = STANDARD.replace("Profile {", "Profile { " + features)
    host.make_product("1.0.0", standard=standard)
    host.has(server).write_schema(standard.replace("CIM_Port ", "CIM_Harbour ").replace("string Lost; uint32 Lose();", ""))
    result = host.register("--install")
    lacking = "zmlr-register: CIM_RegisteredProfile in {} has no {}: clients do not see that of ZEMLAR_RegisteredProfile"
    told = [lacking.format("root/zemlar", "Lost, Lose"), "zmlr-register: left out: ZEMLAR_Port in root/zemlar: the server has no CIM_Port"]
    if server == "openpegasus":  # its interop name space has a schema of its own
        told.insert(1, lacking.format("root/PG_InterOp", "Held, Kept, Lost, Lose"))
    assert (result.returncode, result.stderr.splitlines()) == (5, told)
    texts = "".join(host.contents().values())
    assert "ZEMLAR_RegisteredProfile" in texts and "ZEMLAR_Port" not in texts


def test_an_administrators_schema_stays(host):
    host.has("openpegasus").make_name_space("root/zemlar")
    before = host.contents()
    assert host.register("--install").returncode == 0
    assert host.register("--remove").returncode == 0
    assert host.contents() == before


def test_several_servers(host):
    assert host.register("--install").returncode == 4
    empty = host.has(*SERVERS).contents()
    assert "choose one with --server" in host.register("--install").stderr
    assert (host.register("--update").stdout, host.contents()) == ("nothing is registered\n", empty)

    assert [host.register("--install", "--server", server).returncode for server in SERVERS] == [0, 0]
    host.places = []  # they are noted
    host.make_product("2.0.0")
    assert host.register("--status").returncode == 7
    assert host.register("--update").returncode == 0
    assert host.register("--status").returncode == 0
    assert not [name for name, text in host.contents().items() if "1.0.0" in text]
    assert (host.register("--remove").returncode, host.contents()) == (0, empty)


def test_what_cannot_be_undone_is_told(host):
    (host.folder / "notes" / "openpegasus.mof").mkdir(parents=True)  # the note of the registration cannot be written
    result = host.has("openpegasus").register("--install")
    assert result.returncode == 3 and "could not undo: " in result.stderr
