"""The module's associations: every traversal, from both ends and with every filter, agrees with the enumeration of the class."""

import pytest
from pywbem import CIMInstanceName

from tools.inventory_text import served_classes

TAPES = {"adapters": [{"kind": "fc-hba", "ports": [{}, {"remote_ports": [{"luns": {"type": "tape", "count": 2}}]}]}]}
SCENARIOS = ["cna", "fc-hba", "mixed", "odd", TAPES]

# The association classes that have nothing to join: while no test and no agent runs, without units, without a network.
IDLE = "RemoteServiceHostedAccessPoint OwningJobElement AffectedJobElement ServiceRecordAppliesToElement CompletionRecordAppliesToElement"
UNITS = " StorageResourcesSystemDevice SCSIInitiatorTargetLogicalUnitPath"
NETWORK = " EthernetPortSystemDevice EthernetPortControlledBy AvailableDiagnosticServiceForEthernetPort HostedDependency"
NETWORK += " EthernetPortRealizes LANEndpointDeviceSAPImplementation HostedLANEndpoint"
WITHOUT = {"cna": IDLE + UNITS, "fc-hba": IDLE + UNITS + NETWORK, "mixed": IDLE, "odd": IDLE, "tapes": IDLE + NETWORK}


class Associations:
    """All associations of one class, and what traversals must make of them."""

    def __init__(self, client, class_name):
        self.client = client
        self.name = class_name
        self.all = client.EnumerateInstances(class_name)

    @property
    def roles(self):
        return [name for name, value in self.all[0].items() if isinstance(value, CIMInstanceName)] if self.all else []

    def sources(self, role):
        """A source with associations: of those that fill the role the one in the middle."""
        found = unique(association[role] for association in self.all)
        return found[len(found) // 2]

    def references(self, source, role=None):
        def concerns(association):
            return any(association[name] == source and role in (None, name) for name in self.roles)

        return list({association.path: association for association in filter(concerns, self.all)}.values())

    def far_ends(self, source, role=None, result_role=None, result_class=None):
        classes = subclasses(self.client, result_class)
        return unique(
            association[name]
            for association in self.references(source, role)
            for name in self.roles
            if association[name] != source and result_role in (None, name) and (not classes or association[name].classname in classes)
        )


CLASSES = {None: None}  # by class: itself and its subclasses, the same on every host


def subclasses(client, class_name):
    if class_name not in CLASSES:
        CLASSES[class_name] = [class_name] + client.EnumerateClassNames(ClassName=class_name, DeepInheritance=True)
    return CLASSES[class_name]


def unique(paths):
    return list(dict.fromkeys(paths))


def is_association(client, class_name):
    return "Association" in client.GetClass(class_name, LocalOnly=False, IncludeQualifiers=True).qualifiers


def without_host(paths):
    return [CIMInstanceName(path.classname, path.keybindings, namespace=path.namespace) for path in paths]


def check_associators(associations, source, filters):
    names = associations.client.AssociatorNames(source, AssocClass=associations.name, **{as_word(k): v for k, v in filters.items()})
    assert without_host(names) == associations.far_ends(source, **filters), (associations.name, source, filters)


def as_word(name):
    return "".join(part.capitalize() for part in name.split("_"))


def check_role(associations, role, every):
    client, source = associations.client, associations.sources(role)
    others = [name for name in associations.roles if name != role]
    far = associations.far_ends(source)
    for filters in [{}, {"role": role}, {"role": others[0]}, {"result_role": others[-1]}, {"result_role": role}]:
        check_associators(associations, source, filters)
    parent = client.GetClass(far[0].classname).superclass
    for result_class in [far[0].classname, parent, "CIM_ManagedElement", "ZEMLAR_LogicalDisk"]:
        check_associators(associations, source, {"result_class": result_class})

    superclass = client.GetClass(associations.name).superclass
    named = [other for other in every if other.name in subclasses(client, superclass)]
    by_superclass = client.AssociatorNames(source, AssocClass=superclass)
    assert set(without_host(by_superclass)) == {end for other in named for end in other.far_ends(source)}
    for instance in client.Associators(source, AssocClass=associations.name, Role=role)[:3]:
        assert dict(instance) == dict(client.GetInstance(instance.path))

    for asked in [None, role, others[0]]:
        expected = associations.references(source, asked)
        names = client.ReferenceNames(source, ResultClass=associations.name, Role=asked)
        assert without_host(names) == [association.path for association in expected]
    whole = client.References(source, ResultClass=associations.name, Role=role)
    assert [dict(association) for association in whole] == [dict(association) for association in associations.references(source, role)]


@pytest.mark.parametrize("scenario", SCENARIOS, ids=lambda scenario: scenario if isinstance(scenario, str) else "tapes")
def test_traversals_agree_with_the_enumeration(start, scenario):
    client = start(scenario).pywbem
    every = [Associations(client, class_name) for class_name in served_classes() if is_association(client, class_name)]
    name = scenario if isinstance(scenario, str) else "tapes"
    assert {associations.name[7:] for associations in every if not associations.all} == set(WITHOUT[name].split())
    for associations in every:
        for role in associations.roles:
            check_role(associations, role, every)


def test_tapes_come_without_disks(start):
    client = start(TAPES).pywbem
    (host,) = client.EnumerateInstanceNames("ZEMLAR_ComputerSystem")
    assert client.EnumerateInstanceNames("ZEMLAR_StorageExtent") == []
    tapes = client.EnumerateInstanceNames("ZEMLAR_TapeDrive")
    resources = client.EnumerateInstances("ZEMLAR_StorageResourcesSystemDevice")
    assert [(found["GroupComponent"], found["PartComponent"]) for found in resources] == [(host, tape) for tape in tapes]
    paths = client.EnumerateInstances("ZEMLAR_SCSIInitiatorTargetLogicalUnitPath")
    ends = [(tape["DeviceID"].split("_")[0], "_".join(tape["DeviceID"].split("_")[:2]), tape) for tape in tapes]
    assert [(path["Initiator"]["Name"], path["Target"]["Name"], path["LogicalUnit"]) for path in paths] == ends
    assert len(tapes) == 2
