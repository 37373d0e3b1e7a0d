"""Extrinsic methods of the tests' module: every kind of parameter, out and back, and what is refused."""

from datetime import timedelta

import pytest
import pywbem
from conftest import code_of
from pywbem import CIMDateTime, CIMInstance, CIMInstanceName, CIMParameter
from test_changes import SCALAR_VALUES

RED = CIMInstanceName("TST_Box", {"Name": "red"})
BOLT = CIMInstanceName("TST_Item", {"Name": ' two  "words" \\ and,more=<&> '})


def host_less(value):
    """References come back with the name space that they were given by the server."""
    if isinstance(value, list):
        return [host_less(element) for element in value]
    if isinstance(value, CIMInstanceName):
        return CIMInstanceName(value.classname, value.keybindings)
    return value


# What boxes keep as properties. Nulls and FALSE have tests of their own.
SCALARS = [
    (name, cim_type, [value for value in values if value is not None and value is not False])
    for name, cim_type, values in SCALAR_VALUES
]
ARRAYS = [
    ("BooleanValues", "boolean", [[True, True], []]),
    ("Uint8Values", "uint8", [[0, 255]]),
    ("Sint64Values", "sint64", [[-(2**63), 2**63 - 1]]),
    ("Real64Values", "real64", [[0.1, -0.0]]),
    ("Char16Values", "char16", [["a", "\u00e9"]]),
    ("StringValues", "string", [["", " ", "<&>"], ["x"] * 1000]),
    ("DatetimeValues", "datetime", [[CIMDateTime(timedelta(days=1))]]),
]
OBJECTS = [
    ("Element", "reference", [RED, BOLT]),
    ("Elements", "reference", [[RED, BOLT], []]),
    ("Item", "string", [CIMInstance("TST_Item", {"Name": "<&>"}).tocimxmlstr()]),
]
CASES = [("EchoScalars", *row) for row in SCALARS] + [("EchoArrays", *row) for row in ARRAYS]
CASES += [("EchoObjects", *row) for row in OBJECTS]


@pytest.mark.parametrize("method,name,cim_type,values", CASES, ids=[row[1] for row in CASES])
def test_arguments_come_back_as_they_were_sent(tst, method, name, cim_type, values):
    for value in values:
        parameter = CIMParameter(name, cim_type, value=value, is_array=isinstance(value, list))
        count, out = tst.pywbem.InvokeMethod(method, RED, [parameter])
        assert count == 1
        assert {key: host_less(result) for key, result in out.items()} == {name: value}


def test_all_arguments_at_once_and_none(tst):
    parameters = [CIMParameter(name, cim_type, value=values[0]) for name, cim_type, values in SCALARS]
    assert tst.pywbem.InvokeMethod("echoscalars", RED, parameters)[0] == len(SCALARS)
    assert tst.pywbem.InvokeMethod("EchoScalars", RED) == (0, {})
    nulls = [CIMParameter(name, cim_type, value=None) for name, cim_type, _ in SCALARS]
    assert tst.pywbem.InvokeMethod("EchoScalars", RED, nulls) == (0, {}), "null outputs are left out"


def test_false_comes_back_false(tst):
    # pywbem takes every boolean among the output parameters for true.
    tst.pywbem.InvokeMethod("EchoScalars", RED, [("BooleanValue", False)])
    assert '<PARAMVALUE NAME="BooleanValue" PARAMTYPE="boolean"><VALUE>false</VALUE>' in tst.pywbem.last_raw_reply.decode()


def test_static_method_and_a_text_returned(tst):
    parts = [("Parts", ["a", " ", "<b>"]), ("Separator", "&")]
    assert tst.pywbem.InvokeMethod("Join", "TST_Box", parts)[0] == "a& &<b>"
    assert tst.pywbem.InvokeMethod("Join", "TST_Box", [("Separator", "&")])[0] is None


def test_a_method_may_ask_the_server_in_turn(tst):
    assert tst.pywbem.InvokeMethod("CountItems", "TST_Box")[0] == len(tst.pywbem.EnumerateInstanceNames("TST_Item")) == 4


def test_a_superclass_names_the_object_too(tst):
    red = CIMInstanceName("TST_Element", {"Name": "red"})
    assert tst.pywbem.InvokeMethod("EchoScalars", red, [("Caption", "x")]) == (1, {"Caption": "x"})


def test_a_providers_refusal_keeps_its_code(tst):
    for status, code in {130: 1, 131: 7, 132: 2}.items():
        assert code_of(tst.pywbem.InvokeMethod, "Fail", RED, [("Status", pywbem.Uint32(status))]) == code
    assert tst.pywbem.InvokeMethod("Fail", RED, [("Status", pywbem.Uint32(0))]) == (None, {})


def test_wbemcli_calls_methods(tst):
    printed = tst.wbemcli.run("cm", "TST_Box.Name=red", "EchoScalars.Uint8Value=255,Caption=hello")
    assert any(line.rstrip().endswith("2") for line in printed), printed


ERRORS = [
    ("unknown method", RED, "Explode", [], 17),
    ("a property", RED, "Caption", [], 17),
    ("unknown class", CIMInstanceName("TST_Nothing", {"Name": "red"}), "Fail", [], 5),
    ("unknown parameter", RED, "Fail", [("Colour", "red")], 4),
    ("the return value", RED, "Fail", [("return_value", pywbem.Uint32(1))], 4),
    ("text for a number", RED, "Fail", [("Status", "many")], 4),
    ("too large", RED, "Fail", [("Status", pywbem.Uint64(2**32))], 4),
    ("twice", RED, "Fail", [("Status", pywbem.Uint32(0)), ("STATUS", pywbem.Uint32(0))], 4),
    ("array for a scalar", RED, "Fail", [("Status", [pywbem.Uint32(0)])], 4),
    ("reference to another class", RED, "EchoObjects", [("Element", CIMInstanceName("TST_Alert", {"Text": "x"}))], 4),
    ("reference without a key", RED, "EchoObjects", [("Element", CIMInstanceName("TST_Item", {"Caption": "x"}))], 4),
    ("text for a reference", RED, "EchoObjects", [("Element", "bolt")], 4),
    ("path without a key", CIMInstanceName("TST_Box", {"Caption": "red"}), "Fail", [], 4),
    ("static method of an instance", RED, "Join", [], 1),
    ("unserved class", "TST_Element", "Fail", [], 17),
]


@pytest.mark.parametrize("target,method,arguments,code", [pytest.param(*row[1:], id=row[0]) for row in ERRORS])
def test_errors(tst, target, method, arguments, code):
    assert code_of(tst.pywbem.InvokeMethod, method, target, arguments) == code
