"""What wbemcli and pywbem see of the mixed host through every operation that is served."""

from pathlib import Path

import pytest
import pywbem
from conftest import NAME_SPACE, code_of, without_id
from pywbem import CIMInstance, CIMInstanceName

CLASS = Path(__file__).with_name("class.xml").read_text(encoding="utf-8")
FC_PORT_KEYS = ["SystemCreationClassName", "SystemName", "CreationClassName", "DeviceID"]


def test_class_names(mixed):
    everything = mixed.pywbem.EnumerateClassNames(DeepInheritance=True)
    assert len(everything) == len(set(everything)) == 177
    assert sum(name.startswith("ZEMLAR_") for name in everything) == 76
    assert mixed.wbemcli.enumerate_class_names() == everything, "wbemcli asks for the whole tree"

    roots = mixed.pywbem.EnumerateClassNames()
    assert len(roots) == 14
    assert not [name for name in roots if name.startswith("ZEMLAR_")], "only the roots of the tree stand at the top"
    assert mixed.pywbem.EnumerateClassNames(ClassName="CIM_FCPort") == ["ZEMLAR_FCPort"]
    assert mixed.pywbem.EnumerateClassNames(ClassName="ZEMLAR_FCPort", DeepInheritance=True) == []


def test_classes(mixed):
    tops = mixed.pywbem.EnumerateClasses()
    assert all(top.superclass is None for top in tops)
    everything = mixed.pywbem.EnumerateClasses(DeepInheritance=True, LocalOnly=False)
    assert len(everything) == 177

    port = mixed.pywbem.GetClass("zemlar_fcport", LocalOnly=False, IncludeClassOrigin=True)
    assert port.classname == "ZEMLAR_FCPort"
    assert port.superclass == "CIM_FCPort"
    assert [name for name, prop in port.properties.items() if "Key" in prop.qualifiers] == FC_PORT_KEYS
    assert port.properties["DeviceID"].class_origin == "CIM_LogicalDevice"
    assert port.properties["Speed"].type == "uint64"
    assert port.properties["OperationalStatus"].is_array
    assert port.properties["EnabledDefault"].value == 2
    status = port.properties["OperationalStatus"].qualifiers
    meaning = dict(zip(status["ValueMap"].value, status["Values"].value))
    assert meaning["11"] == "In Service"
    assert dict(zip(*(port.properties["PortType"].qualifiers[name].value for name in ("ValueMap", "Values"))))["10"] == "N"
    assert port.properties["AllocationState"].embedded_object == "instance"
    change = port.methods["RequestStateChange"]
    assert change.return_type == "uint32"
    assert change.parameters["Job"].reference_class == "CIM_ConcreteJob"

    run = mixed.pywbem.GetClass("CIM_DiagnosticService").methods["RunDiagnosticService"]
    assert run.parameters["JobSettings"].qualifiers["EmbeddedInstance"].value == "CIM_JobSettingData"

    local = mixed.pywbem.GetClass("ZEMLAR_PhysicalPackage", LocalOnly=True)
    assert list(local.properties) == ["FRUNumber"]
    assert mixed.pywbem.GetClass("ZEMLAR_PhysicalPackage").properties.keys() == local.properties.keys(), "local by default"
    chosen = mixed.pywbem.GetClass("ZEMLAR_FCPort", LocalOnly=False, IncludeQualifiers=False, PropertyList=["speed"])
    assert [prop.name for prop in chosen.properties.values()] == ["Speed"]
    assert not chosen.qualifiers and not chosen.properties["Speed"].qualifiers
    association = mixed.pywbem.GetClass("ZEMLAR_FCPortSystemDevice", LocalOnly=False)
    assert association.qualifiers["Association"].value is True
    assert association.properties["PartComponent"].reference_class == "ZEMLAR_FCPort"
    printed = [line[1:].rstrip("=") for line in mixed.wbemcli.get_class("ZEMLAR_FCPort") if line.startswith("-")]
    assert printed == list(port.properties)


def test_a_class_is_written_for_the_strictest_reader(tst):
    tst.pywbem.GetClass("tst_labels", IncludeClassOrigin=True)
    assert without_id(tst.pywbem.last_raw_reply.decode()) == CLASS
    item = tst.pywbem.GetClass("TST_Item", LocalOnly=False)
    assert (item.properties["Weight"].value, item.properties["Name"].propagated) == (1, True)
    box = tst.pywbem.GetClass("TST_Box")
    elements = box.methods["EchoObjects"].parameters["Elements"]
    assert (elements.type, elements.is_array, elements.reference_class) == ("reference", True, "TST_Element")
    assert elements.qualifiers["Out"].value is True
    join = box.methods["Join"]
    assert join.qualifiers["Static"].value is True
    assert (join.return_type, join.parameters["Parts"].is_array, list(join.parameters["Parts"].qualifiers)) == ("string", True, ["In"])


