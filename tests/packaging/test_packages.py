"""The Debian packages of a build folder: what lintian says, what works when they are installed, what is left when they are gone."""

import os
import re
import subprocess
from pathlib import Path

import pytest

BUILD = Path(os.environ["ZMLR_BUILD_DIR"])
PACKAGES = {"zmlr-provider", "libhxal1", "libhxal-dev", "hxa", "zmlr-cimserver", "zmlr-inventory", "hxasim"}
ACCOUNTS = {"passwd", "group", "shadow", "gshadow", "passwd-", "group-", "shadow-", "gshadow-", ".pwd.lock"}

CLIENT = """
#include <hxal/hxal.h>
#include <stdio.h>
int main(void)
{
    hxal_libinit(hxa_aen_app_cim);
    printf("%d adapters\\n", hxal_adapter_scan());
    hxal_libexit();
    return 0;
}
"""
PROJECT = """
cmake_minimum_required(VERSION 3.22)
project(client CXX)
find_package(hxal 1 REQUIRED)
add_executable(client client.cpp)
target_link_libraries(client hxal::hxal)
"""


def run(*command, code=0, **environment):
    done = subprocess.run(command, capture_output=True, text=True, env=os.environ | environment, timeout=300, check=False)
    assert done.returncode == code, (command, done.stdout, done.stderr)
    return done.stdout


@pytest.fixture(scope="module", name="packages")
def fixture_packages(tmp_path_factory):
    folder = tmp_path_factory.mktemp("packages")
    run("cpack", "--config", BUILD / "CPackConfig.cmake", "-B", folder)
    return {file.name.split("_")[0]: file for file in folder.glob("*.deb")}


class Tree:
    """An empty system, with a package administration of its own."""

    def __init__(self, root):
        self.root = root
        for folder in ("etc", "var/lib/dpkg/info", "var/lib/dpkg/updates"):
            (root / folder).mkdir(parents=True)
        (root / "var/lib/dpkg/status").touch()
        self.libraries = next(Path("/usr/lib").glob("*-linux-gnu*/libc.so.6")).parent.relative_to("/")

    def dpkg(self, *arguments):
        as_root = [] if os.geteuid() == 0 else ["fakeroot"]
        options = ["--force-script-chrootless", "--force-depends", "--force-not-root", "--log=/dev/null"]
        path = f"{os.environ['PATH']}:/usr/sbin:/sbin"
        return run(*as_root, "dpkg", f"--root={self.root}", *options, *arguments, PATH=path)

    def files(self):
        every = (path for path in self.root.rglob("*") if path.is_symlink() or not path.is_dir())
        names = {str(path.relative_to(self.root)) for path in every}
        return {name for name in names if not name.startswith("var/lib/dpkg/")} - {f"etc/{name}" for name in ACCOUNTS}

    def counts_adapters(self, program):
        library = self.root / self.libraries
        simulated = {"LD_PRELOAD": str(library / "zmlr/libhxasim.so"), "HXASIM_SCENARIO": "mixed"}
        return run(program, LD_LIBRARY_PATH=str(library), **simulated) == "4 adapters\n"


@pytest.fixture(scope="module", name="tree")
def fixture_tree(packages, tmp_path_factory):
    tree = Tree(tmp_path_factory.mktemp("tree"))
    tree.dpkg("--install", *packages.values())
    return tree


def test_lintian_misses_the_licence_only(packages):
    assert set(packages) == PACKAGES
    told = subprocess.run(["lintian", "--allow-root", *packages.values()], capture_output=True, text=True, check=False).stdout
    assert set(told.splitlines()) == {f"E: {name}: no-copyright-file" for name in PACKAGES}


