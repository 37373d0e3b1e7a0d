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
PYTHON = [sys.executable, "-B"]
PROGRAMS = {
    "hxa": [BUILD / "cli/hxa"],
    "hxasim": [BUILD / "sim/hxasim"],
    "zmlr-cimserver": [BUILD / "cimserver/zmlr-cimserver"],
    "zmlr-inventory": [*PYTHON, ROOT / "client/zmlr-inventory"],
    "zmlr-register": [*PYTHON, "-m", "zmlr_register.main"],
}


def test_manual_pages_are_well_formed(tmp_path):
    for program, output, source in (("header_pages.py", tmp_path, "hxal"), ("scenario_page.py", tmp_path / "hxasim-scenario.5", "sim/README.md")):
        subprocess.run([*PYTHON, ROOT / "packaging/man" / program, "--output", output, ROOT / source], check=True)
    lint = subprocess.run(["mandoc", "-T", "lint", "-W", "warning", *PAGES, *tmp_path.iterdir()], capture_output=True, text=True)
    assert lint.stdout + lint.stderr == ""


def options_of(program, *words):
    """The long options that help tells, of the subcommands too."""
    path = {**os.environ, "PYTHONPATH": str(ROOT / "packaging/registration")}
    text = subprocess.run([*program, *words, "--help"], env=path, capture_output=True, text=True, check=True).stdout
    options = set(re.findall(r"(?<![\w-])--[a-z][a-z-]+", text))
    subcommands = re.findall(r"^  ([a-z][a-z-]*)", text.partition("Subcommands:")[2], re.MULTILINE)
    return options.union(*(options_of(program, *words, command) for command in subcommands))


@pytest.mark.parametrize("page", PAGES, ids=lambda page: page.stem)
def test_every_option_is_in_the_manual_page_and_the_completion(page):
    options = options_of(PROGRAMS[page.stem])
    assert "--help" in options
    manual = subprocess.run(["mandoc", "-T", "ascii", page], capture_output=True, text=True, check=True).stdout
    manual = re.sub(".\b", "", manual)
    completion = (ROOT / "packaging/completion" / page.stem).read_text()
    for text in (manual, completion):
        assert not options - set(re.findall(r"--[a-z][a-z-]+", text))


def test_the_class_reference_is_what_script_golden_writes():
    assert (ROOT / "docs/classes.md").read_text(encoding="utf-8") == class_reference.page()


LITERAL = r'"((?:[^"\\]|\\.)*)"'
# A call of the log that is given its text, which then stands somewhere in the same file,
GIVEN = re.compile(r'(?<!define )ZMLR_LOG\((?!\s*[^,"]+,\s*"(?!%s"))')
# or where this says: in another file, or in rows and calls that tell the level or the source with it.
ELSEWHERE = {"diagnostics/test_run.cpp": "diagnostics/record_messages.cpp", "providers/diagnostic_run.cpp": "providers/diagnostic_runs.h",
             "inventory/adapter_walk.cpp": None, "inventory/builder.h": None, "providers/enumeration.cpp": None}
# What else those files say: to the subscribers of alerts, and inside another line.
UNLOGGED = {"The network port %s has been enabled", "The network port %s has been disabled", "FC HBA"}


def logged_texts():
    given = set()
    for folder in ("runtime", "cmpi", "inventory", "profiles", "diagnostics", "indications", "providers", "hxal"):
        for file in sorted((ROOT / folder).rglob("*.[ch]*")):
            name = str(file.relative_to(ROOT))
            text = re.sub(r"^\s*//.*$", "", file.read_text(encoding="utf-8"), flags=re.MULTILINE)
            call = r"std::printf\(" if folder == "hxal" else r"(?:\bLL_\w+, ?(?:[\w.]+, ?)*|ZMLR_LOG\(level, |warning\(\)\.invoke\(|, log_source, )"
            texts = re.findall(call + LITERAL, text)
            given.update([name] if GIVEN.search(text) else [])
            if name in given - ELSEWHERE.keys() or name in ELSEWHERE.values():
                spoken = [found for found in re.findall(LITERAL, text) if " " in found]
                assert spoken, f"where are the texts that {name} logs?"
                texts += spoken
            yield from (" ".join(re.sub(r"\\[nt]", " ", found).split()) for found in texts)
    assert ELSEWHERE.keys() - given == set()


def test_the_page_of_messages_has_every_text_that_is_logged_and_no_other():
    cells = re.findall(r"^\|[^|`]*\| (`.*?`) \|", (ROOT / "docs/messages.md").read_text(encoding="utf-8"), re.MULTILINE)
    told = {text for cell in cells for text in re.findall(r"`([^`]+)`", cell)}
    assert told == set(logged_texts()) - UNLOGGED - {"%s"}


def test_links_between_pages_lead_somewhere():
    """To a file, and in it to a heading."""
    for page in subprocess.run(["git", "ls-files", "*.md"], cwd=ROOT, capture_output=True, text=True, check=True).stdout.split():
        for target, _, heading in (link.partition("#") for link in re.findall(r"\]\(([^)\s]+)\)", (ROOT / page).read_text(encoding="utf-8"))):
            if ":" in target:
                continue
            file = (ROOT / page).parent / target if target else ROOT / page
            assert file.exists(), f"{page}: {target}"
            if heading:
                headings = re.findall(r"^#+ (.*)", file.read_text(encoding="utf-8"), re.MULTILINE)
                assert heading in map(class_reference.anchor, headings), f"{page}: {target}#{heading}"
