"""The interop name space: how a client that knows nothing finds the server, its name spaces and its profiles."""

import socket

import pytest
import pywbem
from conftest import code_of
from pywbem import CIMInstance, CIMInstanceName

INTEROP = "root/PG_InterOp"
OWN = {"CIM_ManagedElement", "CIM_ObjectManager", "CIM_Namespace", "CIM_IndicationFilter", "CIM_IndicationSubscription"}


@pytest.fixture(scope="module")
def interop(mixed):
    return pywbem.WBEMConnection(mixed.server.url, default_namespace=INTEROP, timeout=60)


def test_the_server_describes_itself(mixed, interop):
    server = pywbem.WBEMServer(mixed.pywbem)
    assert server.interop_ns == "interop"
    assert sorted(server.namespaces) == ["interop", INTEROP, "root/interop", "root/zemlar"]
    assert server.brand == "zmlr-cimserver"
    assert server.version and server.version[0].isdigit()
    assert server.cimom_inst["SystemName"] == socket.gethostname()
    assert server.cimom_inst["OperationalStatus"] == [2]
    assert len(server.profiles) == 15


def test_the_object_manager_has_the_names_that_the_server_gives_itself(mixed, interop):
    own = interop.EnumerateInstances("CIM_ObjectManager")[0]
    manager = mixed.pywbem.EnumerateInstances("ZEMLAR_ObjectManager")[0]
    names = [manager[name] for name in ("Name", "Caption", "Description")]
    assert names == [own[name] for name in ("Name", "ElementName", "Description")]
    space = mixed.pywbem.EnumerateInstances("ZEMLAR_Namespace")[0]
    assert (space["ObjectManagerName"], space["Name"]) == (own["Name"], "root/zemlar")


@pytest.mark.parametrize("name", ["interop", "root/interop", "ROOT/PG_INTEROP"])
def test_the_interop_name_space_has_the_names_that_clients_try(interop, name):
    assert [dict(manager) for manager in interop.EnumerateInstances("CIM_ObjectManager", name)] == [
        dict(manager) for manager in interop.EnumerateInstances("CIM_ObjectManager")
    ]


def test_only_the_servers_own_object_manager_is_there(interop):
    managers = interop.EnumerateInstances("CIM_ObjectManager")
    assert [manager.classname for manager in managers] == ["CIM_ObjectManager"]
    assert interop.GetInstance(managers[0].path)["ElementName"] == "zmlr-cimserver"
    assert [space.classname for space in interop.EnumerateInstanceNames("cim_namespace")] == ["CIM_Namespace"] * 4
    assert code_of(interop.EnumerateInstanceNames, "ZEMLAR_ObjectManager") == pywbem.CIM_ERR_INVALID_CLASS


def test_classes_of_both_parts_make_one_tree(interop):
    names = interop.EnumerateClassNames(DeepInheritance=True)
    assert len(names) == len(set(names))
    assert OWN | {"ZEMLAR_RegisteredProfile", "ZEMLAR_ElementConformsToProfile"} <= set(names)
    assert "ZEMLAR_FCPort" not in names
    assert "CIM_ManagedElement" in interop.EnumerateClassNames()
    below = interop.EnumerateClassNames(ClassName="CIM_ManagedElement", DeepInheritance=True)
    assert {"CIM_ObjectManager", "CIM_RegisteredProfile", "ZEMLAR_RegisteredProfile"} <= set(below)
    assert interop.EnumerateClassNames(ClassName="CIM_ListenerDestination") == ["CIM_ListenerDestinationCIMXML"]
    organization = interop.GetClass("CIM_RegisteredProfile", LocalOnly=False).properties["RegisteredOrganization"]
    assert dict(zip(organization.qualifiers["ValueMap"].value, organization.qualifiers["Values"].value))["11"] == "SNIA"
    subscription = interop.GetClass("CIM_IndicationSubscription")
    assert subscription.qualifiers["Association"].value is True
    assert subscription.properties["Handler"].reference_class == "CIM_ListenerDestination"


def test_superclasses_enumerate_both_parts(interop):
    found = {instance.classname for instance in interop.EnumerateInstances("CIM_ManagedElement")}
    assert {"CIM_ObjectManager", "CIM_Namespace"} <= found
    shallow = interop.EnumerateInstances("CIM_ManagedElement", DeepInheritance=False)
    assert {name for instance in shallow for name in instance.keys()} <= {"InstanceID", "Caption", "Description", "ElementName"}
    one = interop.EnumerateInstances("CIM_Namespace", PropertyList=["name"])[0]
    assert dict(one) == {"Name": INTEROP}


@pytest.mark.parametrize(
    "call,code",
    [
        (lambda c: c.CreateInstance(CIMInstance("CIM_ObjectManager", {"Name": "x"})), 7),
        (lambda c: c.CreateInstance(CIMInstance("CIM_ManagedElement", {})), 7),
        (lambda c: c.DeleteInstance(c.EnumerateInstanceNames("CIM_Namespace")[0]), 7),
        (lambda c: c.GetInstance(CIMInstanceName("CIM_Namespace", {"Name": "root/zemlar"})), 4),
        (lambda c: c.ModifyInstance(CIMInstance("CIM_Namespace", path=c.EnumerateInstanceNames("CIM_Namespace")[0])), 7),
        (lambda c: c.InvokeMethod("Explode", "CIM_ObjectManager"), 17),
        (lambda c: c.ExecQuery("WQL", "SELECT * FROM CIM_Namespace"), 7),
        (lambda c: c.AssociatorNames(c.EnumerateInstanceNames("CIM_Namespace")[0], AssocClass="CIM_Nothing"), 4),
    ],
)
def test_errors(interop, call, code):
    assert code_of(call, interop) == code


def test_wbemcli_sees_the_object_manager(mixed):
    wbemcli = type(mixed.wbemcli)(mixed.server.port, INTEROP)
    assert wbemcli.enumerate_instances("CIM_ObjectManager")[0]["ElementName"] == "zmlr-cimserver"
