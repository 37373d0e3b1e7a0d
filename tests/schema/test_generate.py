"""The generator on small MOF texts of its own: what it writes, and that wrong input is refused with a clear message."""

import os
import pathlib
import subprocess
import sys

import pytest

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


WRONG_INPUT = {
    "syntax": ("class CIM_A { string S };", "classes.mof:1:22"),
    "unknown qualifier": ("class CIM_A { [Nonsense] string S; };", "'Nonsense'"),
    "unknown superclass": ("class CIM_A : CIM_B { };", "its superclass 'CIM_B' does not exist"),
    "superclass after its subclass": ("class CIM_A : CIM_B { }; class CIM_B { };", "its superclass 'CIM_B' does not exist"),
    "class declared twice": ("class CIM_A { string S; }; class cim_a { string T; };", "cim_a is declared twice"),
    "reference to an unknown class": ("[Association] class CIM_A { CIM_Gone REF R; };", "CIM_A.R refers to CIM_Gone"),
    "parameter of an unknown class": ("class CIM_A { uint32 M(CIM_Gone REF R); };", "CIM_A.M refers to CIM_Gone"),
    "default of another type": ('class CIM_A { uint16 U = "abc"; };', "classes.mof: invalid literal"),
    "default that is a character": ("class CIM_A { char16 C = 'A'; };", "CIM_A.C: the MOF compiler does not read char16"),
    "default out of range": ("class CIM_A { uint8 U = 256; };", "256 is out of range for CIM datatype uint8"),
    "default that is no datetime": ('class CIM_A { datetime D = "soon"; };', "Invalid format of CIM datetime value: 'soon'"),
    "override changes the type": (
        'class CIM_A { uint16 U; }; class CIM_B : CIM_A { [Override("U")] uint32 U; };',
        "CIM_B.U overrides CIM_A.U with another type"),
    "override makes an array": (
        'class CIM_A { uint16 U; }; class CIM_B : CIM_A { [Override("U")] uint16 U[]; };',
        "CIM_B.U overrides CIM_A.U with another type"),
    "override of nothing": ('class CIM_A { [Override("U")] uint16 U; };', 'CIM_A.U overrides "U", which is not inherited'),
    "feature hides an inherited one": (
        "class CIM_A { uint16 U; }; class CIM_B : CIM_A { uint16 u; };", "CIM_B.u has the name of an inherited feature"),
    "no class": ("", "CIM_A is not declared in the MOF"),
}


@pytest.mark.parametrize("mof, message", WRONG_INPUT.values(), ids=WRONG_INPUT.keys())
def test_wrong_mof_is_refused_and_leaves_the_output_alone(project, mof, message):
    project.generate(CIM_A)
    before = project.contents()
    assert message in project.generate(mof)
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

    project.generate(classes)
    assert project.contents().keys() == first.keys()


def test_defaults_and_documentation_are_written_as_literals(project):
    project.generate(r'''
        [Description("Says \"what?\" in caf\x00E9s.")]
        class CIM_A
        {
            string   S = "a\"b\\c\n??/";
            uint64   Large = 18446744073709551615;
            sint64   Small = -9223372036854775808;
            real32   R = 1.5;
            boolean  B = false;
            datetime D = "00000000000500.000000:000";
            uint16   Codes[] = {1, 65535};
            string   Texts[] = {"one", "two"};
        };''')
    source = (project.output / "schema/meta_data.cpp").read_text()
    for default in (
        r'char _CIM_A_S_default[] = "a\"b\\c\n\?\?/";',
        "uint64 _CIM_A_Large_default[] = {18446744073709551615u};",
        "sint64 _CIM_A_Small_default[] = {-9223372036854775807 - 1};",
        "real32 _CIM_A_R_default[] = {1.5f};",
        "boolean _CIM_A_B_default[] = {false};",
        'char _CIM_A_D_default[] = "00000000000500.000000:000";',
        "uint16 _CIM_A_Codes_default[] = {1, 65535};",
        "Meta_Value _CIM_A_Codes_value = {_CIM_A_Codes_default, 2};",
        'char* const _CIM_A_Texts_default[] = {"one", "two"};',
    ):
        assert default in source
    qualifiers = (project.output / "cimserver/qualifier_table.cpp").read_text()
    assert r'"Says \"what\?\" in caf\303\251s."' in qualifiers
