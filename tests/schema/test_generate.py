"""The generator on small MOF texts of its own: what it writes, and that wrong input is refused with a clear message."""

import json
import os
import pathlib
import subprocess
import sys

import pytest
import pywbem

SCHEMA = pathlib.Path(__file__).resolve().parents[2] / "schema"
sys.path.insert(0, str(SCHEMA))
import generate  # noqa: E402

CIM_A = "class CIM_A { string S; };"
ROW = "ZMLR_PROVIDER(CIM_A, INSTANCE, SKELETON)\n"


class Project:
    """A folder with one MOF file and one provider table."""

    def __init__(self, folder, capsys):
        self.folder = folder
        self.output = folder / "generated"
        self.capsys = capsys

    def arguments(self, mof, providers):
        (self.folder / "classes.mof").write_text(mof)
        (self.folder / "providers.def").write_text(providers)
        files = ["--output", self.output, "--providers", self.folder / "providers.def", SCHEMA / "qualifiers.mof"]
        return [str(argument) for argument in (*files, self.folder / "classes.mof")]

    def generate(self, mof, providers=ROW):
        """The message of a failed run, empty when it succeeded."""
        status = generate.main(self.arguments(mof, providers))
        message = self.capsys.readouterr().err
        assert status == (1 if message else 0)
        return message

    def run(self, mof, hash_seed="0"):
        """As a build runs it: in a process of its own."""
        return subprocess.run([sys.executable, "-B", SCHEMA / "generate.py", *self.arguments(mof, ROW)],
                              env={**os.environ, "PYTHONHASHSEED": hash_seed}, capture_output=True, text=True)

    def contents(self):
        return {path: (path.read_bytes(), path.stat().st_mtime_ns) for path in self.output.rglob("*.*")}


@pytest.fixture
def project(tmp_path, capsys):
    return Project(tmp_path, capsys)


WRONG_INPUT = json.loads(pathlib.Path(__file__).with_name("wrong_mof.json").read_text(encoding="utf-8"))


@pytest.mark.parametrize("case", WRONG_INPUT.values(), ids=WRONG_INPUT.keys())
def test_wrong_mof_is_refused_and_leaves_the_output_alone(project, case):
    project.generate(CIM_A)
    before = project.contents()
    assert case["message"] in project.generate(case["mof"])
    assert project.contents() == before


@pytest.mark.parametrize("row, message", [
    ("ZMLR_PROVIDER(CIM_Gone, INSTANCE, SKELETON)", "CIM_Gone is not declared in the MOF"),
    ("ZMLR_PROVIDER(CIM_A, METHOD, SKELETON)", "METHOD, SKELETON: unknown interfaces or provider state"),
    ("ZMLR_PROVIDER(CIM_A, INSTANCE, PLANNED)", "INSTANCE, PLANNED: unknown interfaces or provider state"),
    ("", "no ZMLR_PROVIDER rows"),
])
def test_wrong_provider_table_is_refused(project, row, message):
    assert message in project.generate(CIM_A, providers=row)


def test_a_failed_run_stops_a_build(project):
    result = project.run("class CIM_A { string S };")
    assert result.returncode == 1
    assert result.stderr.startswith("generate.py: MOF parsing error")
    assert "Traceback" not in result.stderr


class EmptyServer(pywbem.MOFWBEMConnection):
    """Takes a class when everything that it names is there: superclass, referenced and embedded classes, qualifiers."""

    def __init__(self):
        super().__init__()
        self.known = []

    def CreateClass(self, NewClass, namespace=None):
        elements = [*NewClass.properties.values(), *NewClass.methods.values()]
        elements += [parameter for method in NewClass.methods.values() for parameter in method.parameters.values()]
        named = [NewClass.superclass, *(getattr(element, "reference_class", None) for element in elements)]
        named += [element.qualifiers["EmbeddedInstance"].value for element in elements if "EmbeddedInstance" in element.qualifiers]
        missing = {name for name in named if name} - {*self.known, NewClass.classname}
        if missing:
            raise pywbem.CIMError(pywbem.CIM_ERR_INVALID_PARAMETER, f"{NewClass.classname} names {missing}")
        self.known.append(NewClass.classname)


def test_a_strict_server_takes_the_files_into_an_empty_name_space():
    server = EmptyServer()
    compiler = pywbem.MOFCompiler(server, log_func=None)
    for name in ("qualifiers.mof", "cim.mof", "zemlar.mof"):
        compiler.compile_file(str(SCHEMA / name), None)
    assert server.known[-1].startswith("ZEMLAR_")


def test_output_is_deterministic_and_touched_only_where_it_changes(project):
    classes = "class CIM_A { string S; uint32 M(CIM_A REF X, CIM_B REF Y); }; class CIM_B : CIM_A { };"
    assert project.run(classes, hash_seed="1").returncode == 0
    first = project.contents()
    assert project.run(classes, hash_seed="2").returncode == 0
    assert project.contents() == first

    project.generate(classes + "class CIM_C : CIM_B { };")
    second = project.contents()
    changed = {path.name for path in second if first.get(path) != second[path]}
    assert changed == {"CIM_C.h", "meta_data.cpp", "repository.h"}

    of_another = project.output / "metrics/families.h"
    of_another.parent.mkdir()
    of_another.touch()
    project.generate(classes)
    of_another.unlink()  # and it is still there
    assert project.contents().keys() == first.keys()
