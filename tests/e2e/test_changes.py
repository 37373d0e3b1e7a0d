"""Instances that clients make, change and delete, property by property, on the tests' module."""

from datetime import datetime, timedelta

import pytest
import pywbem
from conftest import code_of
from pywbem import CIMDateTime, CIMInstance, CIMInstanceName, CIMProperty

# property, type, values that have to come back as they are; None: null
SCALAR_VALUES = [
    ("BooleanValue", "boolean", [True, False, None]),
    ("Uint8Value", "uint8", [0, 255]),
    ("Sint8Value", "sint8", [-128, 127]),
    ("Uint16Value", "uint16", [0, 65535]),
    ("Sint16Value", "sint16", [-32768, 32767]),
    ("Uint32Value", "uint32", [0, 2**32 - 1, None]),
    ("Sint32Value", "sint32", [-(2**31), 2**31 - 1]),
    ("Uint64Value", "uint64", [0, 2**64 - 1]),
    ("Sint64Value", "sint64", [-(2**63), 2**63 - 1]),
    ("Real32Value", "real32", [0.0, -1.5, 3.4028235e38]),
    ("Real64Value", "real64", [0.0, 1.0 / 3, -1.7976931348623157e308, 5e-324]),
    ("Char16Value", "char16", ["a", "\u00e9", "\u20ac"]),
    ("Caption", "string", ["", "  ", "a\nb\tc", "<&>\"'", "\u00e9\u20ac\U0001f600", None]),
    (
        "DatetimeValue",
        "datetime",
        [CIMDateTime(datetime(2024, 2, 29, 23, 59, 59, 999999)), CIMDateTime(timedelta(days=99999999, seconds=86399)), None],
    ),
]
VALUES = SCALAR_VALUES + [
    ("StringValues", "string", [[], ["", " x "], ["<&>"] * 100, None]),
    ("Uint8Values", "uint8", [[], [0, 255], None]),
    ("DatetimeValues", "datetime", [[CIMDateTime(timedelta(0))]]),
]


@pytest.fixture
def green(tst):
    """The path of a box that is there for one test."""
    path = tst.pywbem.CreateInstance(CIMInstance("TST_Box", {"Name": "green", "Uint8Value": pywbem.Uint8(7)}))
    yield path
    try:
        tst.pywbem.DeleteInstance(path)
    except pywbem.CIMError as error:
        assert error.status_code == pywbem.CIM_ERR_NOT_FOUND


def changed(path, name, value, cim_type):
    is_array = isinstance(value, list) or name.endswith("s")
    instance = CIMInstance(path.classname, [CIMProperty(name, value, type=cim_type, is_array=is_array)])
    instance.path = path
    return instance


def test_life_of_a_box(tst):
    path = tst.pywbem.CreateInstance(CIMInstance("tst_box", {"name": "green", "Caption": "g"}))
    assert (path.classname, path["Name"], path.namespace) == ("TST_Box", "green", "root/zemlar")
    assert tst.pywbem.GetInstance(path)["Caption"] == "g"
    assert "green" in [name["Name"] for name in tst.pywbem.EnumerateInstanceNames("TST_Element")]
    assert code_of(tst.pywbem.CreateInstance, CIMInstance("TST_Box", {"Name": "green"})) == pywbem.CIM_ERR_ALREADY_EXISTS
    tst.pywbem.DeleteInstance(CIMInstanceName("TST_Element", {"Name": "green"}))
    assert code_of(tst.pywbem.DeleteInstance, path) == pywbem.CIM_ERR_NOT_FOUND


@pytest.mark.parametrize("name,cim_type,values", VALUES, ids=[row[0] for row in VALUES])
def test_every_value_survives(tst, green, name, cim_type, values):
    for value in values:
        tst.pywbem.ModifyInstance(changed(green, name, value, cim_type))
        box = tst.pywbem.GetInstance(green)
        assert box[name] == value
        assert name == "Uint8Value" or box["Uint8Value"] == 7, "what was not sent stays"


def test_property_lists_limit_changes(tst, green):
    instance = CIMInstance("TST_Box", {"Caption": "new", "Uint8Value": pywbem.Uint8(8)}, path=green)
    tst.pywbem.ModifyInstance(instance, PropertyList=["caption", "Uint16Value"])
    box = tst.pywbem.GetInstance(green)
    assert (box["Caption"], box["Uint8Value"]) == ("new", 7)
    tst.pywbem.ModifyInstance(instance, PropertyList=[])
    assert tst.pywbem.GetInstance(green)["Uint8Value"] == 7


