"""Writes what registers the module with CIM servers, from the classes and the table of providers.

usage: generate_registration.py --output DIRECTORY --version V --module FILE --providers FILE --interop-roots FILE MOF...

The MOF files are compiled in the given order; the last one is that of the served classes. Below the output directory:

    mof/zemlar.mof                  the served classes
    mof/zemlar-interop.mof          those of them that the interop name space has too
    registration/registration.json  what zmlr-register reads
    registration/openpegasus.mof    the whole registration, for those who register by hand
    registration/sfcb.reg
    registration/schema.txt         what the served classes take from the server's CIM schema
"""

import argparse
import pathlib
import re
import sys

import pywbem

HERE = pathlib.Path(__file__).resolve().parent
sys.path[:0] = [str(HERE), str(HERE.parents[1] / "schema")]

import generate  # noqa: E402
import mof_model  # noqa: E402
import schema_report  # noqa: E402
import write_skeletons  # noqa: E402
from zmlr_register import catalogue as catalogues  # noqa: E402
from zmlr_register.servers import openpegasus_registration, sfcb  # noqa: E402


def main(arguments):
    options = _parse(arguments)
    try:
        generate.update(options.output, files(options))
    except (mof_model.Model_Error, pywbem.MOFCompileError, OSError) as error:
        print(f"generate_registration.py: {error}", file=sys.stderr)
        return 1
    return 0


def _parse(arguments):
    parser = argparse.ArgumentParser(description="Writes what registers the module with CIM servers.")
    parser.add_argument("--output", type=pathlib.Path, required=True, help="directory of the generated files")
    parser.add_argument("--version", required=True, help="version of the module")
    parser.add_argument("--module", required=True, help="the module, relative to where the generated files are installed")
    parser.add_argument("--providers", type=pathlib.Path, required=True, help="the table of served classes")
    parser.add_argument("--interop-roots", type=pathlib.Path, required=True, help="the roots of the interop name space")
    parser.add_argument("mof", type=pathlib.Path, nargs="+", help="MOF files, in the order of compilation")
    return parser.parse_args(arguments)


def files(options):
    """All generated files: relative path -> content."""
    classes = mof_model.load(options.mof)
    served_mof = options.mof[-1].read_text(encoding="utf-8")
    served = [cls for cls in classes if cls.name in catalogues.mof_blocks(served_mof)]
    catalogue = catalogues.Catalogue(
        module="zmlrprovider_Module", vendor="Zemlar", version=options.version, location="zmlrprovider", file=options.module,
        name_space="root/zemlar", classes=_served_classes(served, options, classes), inherited=_inherited(served))
    in_interop = [cls for cls in catalogue.classes if cls.interop]
    return {
        "mof/zemlar.mof": served_mof,
        "mof/zemlar-interop.mof": catalogues.mof_of(served_mof, in_interop),
        "registration/registration.json": catalogues.to_json(catalogue),
        "registration/openpegasus.mof": openpegasus_registration.full_registration(catalogue),
        "registration/sfcb.reg": sfcb.full_registration(catalogue),
        "registration/schema.txt": schema_report.schema_report(served),
    }


def _served_classes(served, options, classes):
    providers = {provider.cls.name: provider for provider in write_skeletons.load_providers(options.providers, classes)}
    roots = re.findall(r"^ZMLR_INTEROP_ROOT\((\w+)\)", options.interop_roots.read_text(encoding="utf-8"), re.MULTILINE)
    for name in providers.keys() - {cls.name for cls in served}:
        raise mof_model.Model_Error(f"{name} is provided, but does not stand in {options.mof[-1]} as a class with qualifiers")
    for name in set(roots) - {cls.name for cls in classes}:
        raise mof_model.Model_Error(f"{options.interop_roots}: {name} is not declared in the MOF")
    return [catalogues.Served_Class(
        cls.name, needs(cls), f"{cls.name}_Provider" if cls.name in providers else "",
        _kinds(providers[cls.name]) if cls.name in providers else [], bool(_line(cls) & set(roots))) for cls in served]


def _inherited(served):
    names = {cls.name for cls in served}
    superclasses = {cls.superclass.name: cls.superclass for cls in served if cls.superclass and cls.superclass.name not in names}
    return {name: [feature.name for feature in cls.features] for name, cls in superclasses.items()}


def _kinds(provider):
    """What of a provider's interfaces the server is to ask for: methods only where the class has one."""
    kinds = {"INSTANCE": ["instance"], "ASSOCIATION": ["instance", "association"], "INDICATION": ["indication"]}
    return kinds[provider.interfaces] + (["method"] if provider.cls.methods else [])


def _line(cls):
    """The names of a class and its ancestors."""
    return {cls.name} | (_line(cls.superclass) if cls.superclass else set())


def needs(cls):
    """The classes that must be there before a class can be declared: its superclass, and those that its own features name."""
    names = [cls.superclass.name] if cls.superclass else []
    for feature in filter(cls.is_local, cls.features):
        for element in feature.parameters if feature.is_method else [feature]:
            names += [element.type] if element.is_reference else []
            names += [element.documentation["EmbeddedInstance"]] if "EmbeddedInstance" in element.documentation else []
    return list(dict.fromkeys(names))


if __name__ == "__main__":
    sys.exit(main(sys.argv[1:]))
