"""The pages that people read, held against what they tell of."""

import os
import pathlib
import re
import subprocess
import sys

import pytest

from tools import class_reference

ROOT = pathlib.Path(__file__).resolve().parents[2]
BUILD = pathlib.Path(os.environ.get("ZMLR_BUILD_DIR", ROOT / "build/dev"))
PAGES = sorted((ROOT / "packaging/man").glob("*.[1-9]"))
PROGRAMS = {
    "hxa": BUILD / "cli/hxa",
    "hxasim": BUILD / "sim/hxasim",
    "zmlr-cimserver": BUILD / "cimserver/zmlr-cimserver",
    "zmlr-inventory": ROOT / "client/zmlr-inventory",
    "zmlr-register": ROOT / "packaging/registration/zmlr-register",
}


def test_manual_pages_are_well_formed(tmp_path):
    subprocess.run([sys.executable, "-B", ROOT / "packaging/man/header_pages.py", "--output", tmp_path, ROOT / "hxal"], check=True)
    lint = subprocess.run(["mandoc", "-T", "lint", "-W", "warning", *PAGES, *tmp_path.iterdir()], capture_output=True, text=True)
    assert lint.stdout + lint.stderr == ""


def options_of(program, *words):
    """The long options that help tells, of the subcommands too."""
    text = subprocess.run([program, *words, "--help"], capture_output=True, text=True, check=True).stdout
    options = set(re.findall(r"(?<![\w-])--[a-z][a-z-]+", text))
    subcommands = re.findall(r"^  ([a-z][a-z-]*)", text.partition("Subcommands:")[2], re.MULTILINE)
    return options.union(*(options_of(program, *words, command) for command in subcommands))


@pytest.mark.parametrize("page", PAGES, ids=lambda page: page.stem)
def test_every_option_is_in_the_manual_page_and_the_completion(page):
    program = PROGRAMS[page.stem]
    if not program.exists():
        pytest.skip(f"{program} is not built")
    options = options_of(program)
    manual = subprocess.run(["mandoc", "-T", "ascii", page], capture_output=True, text=True, check=True).stdout
    manual = re.sub(".\b", "", manual)
    completion = (ROOT / "packaging/completion" / page.stem).read_text()
    for text in (manual, completion):
        assert not options - set(re.findall(r"--[a-z][a-z-]+", text))


def test_the_class_reference_is_what_script_golden_writes():
    assert (ROOT / "docs/classes.md").read_text(encoding="utf-8") == class_reference.page()
