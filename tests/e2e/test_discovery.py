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


@pytest.fixture(scope="module")
def conforming(mixed):
    """What conforms to each profile, as a client that knows only the server's address finds it."""
    server = pywbem.WBEMServer(mixed.pywbem)
    organization = {2: "DMTF", 11: "SNIA"}
    found = {}
    for profile in server.profiles:
        words = (organization[profile["RegisteredOrganization"]], profile["RegisteredName"], profile["RegisteredVersion"])
        assert server.get_selected_profiles(*words) == [profile]
        found[profile["RegisteredName"]] = server.get_central_instances(profile.path)
    return found


def test_profiles_lead_to_what_conforms_to_them(mixed, interop, conforming):
    subprofiles = [profile["InstanceID"] for profile in mixed.pywbem.EnumerateInstances("ZEMLAR_RegisteredSubProfile")]
    told = {name: [(path.namespace, path.classname) for path in paths] for name, paths in conforming.items()}
    host = [("root/zemlar", "ZEMLAR_ComputerSystem")]
    assert told == {
        "SMI-S": [(INTEROP, "ZEMLAR_RegisteredSubProfile")] * 10,
        "Server": [("root/zemlar", "ZEMLAR_ObjectManager")],
        **dict.fromkeys(("FC HBA", "Host Discovered Resources", "Storage HBA"), host),
        **dict.fromkeys(subprofiles, []),
    }
    assert [path["InstanceID"] for path in conforming["SMI-S"]] == subprofiles
    for path in sum(conforming.values(), []):
        assert mixed.pywbem.GetInstance(path)
    further = {path.classname for path in mixed.pywbem.AssociatorNames(conforming["FC HBA"][0])}
    assert {"ZEMLAR_PortController", "ZEMLAR_FCPort", "ZEMLAR_StorageExtent", "ZEMLAR_CIMXMLCommunicationMechanism"} <= further
    for client in (interop, mixed.pywbem):
        one = client.EnumerateInstances("CIM_ElementConformsToProfile")[0]
        assert one["ConformantStandard"].namespace == client.default_namespace
        assert one["ManagedElement"].namespace == "root/zemlar"
        assert client.GetInstance(one.path) == one


def test_the_object_manager_has_the_names_that_the_server_gives_itself(mixed, interop, conforming):
    own = interop.EnumerateInstances("CIM_ObjectManager")[0]
    manager = mixed.pywbem.GetInstance(conforming["Server"][0])
    assert [manager[name] for name in ("Name", "Caption", "Description")] == [own[name] for name in ("Name", "ElementName", "Description")]
    (space,) = mixed.pywbem.Associators(conforming["Server"][0], AssocClass="CIM_NamespaceInManager")
    assert (space["ObjectManagerName"], space["Name"]) == (own["Name"], "root/zemlar")


@pytest.mark.parametrize(
    "filters,expected",
    [
        ({"AssocClass": "CIM_ElementConformsToProfile"}, ["ZEMLAR_ComputerSystem"]),
        ({"ResultClass": "CIM_ComputerSystem"}, ["ZEMLAR_ComputerSystem"]),
        ({"ResultClass": "ZEMLAR_ObjectManager"}, []),
        ({"AssocClass": "CIM_SubProfileRequiresProfile"}, ["ZEMLAR_RegisteredSubProfile"] * 8),
        ({"ResultClass": "CIM_SoftwareIdentity"}, ["ZEMLAR_ProfileSoftwareIdentity"]),
        ({"AssocClass": "ZEMLAR_PortControllerSystemDevice"}, []),
    ],
)
def test_a_profile_leads_on(mixed, interop, filters, expected):
    profile = CIMInstanceName("ZEMLAR_RegisteredProfile", {"InstanceID": "FC HBA"})
    names = interop.AssociatorNames(profile, **filters)
    assert [name.classname for name in names] == expected
    far = {"ZEMLAR_ComputerSystem": "root/zemlar"}
    assert all(name.namespace == far.get(name.classname, INTEROP) for name in names)
    assert [instance.path for instance in interop.Associators(profile, **filters)] == names
    for name in names:  # and back: from there, the profile lies in the name space of what is left
        back = CIMInstanceName("ZEMLAR_RegisteredProfile", {"InstanceID": "FC HBA"}, host=name.host, namespace=name.namespace)
        assert back in mixed.pywbem.AssociatorNames(name)


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
