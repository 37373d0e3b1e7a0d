"""hxa on simulated hosts: what it prints, what it asks, what it exits with."""

import json
import os
import pty
import re
import shlex
import signal
import subprocess
import time
from pathlib import Path

import pytest

ROOT = Path(__file__).resolve().parents[2]
GOLDEN = Path(__file__).parent / "golden"
BUILD = Path(os.environ.get("ZMLR_BUILD_DIR", ROOT / "build/dev"))
IS_SANITIZED = "ZMLR_SANITIZE:STRING=\n" not in (BUILD / "CMakeCache.txt").read_text(encoding="utf-8")
TIMEOUT = 60  # seconds until something that must happen has failed to


def environment(scenario, **more):
    simulated = {} if IS_SANITIZED else {"LD_PRELOAD": str(BUILD / "sim/libhxasim.so")}
    path = f"{BUILD / 'cli'}:{os.environ['PATH']}"
    return os.environ | simulated | {"HXASIM_SCENARIO": str(scenario), "HXASIM_TIME_SCALE": "0", "PATH": path} | more


def hxa(scenario, *words):
    command = [BUILD / "cli/hxa", *words]
    return subprocess.run(command, cwd=ROOT, env=environment(scenario), stdin=subprocess.DEVNULL, capture_output=True, text=True, timeout=TIMEOUT)


def host(tmp_path, *faults, scenario="mixed"):
    """A scenario file: the shipped one with faults."""
    path = tmp_path / "host.json"
    shipped = json.loads((ROOT / f"sim/scenarios/{scenario}.json").read_text(encoding="utf-8"))
    path.write_text(json.dumps(shipped | {"faults": list(faults)}), encoding="utf-8")
    return path


@pytest.mark.parametrize("golden", sorted(GOLDEN.glob("*.txt")), ids=lambda path: path.stem)
def test_answers_are_those_of_the_golden_text(golden):
    """Each line "$ hxa ..." of the text, with all that comes up to the next one."""
    told = golden.read_text(encoding="utf-8")
    now = ""
    for words in re.findall(r"^\$ hxa (.*)$", told, re.MULTILINE):
        ran = hxa(golden.stem, *shlex.split(words))
        now += f"$ hxa {words}\n{ran.stdout}{ran.stderr}exit {ran.returncode}\n\n"
    if os.environ.get("ZMLR_REWRITE_GOLDEN"):
        golden.write_text(now, encoding="utf-8")
        return
    assert now == told
    assert not re.search(r"[\x00-\x09\x0b-\x1f\x7f-\x9f\u200b-\u200f\u202a-\u202e\u2066-\u2069\ufeff]", now)


@pytest.mark.parametrize(
    ("scenario", "words", "code", "error"),
    [
        ("no-driver", "list", 3, "not installed or loaded (133)"),
        ("version-refused", "stats", 3, "version mismatch (70)"),
        ("mixed", "", 2, "subcommand"),
        ("mixed", "lists", 2, "not expected: lists"),
        ("odd", "--yes adapter disable ''", 2, "empty"),
        ("odd", "--yes adapter disable SAME-SERIAL1", 4, "1 as well as 2"),
        ("mixed", "port name 1/0 'bell \a'", 2, "is no name"),
        ("mixed", "port speed 1/0 3", 2, '"3" is no speed'),
        ("mixed", "port speed 1/0", 2, "value is required"),
        ("mixed", "stats --watch 1e300", 2, "no number of seconds"),
        ("mixed", "diag ping 1/0 --pattern xyz", 2, "hexadecimal"),
        ("mixed", "diag loopback 1/0 --ethernet", 2, "external and cable"),
        ("mixed", "stats --count 2", 2, "--watch"),
        ("mixed", "config set 1/0 qdepth many --file /dev/null", 2, "up to 65535"),
        ("mixed", "config set 1/0 qos maybe --file /dev/null", 2, "TRUE or FALSE"),
        ("mixed", "port show 1/2", 4, 'no adapter or port "1/2"'),
        ("mixed", "flash erase 1 nothing", 4, "no partition"),
        ("mixed", "diag loopback 2/1 --ethernet", 4, "no Ethernet function"),
        ("mixed", "--yes flash update 1 /dev/null", 1, "Not a valid Zemlar Boot Code file (79)"),
        ("mixed", "adapter enable 1", 1, "already enabled (67)"),
        ("mixed", "port sfp 1/1", 1, "No SFP device"),
        ("mixed", "port disable 1/0", 5, "for storage and for the network"),
        ("mixed", "flash write 1 fw /dev/null", 5, "partition fw/0 of adapter 1"),
        ("mixed", "flash read 1 fw /dev/null", 5, "/dev/null is replaced"),
        ("mixed", "diag memory 1", 5, "lose their links"),
        ("mixed", "stats --reset", 5, "8 ports"),
    ],
)
def test_what_cannot_be_done_is_told_with_its_exit_code(scenario, words, code, error):
    ran = hxa(scenario, *shlex.split(words))
    assert (ran.returncode, error in ran.stderr) == (code, True), ran.stderr
    if words != "port sfp 1/1":
        assert ran.stdout == ""