def as_wbemcli_prints(value):
    if value is None:
        return ""
    if isinstance(value, list):
        return ",".join(as_wbemcli_prints(element) for element in value)
    return str(value).upper() if isinstance(value, bool) else str(value)


@pytest.mark.parametrize("class_name", ["ZEMLAR_ComputerSystem", "ZEMLAR_PortController", "ZEMLAR_FCPort"])
def test_both_clients_see_the_same_instances(mixed, class_name):
    seen = mixed.pywbem.EnumerateInstances(class_name)
    other = mixed.wbemcli.enumerate_instances(class_name)
    assert len(seen) == len(other) > 0
    for instance, printed in zip(seen, other):
        del printed["__path"]
        assert printed == {name: as_wbemcli_prints(value) for name, value in instance.items()}
    assert len(mixed.wbemcli.enumerate_instance_names(class_name)) == len(seen)
    for path, instance in zip(mixed.wbemcli.enumerate_instance_names(class_name), seen):
        assert mixed.wbemcli.get_instance(path)["ElementName"] == instance["ElementName"]


def test_property_lists(mixed):
    some = mixed.pywbem.EnumerateInstances("ZEMLAR_FCPort", PropertyList=["speed", "PortNumber", "NoSuchProperty"])
    assert all({name.lower() for name in port.keys()} == {"speed", "portnumber"} for port in some)
    assert all(port.path["DeviceID"] for port in some), "paths carry the keys whatever was asked for"
    one = mixed.pywbem.GetInstance(some[0].path, PropertyList=["DeviceID"])
    assert dict(one) == {"DeviceID": some[0].path["DeviceID"]}
    none = mixed.pywbem.GetInstance(some[0].path, PropertyList=[])
    assert dict(none) == {}
    printed = mixed.wbemcli.get_instance(mixed.wbemcli.enumerate_instance_names("ZEMLAR_FCPort")[0], "Speed")
    assert set(printed) - {"__path"} == {"Speed"}


def test_superclass_is_the_union_of_its_served_subclasses(mixed):
    ports = {port["DeviceID"] for port in mixed.pywbem.EnumerateInstances("ZEMLAR_FCPort")}
    assert {port["DeviceID"] for port in mixed.pywbem.EnumerateInstances("CIM_FCPort")} == ports
    devices = mixed.pywbem.EnumerateInstances("CIM_LogicalDevice")
    assert {"ZEMLAR_FCPort", "ZEMLAR_PortController"} <= {device.classname for device in devices}
    assert len({str(device.path) for device in devices}) == len(devices)
    named = mixed.pywbem.EnumerateInstanceNames("CIM_LogicalDevice")
    assert [path["DeviceID"] for path in named] == [device["DeviceID"] for device in devices]
    shallow = mixed.pywbem.EnumerateInstances("CIM_LogicalDevice", DeepInheritance=False)
    assert all("PortNumber" not in device for device in shallow)


def test_what_two_providers_have_is_there_once(tst):
    assert [path.classname for path in tst.pywbem.EnumerateInstanceNames("TST_Keyed")] == ["TST_Box"]
    names = tst.pywbem.EnumerateInstanceNames("tst_element")
    for found in (names, [instance.path for instance in tst.pywbem.EnumerateInstances("TST_Element")]):
        assert len(found) == len(set(found)) and {"red", "bolt"} <= {path["Name"] for path in found}
    assert tst.pywbem.EnumerateInstances("TST_Alert") == tst.pywbem.EnumerateInstances("TST_Pair") == [], "nobody serves these"


# A key of every kind: as values of its type, as texts of it, and what is neither.
KEYS = {"Name": "x", "Left": CIMInstanceName("tst_box", {"Name": "red"}), "Flag": True, "Count": pywbem.Uint8(255), "Mark": "m"}
KEYS |= {"Offset": pywbem.Sint8(-128), "Ratio": pywbem.Real64(-25.0), "when": "00000001000000.000000:000"}
TEXTS = {"Flag": "True", "Count": "255", "Offset": "-128", "Ratio": "-2.5e1"}
REACHED = (
    'TST_Keyed.Name="x",Left="TST_Box.Name=\\"red\\"",Flag=true,Count=255,Offset=-128,Mark=\'m\',Ratio=-25.000000,'
    "When=00000001000000.000000:000"
)
DEEP = KEYS["Left"]
for _ in range(7):
    DEEP = CIMInstanceName("TST_Keyed", {**KEYS, "Left": DEEP})
NO_KEYS = [("Flag", 1), ("Count", "0x100"), ("Count", -1), ("Mark", "\u20ac\u20ac"), ("Ratio", "inf"), ("Left", 'TST_Box.Name="red"')]
NO_KEYS += [("Left", CIMInstanceName(*target)) for target in [("TST_Nothing", {"Name": "red"}), ("TST_Alert", {"Text": "x"}), ("TST_Box", {"Caption": "x"})]]


