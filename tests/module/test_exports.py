"""The built module as the loader sees it: what it exports, what it needs."""

import os
import re
import subprocess
from pathlib import Path

ROOT = Path(__file__).resolve().parents[2]
MODULE = Path(os.environ["ZMLR_MODULE"])

KINDS = {
    "INSTANCE": ["Instance", "Method"],
    "ASSOCIATION": ["Instance", "Method", "Association"],
    "INDICATION": ["Method", "Indication"],
}


def run(*command):
    return subprocess.run(command, capture_output=True, text=True, check=True).stdout


def factories():
    rows = re.findall(r"^ZMLR_PROVIDER\((\w+),\s*(\w+),", (ROOT / "providers/providers.def").read_text(), re.MULTILINE)
    for class_name, interfaces in rows:
        for kind in KINDS[interfaces]:
            yield kind, f"{class_name}_Provider_Create_{kind}MI"
            yield kind, f"{class_name}_Create_{kind}MI"


def test_exports_the_factories_and_two_entry_points_and_nothing_else():
    expected = list(factories())
    counts = {kind: sum(kind == other for other, _ in expected) for kind, _ in expected}
    assert counts == {"Instance": 2 * 74, "Method": 2 * 75, "Association": 2 * 41, "Indication": 2 * 1}

    exported = {line.split()[-1] for line in run("nm", "-D", "--defined-only", MODULE).splitlines()}
    assert exported == {name for _, name in expected} | {"cimple_module", "cimple_cmpi_adapter"}


def test_needs_nothing_but_the_language_and_the_system():
    needed = set(re.findall(r"NEEDED.*\[([a-z+_0-9-]+)\.so", run("readelf", "-d", MODULE)))
    assert needed <= {"libstdc", "libstdc++", "libm", "libgcc_s", "libc", "libpthread", "ld-linux-x86-64"}


def test_is_linked_so_that_it_can_be_trusted_and_unloaded():
    dynamic = run("readelf", "-d", MODULE)
    assert "BIND_NOW" in dynamic or "NOW" in dynamic
    assert "GNU_RELRO" in run("readelf", "-l", MODULE)
    unique = [line for line in run("nm", "-D", MODULE).splitlines() if " u " in line]
    assert unique == [], "a unique symbol keeps the module in memory"
