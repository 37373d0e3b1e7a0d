"""The generated registrations against the table of providers, the schema and the module that was built."""

import configparser
import os
import pathlib
import re
import subprocess

import pytest
import pywbem

from conftest import ROOT

BUILD = pathlib.Path(os.environ.get("ZMLR_BUILD_DIR", ROOT / "build" / "dev"))
DATA = BUILD / "packaging" / "registration" / "data"
KINDS = {2: "Instance", 3: "Association", 4: "Indication", 5: "Method"}
ROWS = dict(re.findall(r"^ZMLR_PROVIDER\((\w+),\s*(\w+)", (ROOT / "providers" / "providers.def").read_text(), re.MULTILINE))
INTEROP = {"ZEMLAR_RegisteredProfile", "ZEMLAR_RegisteredSubProfile", "ZEMLAR_ProfileSoftwareIdentity",
           "ZEMLAR_ElementConformsToProfile", "ZEMLAR_SubProfileRequiresProfile", "ZEMLAR_ProfileElementSoftwareIdentity"}


@pytest.fixture(scope="module")
def server():
    """Both name spaces, as a strict MOF compiler makes them of what is installed."""
    connection = pywbem.MOFWBEMConnection()
    compiler = pywbem.MOFCompiler(connection, log_func=None)
    schema = [ROOT / "schema" / "qualifiers.mof", ROOT / "schema" / "cim.mof"]
    for file in (*schema, DATA / "mof" / "zemlar.mof"):
        compiler.compile_file(str(file), "root/zemlar")
    pegasus = [pathlib.Path(__file__).with_name("pg_classes.mof"), DATA / "registration" / "openpegasus.mof"]
    for file in (*schema, DATA / "mof" / "zemlar-interop.mof", *pegasus):
        compiler.compile_file(str(file), "root/PG_InterOp")
    return connection


@pytest.fixture(scope="module")
def capabilities(server):
    instances = [instance for instance in server.instances["root/PG_InterOp"] if instance.classname == "PG_ProviderCapabilities"]
    assert len(instances) == len(ROWS)
    return {instance["ClassName"]: instance for instance in instances}


def methods(classes, name):
    """Whether a class or one of its ancestors has a method."""
    return name is not None and (bool(classes[name].methods) or methods(classes, classes[name].superclass))


def test_every_class_is_registered_with_what_it_offers(server, capabilities):
    classes = server.classes["root/zemlar"]
    offered = {"INSTANCE": [2], "ASSOCIATION": [2, 3], "INDICATION": [4]}
    for name, interfaces in ROWS.items():
        assert capabilities[name]["ProviderType"] == offered[interfaces] + ([5] if methods(classes, name) else []), name
        assert capabilities[name]["Namespaces"] == ["root/zemlar"] + (["root/PG_InterOp"] if name in INTEROP else []), name
        assert (3 in capabilities[name]["ProviderType"]) == ("Association" in classes[name].qualifiers), name
    assert INTEROP == {name for name in server.classes["root/PG_InterOp"] if name.startswith("ZEMLAR_")}


def test_one_module_holds_all_providers_under_the_servers_own_user(server, capabilities):
    instances = server.instances["root/PG_InterOp"]
    module, = (instance for instance in instances if instance.classname == "PG_ProviderModule")
    providers = [instance["Name"] for instance in instances if instance.classname == "PG_Provider"]
    assert (module["Location"], module["UserContext"]) == ("zmlrprovider", 4)
    assert {instance["ProviderModuleName"] for instance in instances if instance.classname != "PG_ProviderModule"} == {module["Name"]}
    assert sorted(providers) == sorted(capability["ProviderName"] for capability in capabilities.values())


def test_provider_names_are_what_the_factory_functions_carry(capabilities):
    table = subprocess.run(["nm", "-D", "--defined-only", BUILD / "providers" / "libzmlrprovider.so"], capture_output=True,
                           text=True, check=True).stdout
    symbols = {line.split()[-1] for line in table.splitlines()}
    wanted = {f"{capability['ProviderName']}_Create_{KINDS[kind]}MI" for capability in capabilities.values()
              for kind in capability["ProviderType"]}
    assert wanted - symbols == set()
    assert {symbol for symbol in symbols - wanted if "_Provider_Create_" in symbol and not symbol.endswith("MethodMI")} == set()


def test_sfcb_is_told_the_same(capabilities):
    registration = configparser.ConfigParser(delimiters=(":",))
    registration.read(DATA / "registration" / "sfcb.reg")
    assert registration.sections() == list(capabilities)
    for name, capability in capabilities.items():
        assert dict(registration[name]) == {
            "provider": capability["ProviderName"], "location": "zmlrprovider", "group": "zmlrprovider", "unload": "never",
            "type": " ".join(KINDS[kind].lower() for kind in capability["ProviderType"]),
            "namespace": " ".join(capability["Namespaces"]).replace("root/PG_InterOp", "root/interop")}