@pytest.mark.parametrize("answer", ["y", "n"])
def test_a_person_is_asked_and_the_answer_counts(tmp_path, answer):
    file = tmp_path / "hxa.conf"
    here, there = pty.openpty()
    command = [BUILD / "cli/hxa", "port", "disable", "100000051e100000", "--keep", "--file", file]
    program = subprocess.Popen(command, env=environment("mixed"), stdin=there, stderr=there, stdout=subprocess.PIPE)
    os.close(there)
    asked = b""
    while b"[y/N]" not in asked:
        asked += os.read(here, 1000)
    os.write(here, answer.encode() + b"\n")
    out, _ = program.communicate(timeout=TIMEOUT)
    os.close(here)
    assert b"Port 1/0 goes out of service" in asked
    assert (program.returncode, out, file.exists()) == ((0, b"port 1/0: disable: done\n", True) if answer == "y" else (5, b"", False))
    assert answer == "n" or 'hxa0-port-enable = "FALSE"' in file.read_text(encoding="utf-8")


def test_settings_are_kept_beside_those_of_the_file(tmp_path):
    file = tmp_path / "hxa.conf"
    file.write_text('hxa2-port-wwn = "10:00:00:05:1e:10:01:00";\nhxa2-pathtov = 7;\n', encoding="utf-8")
    for words in ("port speed 2/0 4 --keep", "config set 2/0 qdepth 12", "adapter name 2 blue --keep", "config set 2/0 vf-list 2,5"):
        assert hxa("mixed", "--yes", *words.split(), "--file", file).returncode == 0
    shown = json.loads(hxa("mixed", "--json", "config", "--file", file).stdout)["settings"]
    values = {(row["element"], row["setting"]): row["value"] for row in shown}
    assert values == {("port 2/0", "port-speed"): 4, ("port 2/0", "pathtov"): 7, ("port 2/0", "qdepth"): 12,
                      ("adapter 2", "name"): "blue", ("port 2/0", "vf-list"): [2, 5]}  # fmt: skip


@pytest.mark.parametrize("words", ["list", "adapter", "port", "port sfp", "stats", "stats 1 --watch 0.01 --count 1", "targets", "flash",
                                   "diag ping 1/0", "port speed 1/0 4", "config --file /dev/null"])  # fmt: skip
@pytest.mark.parametrize("scenario", ["mixed", "odd"])
def test_json_is_clean(scenario, words):
    ran = hxa(scenario, "--json", *words.split())
    assert isinstance(json.loads(ran.stdout), dict)


