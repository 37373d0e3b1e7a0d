"""Generates the meta-data of the embedded server's own classes: a source for cimserver/interop/server_schema.h.

usage: write_server_schema.py --output FILE MOF...

The server has no records of these classes: offsets and sizes are 0. Every class that is not abstract is registered.
"""

import argparse
import pathlib
import sys

import pywbem

import mof_model
from cpp_text import BANNER, in_name_space, string_literal, type_code
from mof_model import FLAGS
from write_meta_data import default_value, feature_array, head


def server_schema_source(classes):
    served = [cls for cls in classes if not cls.flags & FLAGS["Abstract"]]
    features = "\n".join(_feature(feature) for cls in classes for feature in cls.features if cls.is_local(feature))
    sections = [
        "using namespace zmlr;",
        "namespace\n{\n\nextern const Meta_Repository repository;\n\n" + features + "\n\n} // namespace",
        *(_meta_class(cls) for cls in classes),
        "namespace\n{\n\n" + _lists(classes, served) + "\n\n} // namespace",
        f"const Registration* server_registrations() {{ return &registered[{len(served) - 1}]; }}",
    ]
    return f'{BANNER}#include "cimserver/interop/server_schema.h"\n\n' + in_name_space("cimserver", "\n\n".join(sections))


def _feature(feature):
    name = _object(feature)
    start = f"{{{{{head(feature.flags, feature.name)}}}"
    if feature.is_reference:
        return f"constinit const Meta_Reference {name} = {start}, 0, &{feature.type}, 0}};"
    default, pointer = default_value(feature, name)
    return default + f"constinit const Meta_Property {name} = {start}, {type_code(feature.type)}, {feature.array}, 0, {pointer}}};"


def _object(feature):
    return f"_{feature.owner}_{feature.name}"


def _meta_class(cls):
    local = ", ".join("{1}" if cls.is_local(feature) else "{0}" for feature in cls.features)
    superclass = f"&{cls.superclass.name}" if cls.superclass else "nullptr"
    keys = sum(feature.is_key for feature in cls.features)
    array = feature_array(f"_{cls.name}_features", [_object(feature) for feature in cls.features])
    return (
        f"namespace\n{{\n\n{array}\nconstinit const Meta_Feature_Local _{cls.name}_locals[] = {{{local}}};\n\n}} // namespace\n\n"
        f"constinit const Meta_Class {cls.name} = {{{{{{{head(cls.flags, cls.name)}}}, _{cls.name}_features, {len(cls.features)}, 0}},"
        f" _{cls.name}_locals, {superclass}, {keys}, &repository}};"
    )


def _lists(classes, served):
    names = ", ".join(f"&{cls.name}" for cls in classes)
    rows = "".join(
        f'    {{"zmlr-cimserver", {string_literal(cls.name)}, nullptr, &{cls.name}, {f"&registered[{i - 1}]" if i else "nullptr"}}},\n'
        for i, cls in enumerate(served)
    )
    return (
        f"constinit const Meta_Class* const classes[] = {{{names}}};\n"
        f"constinit const Meta_Repository repository = {{classes, {len(classes)}}};\n"
        f"extern const Registration registered[{len(served)}];\n"
        f"constinit const Registration registered[{len(served)}] = {{\n{rows}}};"
    )


def main(arguments):
    parser = argparse.ArgumentParser(description="Generates the meta-data of the embedded server's own classes from MOF.")
    parser.add_argument("--output", type=pathlib.Path, required=True, help="the generated file")
    parser.add_argument("mof", type=pathlib.Path, nargs="+", help="MOF files, in the order of compilation")
    options = parser.parse_args(arguments)
    try:
        source = server_schema_source(mof_model.load(options.mof))
    except (mof_model.Model_Error, pywbem.MOFCompileError, OSError) as error:
        print(f"write_server_schema.py: {error}", file=sys.stderr)
        return 1
    options.output.parent.mkdir(parents=True, exist_ok=True)
    options.output.write_text(source, encoding="utf-8")
    return 0


if __name__ == "__main__":
    sys.exit(main(sys.argv[1:]))
