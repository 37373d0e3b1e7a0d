"""A host with the programs of CIM servers, and a small product to register with them."""

import os
import pathlib
import shutil
import sys
import tempfile
import traceback
from types import SimpleNamespace

import pytest

ROOT = pathlib.Path(__file__).resolve().parents[2]
sys.path.insert(0, str(ROOT / "packaging" / "registration"))

import generate_registration  # noqa: E402
from zmlr_register.main import main  # noqa: E402

STAND_IN = pathlib.Path(__file__).with_name("stand_in")
SERVERS = {
    "openpegasus": ("cimmof", "cimprovider", "cimcli", "cimconfig"),
    "sfcb": ("sfcbstage", "sfcbunstage", "sfcbrepos", "systemctl"),
}
STANDARD = "class CIM_ManagedElement { };\nclass CIM_Port : CIM_ManagedElement { };\nclass CIM_RegisteredProfile { };\n"
PRODUCT = "".join(f'[Description("One.")]\nclass ZEMLAR_{name} : CIM_{name}\n{{\n}};\n\n' for name in ("Port", "RegisteredProfile"))
PROVIDERS = "".join(f"ZMLR_PROVIDER(ZEMLAR_{name}, INSTANCE, SKELETON)\n" for name in ("Port", "RegisteredProfile"))


class Host:
    """A folder that holds the servers' state, our program's notes and the product's data."""

    def __init__(self, folder):
        self.folder = folder
        self.state = folder / "host"
        for name in ("modules", "providers", "staging/regs", "staging/mofs", "repository", "served"):
            (self.state / name).mkdir(parents=True)
        (folder / "bin").mkdir()
        self.make_name_space("root/PG_InterOp")
        self.write_schema(STANDARD)
        self.make_product("1.0.0")
        self.places = ["--schema", str(folder / "schema/CIM_Schema.mof"), "--staging", str(self.state / "staging")]

    def has(self, *servers):
        for program in (program for server in servers for program in SERVERS[server]):
            (self.folder / "bin" / program).symlink_to(STAND_IN)
        return self

    def make_name_space(self, name):
        classes = self.state / name / "=classes"
        classes.mkdir(parents=True)
        for line in STANDARD.splitlines():
            cls, _, superclass = line.removeprefix("class ").removesuffix(" { };").partition(" : ")
            (classes / cls).write_text(superclass + "\n")

    def write_schema(self, classes):
        files = {"qualifiers.mof": "Qualifier Key : boolean = false, Scope(property);", "classes.mof": "/* class CIM_Gone */\n" + classes,
                 "CIM_Schema.mof": '#pragma include ("qualifiers.mof")\n#pragma include ("classes.mof")\n'}
        (self.folder / "schema").mkdir(exist_ok=True)
        for name, text in files.items():
            (self.folder / "schema" / name).write_text(text)

    def make_product(self, version, mof=PRODUCT, standard=STANDARD):
        texts = {"cim.mof": standard, "zemlar.mof": mof, "providers.def": PROVIDERS, "libzmlrprovider.so": "",
                 "roots.def": "ZMLR_INTEROP_ROOT(CIM_RegisteredProfile)\n"}
        for name, text in texts.items():
            (self.folder / name).write_text(text)
        files = ["--output", "data", "--providers", "providers.def", "--interop-roots", "roots.def"]
        words = [word if word.startswith("--") else str(self.folder / word) for word in [*files, "cim.mof", "zemlar.mof"]]
        words.insert(-2, str(ROOT / "schema" / "qualifiers.mof"))
        assert generate_registration.main(["--version", version, "--module", "../libzmlrprovider.so", *words]) == 0

    def register(self, *words, fault="", at=0):
        """Runs zmlr-register; `fault` (FAIL, TERM, KILL) strikes at call number `at`."""
        (self.state / "calls").unlink(missing_ok=True)
        options = [*words, "--state", str(self.folder / "notes"), *self.places]
        if self.places and ("sfcb" in words or not (self.folder / "bin" / "cimconfig").exists()):
            options += ["--provider-folder", str(self.state / "providers")]
        environment = {"PATH": f"{self.folder}/bin:{os.environ['PATH']}", "STAND_IN": str(self.state), "FAULT": fault,
                       "FAULT_AT": str(at)}
        return self._run(options, environment)

    def _run(self, options, environment):
        """In a process of its own, which may be killed, but without the start of another interpreter."""
        outputs = [self.folder / "stdout", self.folder / "stderr"]
        process = os.fork()
        if process == 0:
            try:
                for number, output in enumerate(outputs, 1):
                    os.dup2(os.open(output, os.O_WRONLY | os.O_CREAT | os.O_TRUNC), number)
                sys.stdout, sys.stderr = open(1, "w", encoding="utf-8"), open(2, "w", encoding="utf-8")
                os.environ.update(environment)
                os.geteuid, tempfile.tempdir = lambda: 0, str(self.folder)
                os._exit(main(options, self.folder / "data"))
            except BaseException:
                traceback.print_exc()
                os._exit(99)
        status = os.waitstatus_to_exitcode(os.waitpid(process, 0)[1])
        return SimpleNamespace(returncode=status, stdout=outputs[0].read_text(), stderr=outputs[1].read_text())

    def calls(self):
        return (self.state / "calls").read_text().splitlines()

    def copy(self, source="host notes", target="host-before notes-before"):
        for here, there in zip(source.split(), target.split()):
            shutil.rmtree(self.folder / there, ignore_errors=True)
            if (self.folder / here).exists():
                shutil.copytree(self.folder / here, self.folder / there, symlinks=True)

    def contents(self):
        """Everything that a run may change: the texts of files, the targets of links, the name spaces."""
        def text(path):
            return os.readlink(path) if path.is_symlink() else path.read_text() if path.is_file() else ""

        paths = [path for folder in (self.state, self.folder / "notes") for path in folder.rglob("*")]
        return {str(path.relative_to(self.folder)): text(path) for path in paths
                if path.name == "=classes" or path.name != "calls" and not path.is_dir()}


@pytest.fixture
def host(tmp_path):
    return Host(tmp_path)
