"""The layer compiles with the CMPI headers of later editions: against copies of ours that are altered as those differ."""

import os
import re
import shutil
import subprocess
from concurrent.futures import ThreadPoolExecutor
from pathlib import Path

import pytest

ROOT = Path(__file__).resolve().parents[2]
STANDARD = ROOT / "cmpi/standard"
BUILD = Path(os.environ.get("ZMLR_BUILD_DIR", ROOT / "build/dev"))
COMPILER = os.environ.get("CXX", "g++")

# file, what is written there, what later editions have in its place, how often
ALTERATIONS = [
    ("cmpift.h", r"\bvoid\* hdl;", "const void* hdl;", 18),
    ("cmpift.h", r"\bint miVersion;", "const int miVersion;", 4),
    ("cmpift.h", r"(\(\*mustPoll\)\(CMPIIndicationMI\*, const CMPIContext\*,)", r"\1 const CMPIResult*,", 1),
    (
        "cmpift.h",
        r"(CMPIStatus \(\*disableIndications\)[^;]*;)",
        r"\1\n" + "".join(f"CMPIStatus (*filterCollection{i})(CMPIIndicationMI*, const CMPIContext*);\n" for i in range(3)),
        1,
    ),
    ("cmpift.h", r"static_assert\([^;]*;", "", 21),  # ours alone have these sizes
    # the broker's calls are the first of their names
    ("cmpift.h", r"(\(\*modifyInstance\)\(const CMPIBroker\*[^;]*?)const char\*\* properties", r"\1const char* const* properties", 1),
    ("cmpift.h", r"(\(\*enumerateInstances\)\(const CMPIBroker\*[^;]*?)const char\*\* properties", r"\1const char* const* properties", 1),
    ("cmpimacs.h", r"(CBEnumInstances\([^;]*?)const char\*\* properties", r"\1const char* const* properties", 1),
    ("cmpimacs.h", r"(CBModifyInstance\([^;]*?)const char\*\* properties", r"\1const char* const* properties", 1),
]


@pytest.fixture(scope="session")
def edition(tmp_path_factory):
    folder = tmp_path_factory.mktemp("edition")
    for header in STANDARD.glob("*.h"):
        shutil.copy(header, folder)
    for name, old, new, times in ALTERATIONS:
        text, count = re.subn(old, new, (folder / name).read_text())
        assert count == times, old
        (folder / name).write_text(text)
    return folder


def test_a_later_edition_compiles(edition):
    flags = ["-std=c++20", "-Wall", "-Wextra", "-Wshadow", "-Wconversion", "-Werror", "-fsyntax-only"]
    flags += ["-DCMPI_PLATFORM_LINUX_GENERIC_GNU", "-DCMPI_VERSION=100"]
    flags += [f"-I{ROOT}", f"-I{BUILD}/generated", f"-I{BUILD}/cmpi/include", "-isystem", edition]

    def errors_of(source):
        return subprocess.run([COMPILER, *flags, source], capture_output=True, text=True).stderr

    with ThreadPoolExecutor(2) as pool:
        errors = list(pool.map(errors_of, sorted((ROOT / "cmpi").glob("*.cpp"))))
    assert "".join(errors) == ""


@pytest.mark.parametrize("place", ["cmpi", "Pegasus/Provider/CMPI"])
def test_the_build_finds_the_headers_of_a_distribution(edition, tmp_path, place):
    shutil.copytree(edition, tmp_path / "prefix/include" / place)
    options = ["-DZMLR_SYSTEM_CMPI=ON", "-DZMLR_TESTS=OFF", f"-DCMAKE_PREFIX_PATH={tmp_path}/prefix"]
    options += [f"-DZMLR_PYTHON={ROOT}/.venv/bin/python"]
    subprocess.run(["cmake", "-S", ROOT, "-B", tmp_path / "build", "-G", "Ninja", *options], check=True, capture_output=True)
    found = re.search(r"ZMLR_CMPI_INCLUDE_DIR:PATH=(.*)", (tmp_path / "build/CMakeCache.txt").read_text())[1]
    assert found == str(tmp_path / "prefix/include" / place)
