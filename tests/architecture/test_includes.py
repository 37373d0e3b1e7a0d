"""Data goes one way: each folder includes only what lies below it in the house."""

import re
from pathlib import Path

import pytest

ROOT = Path(__file__).resolve().parents[2]

# folder: the folders (or single files) of ours that it may include besides itself
MAY_INCLUDE = {
    "text": [],
    "runtime": ["text"],
    "schema": ["runtime"],
    "hxal": [],
    "cmpi": ["runtime", "providers/providers.def"],
    "inventory": ["schema", "runtime", "text", "hxal"],
    "profiles": ["schema", "runtime", "hxal", "inventory", "cmpi/cimom.h"],
    "diagnostics": ["schema", "runtime", "hxal", "inventory"],
    "indications": ["schema", "runtime", "hxal", "inventory"],
    "providers": [
        "inventory",
        "profiles",
        "diagnostics",
        "indications",
        "schema",
        "cmpi/cimom.h",
        "cmpi/provider.h",
        "cmpi/handlers.h",
        "cmpi/status.h",
        "runtime",
    ],
    "cimserver": ["cmpi/standard", "cmpi/registration.h", "runtime/meta.h", "runtime/types.h", "text"],
    "sim": ["hxal/records", "hxal/commands.h"],
    "cli": ["hxal", "text", "metrics/families.h"],
}

# The floors inside a big folder: its sub-folder ("." is the folder itself): the sub-folders (or single files) of the same big
# folder that it may include besides itself. A folder of this table has no sub-folder that stands in no row.
FLOORS = {
    "cmpi": {"standard": [], ".": ["standard"]},
    "sim": {
        ".": ["model"],
        "model": [],
        "scenario": ["model"],
        "commands": ["model"],
        "driver": ["model", "scenario", "commands", "hxasim.h"],
        "control": ["model", "scenario", "driver", "hxasim.h"],
        "interposition": ["scenario", "driver", "control", "hxasim.h"],
        "scenarios": [],
    },
    "hxal": {
        "records": [],
        "internal": ["records", "adapter.h", "ioc.h", "library.h"],
        "config": ["internal", "records", "adapter.h", "ioc.h"],
        ".": ["config", "internal", "records"],
    },
    "cimserver": {
        "model": [],
        "broker": ["model"],
        "security": ["model"],
        "cimxml": ["model", "security"],
        "operations": ["model", "broker"],
        "interop": ["model", "broker", "operations"],
        "indications": ["model", "broker", "cimxml", "security", "operations", "interop"],
        ".": ["model", "broker", "cimxml", "security", "operations", "interop", "indications"],
    },
}


def includes(folder):
    """(file, line number, included name) of every quoted include below a folder."""
    for path in sorted((ROOT / folder).rglob("*")):
        if path.suffix in {".h", ".cpp", ".c", ".def"}:
            for number, line in enumerate(path.read_text(encoding="utf-8").splitlines(), 1):
                included = re.match(r'\s*#\s*include\s+"([^"]+)"', line)
                if included:
                    yield path.relative_to(ROOT), number, included[1]


@pytest.mark.parametrize("folder", MAY_INCLUDE)
def test_folder_includes_only_what_lies_below_it(folder):
    allowed = (f"{folder}/", *(name if "." in name else f"{name}/" for name in MAY_INCLUDE[folder]))
    strays = [
        f"{path}:{number} includes {name}"
        for path, number, name in includes(folder)
        if not name.startswith(allowed)
    ]
    assert strays == []


@pytest.mark.parametrize("folder", FLOORS)
def test_floor_includes_only_floors_below_it(folder):
    def floor(name):
        return name.split("/")[0] if "/" in name else "."

    strays = []
    for path, number, name in includes(folder):
        if not name.startswith(f"{folder}/"):
            continue
        here, there = str(path.relative_to(folder)), name.removeprefix(f"{folder}/")
        allowed = [floor(here), *FLOORS[folder].get(floor(here), [])]
        if floor(there) not in allowed and there not in allowed:
            strays.append(f"{path}:{number} includes {name}")
    assert strays == []


@pytest.mark.parametrize("folder", FLOORS)
def test_every_sub_folder_has_a_floor(folder):
    sub_folders = {path.name for path in (ROOT / folder).iterdir() if path.is_dir()}
    assert sub_folders - FLOORS[folder].keys() == set()


def test_command_line_sees_no_more_of_the_access_library_than_its_other_clients():
    hidden = ("hxal/internal/", "hxal/config/internal/", "hxal/records/commands.h")
    assert [f"{path}:{number}" for path, number, name in includes("cli") if name.startswith(hidden)] == []


@pytest.mark.parametrize("folder", ["sim", "cli"])
def test_one_source_sees_the_json_library(folder):
    sources = [path for path in (ROOT / folder).rglob("*.*") if path.suffix in {".h", ".cpp"}]
    assert [path.name for path in sources if "<nlohmann/json.hpp>" in path.read_text(encoding="utf-8")] == ["json.cpp"]


def test_every_folder_of_the_table_exists_and_says_what_it_is():
    folders = [*MAY_INCLUDE, "hxal/config", "cmpi/standard", "packaging", "tests", "bench", "fuzz", "script", "docs", "tools"]
    assert [folder for folder in folders if not (ROOT / folder / "README.md").is_file()] == []