def test_an_embedded_instance_is_a_text_of_its_own(tst, green):
    item = CIMInstance("TST_Item", {"Name": '<"&">'})
    tst.pywbem.ModifyInstance(changed(green, "Inside", item, "string"))
    text = tst.pywbem.GetInstance(green)["Inside"]
    assert text == item.tocimxmlstr()


def test_wbemcli_changes_too(tst, green):
    target = "TST_Box.Name=green"
    tst.wbemcli.run("mi", target, "Caption=mine,Uint8Value=255")
    assert tst.wbemcli.run("gp", target, "Caption") == ["mine"]
    tst.wbemcli.run("sp", target, "Uint8Value=9")
    assert tst.pywbem.GetInstance(green)["Uint8Value"] == 9
    tst.wbemcli.run("di", target)
    assert tst.wbemcli.run("ci", "TST_Box.Name=violet", "Name=violet,Caption=v")[0].endswith('TST_Box.Name="violet"')
    tst.wbemcli.run("di", "TST_Box.Name=violet")


# operation, {provider status: CIM status}; the refusal's name is the status
STATUSES = [
    ("get", {60: 6, 61: 6, 62: 4, 63: 2, 64: 1}),
    ("create", {80: 11, 81: 7, 82: 4, 83: 2, 84: 1}),
    ("delete", {90: 6, 91: 7, 92: 2, 93: 1}),
    ("modify", {100: 6, 101: 7, 102: 4, 103: 2, 104: 1}),
]


@pytest.mark.parametrize("operation,statuses", STATUSES, ids=[row[0] for row in STATUSES])
def test_a_providers_refusal_keeps_its_code(tst, operation, statuses):
    for status, code in statuses.items():
        path = CIMInstanceName("TST_Refusal", {"Name": str(status)})
        calls = {
            "get": lambda: tst.pywbem.GetInstance(path),
            "create": lambda: tst.pywbem.CreateInstance(CIMInstance("TST_Refusal", {"Name": path["Name"]})),
            "delete": lambda: tst.pywbem.DeleteInstance(path),
            "modify": lambda: tst.pywbem.ModifyInstance(CIMInstance("TST_Refusal", {"Caption": "x"}, path=path)),
        }
        assert code_of(calls[operation]) == code, status


def wrong(**properties):
    return lambda c, path: c.ModifyInstance(CIMInstance("TST_Box", properties, path=path))


ERRORS = [
    ("a method for a property", wrong(Join="x"), 12),
    ("another key", lambda c, p: c.ModifyInstance(changed(p, "Name", "violet", "string")), 4),
    ("unknown property", wrong(Colour="red"), 12),
    ("unknown property in the list", lambda c, p: c.ModifyInstance(CIMInstance("TST_Box", path=p), PropertyList=["Colour"]), 12),
    ("text for a number", wrong(Uint8Value="seven"), 4),
    ("too large", wrong(Uint8Value=pywbem.Uint16(256)), 4),
    ("negative", wrong(Uint64Value=pywbem.Sint8(-1)), 4),
    ("beyond real32", wrong(Real32Value=pywbem.Real64(1e300)), 4),
    ("no datetime", wrong(DatetimeValue="20240230000000.000000+000"), 4),
    ("two characters", wrong(Char16Value="ab"), 4),
    ("array for a scalar", wrong(Caption=["a"]), 4),
    ("scalar for an array", wrong(StringValues="a"), 4),
    ("one bad element", wrong(Uint8Values=[pywbem.Uint16(1), pywbem.Uint16(256)]), 4),
    ("reference for a text", wrong(Caption=CIMInstanceName("TST_Item", {"Name": "bolt"})), 4),
    ("no such instance", lambda c, p: c.ModifyInstance(CIMInstance("TST_Box", path=CIMInstanceName("TST_Box", {"Name": "?"}))), 6),
    ("create: unknown property", lambda c, p: c.CreateInstance(CIMInstance("TST_Box", {"Colour": "red"})), 4),
    ("create: unknown class", lambda c, p: c.CreateInstance(CIMInstance("TST_Nothing")), 5),
    ("create: not served", lambda c, p: c.CreateInstance(CIMInstance("TST_Element", {"Name": "x"})), 7),
    ("create: unsupported", lambda c, p: c.CreateInstance(CIMInstance("TST_Item", {"Name": "x"})), 7),
    ("create: an indication", lambda c, p: c.CreateInstance(CIMInstance("TST_Alert", {"Text": "x"})), 7),
    ("query", lambda c, p: c.ExecQuery("WQL", "SELECT * FROM TST_Box"), 7),
]


@pytest.mark.parametrize("call,code", [pytest.param(*row[1:], id=row[0]) for row in ERRORS])
def test_errors(tst, green, call, code):
    assert code_of(call, tst.pywbem, green) == code
    assert tst.pywbem.GetInstance(green)["Uint8Value"] == 7
