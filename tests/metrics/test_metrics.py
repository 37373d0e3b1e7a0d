"""What hxa and zmlr-inventory write for collectors, held against Prometheus's own tools and a strict parser of OpenMetrics."""

import csv
import os
import re
import subprocess
import sys
from pathlib import Path

import pytest
from prometheus_client.openmetrics.parser import text_string_to_metric_families

ROOT = Path(__file__).resolve().parents[2]
HERE = Path(__file__).resolve().parent
BUILD = Path(os.environ.get("ZMLR_BUILD_DIR", ROOT / "build/dev"))
sys.path[:0] = [str(ROOT), str(ROOT / "client")]

from tools.simulated_server import SimulatedServer  # noqa: E402
from zmlr_inventory.main import main  # noqa: E402

IS_SANITIZED = "ZMLR_SANITIZE:STRING=\n" not in (BUILD / "CMakeCache.txt").read_text(encoding="utf-8")
with (ROOT / "metrics/families.tsv").open(encoding="utf-8") as table:
    FAMILIES = list(csv.DictReader(table, delimiter="\t", quoting=csv.QUOTE_NONE))
SEEN_BY_BOTH = {row["family"] for row in FAMILIES if row["cim"] != "-" and {row["fc"], row["fcoe"]} != {"-"}}


def hxa(scenario, path):
    simulated = {"HXASIM_SCENARIO": str(scenario)} | ({} if IS_SANITIZED else {"LD_PRELOAD": str(BUILD / "sim/libhxasim.so")})
    command = [BUILD / "cli/hxa", "stats", "--openmetrics", path]
    return subprocess.run(command, env=os.environ | simulated, capture_output=True, text=True, check=False)


def check_metrics(path):
    return subprocess.run(["promtool", "check", "metrics"], stdin=path.open("rb"), capture_output=True, text=True, check=False)


def series(path):
    """The samples by name and labels; the parser refuses what is not OpenMetrics, and a series told twice is seen by the count."""
    text = path.read_text(encoding="utf-8")
    samples = [sample for family in text_string_to_metric_families(text) for sample in family.samples]
    told = {(sample.name, *sorted(sample.labels.items())): sample.value for sample in samples}
    assert len(told) == len(samples)
    return told


@pytest.mark.parametrize("scenario", ["mixed", HERE / "hostile.json"])
def test_both_programs_tell_the_same_in_both_forms(scenario, tmp_path):
    told = {}
    with SimulatedServer(str(scenario)) as server:
        for suffix in (".prom", ".txt"):
            files = {"hxa": tmp_path / f"hxa{suffix}", "inventory": tmp_path / f"inventory{suffix}"}
            assert (written := hxa(scenario, files["hxa"])).returncode == 0, written.stderr
            assert main([server.url, "--openmetrics", str(files["inventory"])]) == 0
            for program, path in files.items():
                assert path.stat().st_mode & 0o777 == 0o644
                if suffix == ".prom":
                    checked = check_metrics(path)
                    assert (checked.returncode, checked.stdout + checked.stderr) == (0, "")
                    counters = [line for line in path.read_text().splitlines() if line.endswith(" counter")]
                    assert all(line.endswith("_total counter") for line in counters) and len(counters) >= 14
                    continue
                told[program] = {key: value for key, value in series(path).items() if key[0] in SEEN_BY_BOTH and "last_read" not in key[0]}
    assert told["hxa"] == told["inventory"]
    assert sum(key[0] == "hxa_adapter_enabled" for key in told["hxa"]) == told["hxa"]["hxa_adapters",]
    if scenario == "mixed":
        port = (("adapter", "ZMF2500789"), ("port_wwn", "100000051E100100"))
        assert told["hxa"][("hxa_port_receive_bytes_total", *port)] == 16384000
        assert told["hxa"][("hxa_port_speed_bytes_per_second", *port)] == 2.5e8
        assert told["hxa"][("hxa_port_state", *port, ("state", "up"))] == 1


def test_a_failed_read_leaves_the_old_file_and_what_is_no_file_is_refused(tmp_path):
    old = tmp_path / "old.prom"
    old.write_text("old")
    assert hxa("no-driver", old).returncode != 0
    assert main(["http://127.0.0.1:9", "--openmetrics", str(old)]) != 0

    (tmp_path / "link.prom").symlink_to(old)
    assert hxa("mixed", tmp_path / "link.prom").returncode != 0
    assert hxa("mixed", tmp_path / "missing" / "new.prom").returncode != 0
    assert old.read_text() == "old"
    assert sorted(path.name for path in tmp_path.iterdir()) == ["link.prom", "old.prom"]


def test_hosts_are_told_apart_and_one_that_failed_is_down(tmp_path):
    path = tmp_path / "fleet.txt"
    with SimulatedServer("fc-hba") as server:
        assert main([server.url, "http://127.0.0.1:9", "--openmetrics", str(path)]) == 1
        (tmp_path / "link").symlink_to(path)
        assert main([server.url, "--openmetrics", str(tmp_path / "link")]) == 5
    told = series(path)
    here = ("host", server.url.removeprefix("http://"))
    assert (told["hxa_host_up", here], told["hxa_host_up", ("host", "127.0.0.1:9")], told["hxa_adapters", here]) == (1, 0, 1)
    assert all(here in key for key in told if key[0] != "hxa_host_up")


def test_alert_rules_fire_on_what_they_are_for():
    for arguments in (["check", "rules", ROOT / "metrics/hxa.rules.yml"], ["test", "rules", HERE / "hxa.rules.test.yml"]):
        checked = subprocess.run(["promtool", *arguments], capture_output=True, text=True, check=False)
        assert checked.returncode == 0, checked.stdout + checked.stderr


def test_rules_and_page_speak_of_the_families_that_are_told():
    rules = (ROOT / "metrics/hxa.rules.yml").read_text(encoding="utf-8")
    page = (ROOT / "docs/openmetrics.md").read_text(encoding="utf-8")
    families = {row["family"] for row in FAMILIES}
    assert set(re.findall(r"hxa_\w+", rules)) - families == set()
    assert [name for name in families.union(re.findall(r"alert: (\w+)", rules)) if f"`{name}`" not in page] == []
