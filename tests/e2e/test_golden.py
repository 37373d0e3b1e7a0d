"""Golden inventories: all that is served on a scenario, with every property. script/golden rewrites them."""

import difflib
from pathlib import Path

import pytest

from tools.inventory_text import inventory_text

FILES = sorted((Path(__file__).parent / "golden").glob("*.txt"))


@pytest.mark.parametrize("file", FILES, ids=lambda file: file.stem)
def test_all_that_is_served(file, start):
    served = (inventory_text(start(file.stem).server.url) + "\n").splitlines()
    golden = file.read_text(encoding="utf-8").splitlines()
    difference = list(difflib.unified_diff(golden, served, "golden", "served", lineterm="", n=4))
    assert not difference, "\n".join(difference)
