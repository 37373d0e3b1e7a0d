"""Association traversal on the tests' module: which objects each filter finds, with both clients, and what is refused."""

import json
from pathlib import Path

import pytest
from conftest import code_of
from pywbem import CIMInstanceName

# What each filter finds: source, filter, the names; and for references the association with its container and content. The red
# box holds bolt and nut and is labelled with the bolt and the blue box, which holds the item with words and marks for a name.
FOUND = json.loads(Path(__file__).with_name("associations.json").read_text(encoding="utf-8"))


def box(name, class_name="TST_Box"):
    return CIMInstanceName(class_name, {"Name": name})


@pytest.mark.parametrize("source,filters,expected", FOUND["associated"])
def test_associators_find_the_union_once(tst, source, filters, expected):
    source = box(source[1], source[0])
    names = tst.pywbem.AssociatorNames(source, **filters)
    assert sorted(name["Name"] for name in names) == sorted(expected)
    assert all(name.namespace == "root/zemlar" and name.host for name in names)
    instances = tst.pywbem.Associators(source, **filters)
    assert sorted(map(str, names)) == sorted(str(instance.path) for instance in instances)
    for instance in instances:
        assert instance["Name"] == instance.path["Name"]
        again = tst.pywbem.GetInstance(instance.path)
        assert dict(again) == dict(instance)


@pytest.mark.parametrize("source,filters,expected", FOUND["references"])
def test_references_find_the_associations(tst, source, filters, expected):
    def triple(path):
        return [path.classname[4:], path["Container"]["Name"], path["Content"]["Name"]]

    source = box(source[1], source[0])
    assert sorted(map(triple, tst.pywbem.ReferenceNames(source, **filters))) == expected
    instances = tst.pywbem.References(source, **filters)
    assert sorted(triple(instance.path) for instance in instances) == expected
    for instance in instances:
        assert instance["Container"] == instance.path["Container"]
        assert instance["Container"].namespace == "root/zemlar"


def test_property_lists_shorten_objects_never_paths(tst):
    found = tst.pywbem.Associators(box("red"), AssocClass="TST_Holds", PropertyList=["weight", "Nothing"])
    assert [dict(instance) for instance in found] == [{"Weight": 1}, {"Weight": 1}]
    assert [instance.path["Name"] for instance in found] == ["bolt", "nut"]
    found = tst.pywbem.References(box("red"), ResultClass="TST_Holds", PropertyList=["Position"])
    assert [dict(instance) for instance in found] == [{"Position": 1}, {"Position": 2}]
    assert [instance.path["Content"]["Name"] for instance in found] == ["bolt", "nut"]
    origins = tst.pywbem.Associators(box("red"), AssocClass="TST_Holds", IncludeClassOrigin=True)[0]
    assert origins.properties["Name"].class_origin == "TST_Element"
    assert origins.properties["Weight"].class_origin == "TST_Item"


@pytest.mark.parametrize(
    "call,code",
    [
        (lambda c: c.Associators(box("red"), AssocClass="TST_Nothing"), 4),
        (lambda c: c.AssociatorNames(box("red"), ResultClass="TST_Nothing"), 4),
        (lambda c: c.References(box("red"), ResultClass="TST_Nothing"), 4),
        (lambda c: c.ReferenceNames(CIMInstanceName("TST_Nothing", {"Name": "red"})), 4),
        (lambda c: c.AssociatorNames(CIMInstanceName("TST_Box", {"Caption": "red"})), 4),
        (lambda c: c.AssociatorNames(CIMInstanceName("TST_Box", {"Name": "red", "Colour": "red"})), 4),
        (lambda c: c.Associators("TST_Box"), 7),
        (lambda c: c.ReferenceNames(CIMInstanceName("TST_Box", {"Name": "red"}, namespace="root/nowhere")), 3),
    ],
)
def test_errors(tst, call, code):
    assert code_of(call, tst.pywbem) == code


def test_what_does_not_exist_has_no_associations(mixed):
    for class_name in ("ZEMLAR_FCPort", "CIM_LogicalDevice"):
        port = mixed.pywbem.EnumerateInstanceNames("ZEMLAR_FCPort")[0]
        port.classname, port["DeviceID"] = class_name, "none"
        assert mixed.pywbem.AssociatorNames(port) == []


def test_wbemcli_walks_the_same_way(tst):
    red = "TST_Box.Name=red"
    assert len(tst.wbemcli.run("ain", red)) == 3
    assert len([line for line in tst.wbemcli.run("ai", red) if line.startswith("-Name")]) == 3
    assert len(tst.wbemcli.run("rin", red)) == 4
    assert sum(line.startswith("-Position") for line in tst.wbemcli.run("ri", red)) == 2
    assert len(tst.wbemcli.run("ain", red, "-ac", "TST_Link", "-arr", "Content", "-arc", "TST_Box")) == 1