def test_clients_in_c_and_cpp(tree, tmp_path):
    include = tree.root / "usr/include"
    headers = sorted(str(file.relative_to(include)) for file in include.rglob("*.h"))
    assert len(headers) > 40 and not [name for name in headers if "internal" in name]
    for number, header in enumerate(headers):
        (tmp_path / f"{number}.c").write_text(f"#include <{header}>\nint header_{number};\n")
    strict = ["-Wall", "-Wextra", "-Wpedantic", "-Werror", "-fsyntax-only", f"-I{include}"]
    run(os.environ["CC"], "-std=c11", *strict, *tmp_path.glob("*.c"))
    run(os.environ["CXX"], "-std=c++11", "-x", "c++", *strict, *tmp_path.glob("*.c"))

    (tmp_path / "client.c").write_text(CLIENT)
    options = run("pkg-config", "--cflags", "--libs", "hxal", PKG_CONFIG_PATH=str(tree.root / tree.libraries / "pkgconfig"))
    run(os.environ["CC"], "-std=c11", "-o", tmp_path / "client", tmp_path / "client.c", *options.split())
    assert tree.counts_adapters(tmp_path / "client")

    (tmp_path / "client.cpp").write_text(CLIENT)
    (tmp_path / "CMakeLists.txt").write_text(PROJECT)
    run("cmake", "-S", tmp_path, "-B", tmp_path / "build", f"-DCMAKE_PREFIX_PATH={tree.root}/usr")
    run("cmake", "--build", tmp_path / "build")
    assert tree.counts_adapters(tmp_path / "build/client")


def test_the_library_exports_what_its_headers_declare(tree):
    headers = "".join(file.read_text() for file in (tree.root / "usr/include").rglob("*.h"))
    declared = set(re.findall(r"^    .*?\b(hxal?_\w+)(?:\(|\[[^\]]*\];)", re.sub(r"//.*", "", headers), re.MULTILINE))
    symbols = run("nm", "-D", "--defined-only", tree.root / tree.libraries / "libhxal.so.1").splitlines()
    assert {line.split()[-1] for line in symbols} == {name for name in declared if not name.endswith("_t")}


def test_programs_run_where_they_are_installed(tree):
    programs = {path.name: path for folder in ("bin", "sbin") for path in (tree.root / "usr" / folder).iterdir()}
    assert set(programs) == {"hxa", "hxasim", "zmlr-cimserver", "zmlr-inventory", "zmlr-register"}
    for name, program in programs.items():
        assert name in run(program, "--help", LD_LIBRARY_PATH=str(tree.root / tree.libraries), PYTHONDONTWRITEBYTECODE="1")


def test_units_are_sound_and_keep_their_programs_in(tree):
    units = list((tree.root / "usr/lib/systemd/system").iterdir())
    told = subprocess.run(["systemd-analyze", "verify", "--man=no", *units], capture_output=True, text=True, check=False).stderr
    assert [line for line in told.splitlines() if not re.search("/usr/s?bin/(hxa|zmlr-cimserver) is not executable", line)] == []
    services = [unit for unit in units if unit.suffix == ".service"]
    assert {service.name for service in services} == {"hxa-openmetrics.service", "zmlr-cimserver.service"}
    run("systemd-analyze", "security", "--offline=yes", "--threshold=20", "--no-pager", *services)


def test_a_purge_leaves_nothing(tree):
    metrics = "var/lib/prometheus/node-exporter/hxa.prom"
    made = {"var/lib/zmlr-cimserver/subscriptions", "var/cache/zmlr-cimserver/boot.tar", "etc/zmlr/users.Xa3Bc9",
            "var/lib/zmlr-register/sfcb.json", "usr/share/zmlr/venv/bin/python", metrics}
    for file in map(tree.root.joinpath, made):
        file.parent.mkdir(parents=True, exist_ok=True)
        file.touch()
    users = tree.root / "etc/zmlr/users"
    assert (users.read_text(), users.stat().st_mode & 0o777) == ("", 0o640)
    assert "zmlr-cimserver:" in (tree.root / "etc/passwd").read_text()

    tree.dpkg("--remove", *PACKAGES)
    assert {*made, "etc/zmlr/users", "etc/default/zmlr-cimserver"} - tree.files() == {metrics}, "settings and state stay"
    tree.dpkg("--purge", *PACKAGES)
    assert tree.files() == set()
    assert "zmlr" not in (tree.root / "etc/passwd").read_text() + (tree.root / "etc/group").read_text()