def test_what_fails_costs_its_own_part_and_the_library_speaks_on_standard_error(tmp_path):
    scenario = host(tmp_path, {"command": "IOCMD_ETHPORT_GET_STATS", "error": "EIO"})
    ran = hxa(scenario, "--json", "stats", "1/0")
    blocks = {block["block"]: block["counters"] for block in json.loads(ran.stdout)["ports"][0]["blocks"]}
    assert ran.returncode == 1 and "IOCTL ERR" in ran.stderr and "Ethernet function counters of port 1/0: I/O error (42)" in ran.stderr
    assert "Ethernet function" not in blocks
    assert {"name": "Tx bytes", "value": 98304000} in blocks["Ethernet port"]


def test_a_driver_that_refuses_costs_its_part_of_the_host(tmp_path):
    path = host(tmp_path)
    path.write_text(json.dumps(json.loads(path.read_text()) | {"drivers": {"hxn": {"version_status": 70}}}), encoding="utf-8")
    ran = hxa(path, "list", "1")
    assert (ran.returncode, "cannot read all adapters: Application/Driver version mismatch (70)" in ran.stderr) == (1, True)
    assert "ZMC2000456" in ran.stdout and "/dev/hxn" not in ran.stdout


def test_a_test_that_fails_leaves_the_port_in_service(tmp_path):
    busy = {"command": "IOCMD_DIAG_LOOPBACK", "status": 71}
    stuck = {"command": "IOCMD_PORT_ENABLE", "status": 1}
    failed = hxa(host(tmp_path, busy), "--yes", "diag", "loopback", "2/0")
    assert (failed.returncode, "diag busy (71)" in failed.stdout, failed.stderr) == (1, True, "")
    left = hxa(host(tmp_path, stuck), "--yes", "--json", "diag", "loopback", "2/0")
    assert left.returncode == 1 and "does not come back into service" in left.stderr
    assert json.loads(left.stdout)["passed"]
    assert hxa(host(tmp_path, stuck), "diag", "loopback", "2/1").returncode == 0  # was out of service


def test_flash_is_read_as_it_was_written(tmp_path):
    image = tmp_path / "image"
    image.write_bytes(bytes(range(256)))
    assert hxa("mixed", "--yes", "flash", "write", "1", "cfg/1", image).returncode == 0
    assert hxa("mixed", "flash", "read", "1", "pbc", tmp_path / "copy").returncode == 0
    assert (tmp_path / "copy").stat().st_size == 4096


def test_events_are_followed_until_interrupted(tmp_path):
    control = tmp_path / "control"
    command = [BUILD / "cli/hxa", "--json", "events"]
    program = subprocess.Popen(command, env=environment("mixed", HXASIM_CONTROL=str(control)), stdout=subprocess.PIPE, text=True)
    deadline = time.monotonic() + TIMEOUT
    while not control.exists():
        assert time.monotonic() < deadline
        time.sleep(0.02)
    for words in ("event port sfp-pom --level 3", "event ioc hbfail --node /dev/hxn", "unplug 1"):
        subprocess.run([BUILD / "sim/hxasim", "--socket", control, *words.split()], check=True, capture_output=True, timeout=TIMEOUT)
    seen = [json.loads(program.stdout.readline()) for _ in range(3)]
    program.send_signal(signal.SIGINT)
    rest, _ = program.communicate(timeout=TIMEOUT)
    assert (program.returncode, rest) == (0, "")
    assert [(event["element"], event["severity"], event["message"]) for event in seen] == [
        ("port 1/0", "Warning", "SFP POM level to alarm: WWN/MAC = 100000051E100000."),
        ("port 1/0", "Critical", "Heart Beat of IOC 0 has failed."),
        ("adapter 2", "Warning", "Adapter removed: SN = ZMF2500789."),
    ]


def test_completion_names_the_ports_of_this_host():
    source = shlex.quote(str(ROOT / "packaging/completion/hxa"))
    script = f"source {source}; COMP_WORDS=(hxa port show 2); COMP_CWORD=3; _hxa; echo ${{COMPREPLY[@]}}"
    ran = subprocess.run(["bash", "-c", script], env=environment("mixed"), capture_output=True, text=True, timeout=TIMEOUT)
    assert (ran.stdout, ran.stderr) == ("2 2/0 2/1\n", "")