def test_keys_of_every_kind_reach_the_provider_or_are_refused(tst):
    for keys in (KEYS, {**KEYS, **TEXTS}):
        assert tst.pywbem.GetInstance(CIMInstanceName("TST_Keyed", keys))["Path"] == REACHED
    for name, value in [*NO_KEYS, ("Left", DEEP)]:
        with pytest.raises(pywbem.CIMError) as caught:
            tst.pywbem.GetInstance(CIMInstanceName("TST_Keyed", {**KEYS, name: value}))
        assert caught.value.status_code == 4 and "key" in caught.value.status_description, (name, value)


def test_class_origins_are_told_when_asked_for(mixed):
    for asked, origin in [(True, "CIM_LogicalDevice"), (False, None)]:
        ports = mixed.pywbem.EnumerateInstances("ZEMLAR_FCPort", LocalOnly=True, IncludeClassOrigin=asked)
        assert {port.properties["DeviceID"].class_origin for port in ports} == {origin}


def test_qualifiers(mixed):
    declared = {qualifier.name: qualifier for qualifier in mixed.pywbem.EnumerateQualifiers()}
    used = {name for cls in mixed.pywbem.EnumerateClasses(DeepInheritance=True, LocalOnly=False) for name in cls.qualifiers}
    assert used <= declared.keys() and {"Key", "Override", "Values", "EmbeddedInstance"} <= declared.keys()
    key = mixed.pywbem.GetQualifier("key")
    assert (key.name, key.type, key.value, key.overridable, key.scopes["REFERENCE"]) == ("Key", "boolean", False, False, True)
    assert mixed.pywbem.GetQualifier("ValueMap").is_array
    assert code_of(mixed.pywbem.GetQualifier, "Colour") == 6
    assert code_of(mixed.pywbem.EnumerateQualifiers, "root/nowhere") == 3
    assert code_of(mixed.pywbem.DeleteQualifier, "Key") == 7


def test_errors_are_sentences(mixed, tst):
    port = mixed.pywbem.EnumerateInstanceNames("ZEMLAR_FCPort")[0]
    for call, told in [
        (lambda: mixed.pywbem.InvokeMethod("RequestStateChange", port), "ZEMLAR_FCPort does not support RequestStateChange"),
        (lambda: tst.pywbem.GetInstance(CIMInstanceName("TST_Refusal", {"Name": "63"})), "TST_Refusal: GetInstance: access denied"),
        (lambda: tst.pywbem.GetInstance(CIMInstanceName("TST_Refusal", {"Name": "64"})), "TST_Refusal: GetInstance failed"),
        (lambda: tst.pywbem.EnumerateInstances("TST_Part"), "TST_Broken: EnumerateInstances: access denied"),
        (lambda: tst.pywbem.EnumerateInstanceNames("TST_Broken"), "TST_Broken: EnumerateInstanceNames: access denied"),
        (lambda: mixed.pywbem.GetInstance(CIMInstanceName("CIM_FCPort", GOOD)), f"there is no instance root/zemlar:CIM_FCPort.{GOOD_TEXT}"),
    ]:
        with pytest.raises(pywbem.CIMError) as caught:
            call()
        assert caught.value.status_description == told


GOOD = dict(zip(FC_PORT_KEYS, ["ZEMLAR_ComputerSystem", "nowhere", "ZEMLAR_FCPort", "0000000000000000"]))
GOOD_TEXT = ",".join(f'{name}="{value}"' for name, value in GOOD.items())


def port(**keys):
    return CIMInstanceName("ZEMLAR_FCPort", {**GOOD, **keys})


@pytest.mark.parametrize(
    "call,code",
    [
        (lambda c: c.EnumerateInstances("ZEMLAR_Nothing"), 5),
        (lambda c: c.EnumerateClassNames(ClassName="CIM_Nothing"), 5),
        (lambda c: c.GetClass("CIM_Nothing"), 6),
        (lambda c: c.EnumerateInstances("ZEMLAR_FCPort", "root/nowhere"), 3),
        (lambda c: c.GetInstance(port()), 6),
        (lambda c: c.GetInstance(CIMInstanceName("ZEMLAR_FCPort", {"DeviceID": "1"})), 4),
        (lambda c: c.GetInstance(CIMInstanceName("CIM_FCPort", {"DeviceID": "1"})), 4),
        (lambda c: c.GetInstance(port(X="1")), 4),
        (lambda c: c.GetInstance(port(DeviceID=True)), 4),
        (lambda c: c.InvokeMethod("Explode", port()), 17),
        (lambda c: c.DeleteInstance(port()), 7),
        (lambda c: c.ModifyInstance(CIMInstance("ZEMLAR_FCPort", {"Caption": "x"}, path=port())), 7),
        (lambda c: c.OpenEnumerateInstances("ZEMLAR_FCPort"), 7),
        (lambda c: c.PullInstances(("1", NAME_SPACE), 1), 7),
        (lambda c: c.CreateClass(pywbem.CIMClass("TST_New")), 7),
    ],
)
def test_errors(mixed, call, code):
    assert code_of(call, mixed.pywbem) == code
