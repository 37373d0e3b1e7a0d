"""Generates the C++ side of the classes: records, meta-data, provider skeletons and the server's qualifier table.

usage: generate.py --output DIRECTORY --providers FILE [--omit CLASS]... MOF...

The MOF files are compiled in the given order. Omitted classes are read and not written. Below the output directory:

    schema/<Class>.h                          the record of a class and of its methods' parameters
    schema/meta_data.cpp, repository.h        the meta-data of all classes
    providers/<Class>_Provider_Skeleton.h     per row of providers.def: what its provider derives from
    providers/skeletons.h                     all of them
    providers/skeletons.cpp                   default answers, method dispatch, provider procedures
    providers/row_providers.cpp               the providers of the classes that are rows of a table
    cimserver/qualifier_table.cpp             Description, EmbeddedInstance, ValueMap and Values

The same input gives the same bytes. A file is written only when its content changes; files of former classes go away.
Wrong input ends with a message on standard error and exit status 1, and leaves the output as it was.
"""

import argparse
import pathlib
import sys

import pywbem

import mof_model
import write_meta_data
import write_qualifiers
import write_records
import write_skeletons


def main(arguments):
    options = _parse(arguments)
    try:
        files = generate(options.mof, options.providers, options.omit)
        update(options.output, files)
    except (mof_model.Model_Error, pywbem.MOFCompileError, OSError) as error:
        print(f"generate.py: {error}", file=sys.stderr)
        return 1
    return 0


def _parse(arguments):
    parser = argparse.ArgumentParser(description="Generates C++ from MOF.")
    parser.add_argument("--output", type=pathlib.Path, required=True, help="directory of the generated files")
    parser.add_argument("--providers", type=pathlib.Path, required=True, help="the table of served classes")
    parser.add_argument("--omit", action="append", default=[], metavar="CLASS", help="declared for servers only")
    parser.add_argument("mof", type=pathlib.Path, nargs="+", help="MOF files, in the order of compilation")
    return parser.parse_args(arguments)


def generate(mof, providers_file, omitted=()):
    """All generated files: relative path -> content."""
    classes = mof_model.load(mof, omitted)
    providers = write_skeletons.load_providers(providers_file, classes)
    files = {f"schema/{cls.name}.h": write_records.record_header(cls) for cls in classes}
    files["schema/repository.h"] = write_meta_data.repository_header(classes)
    files["schema/meta_data.cpp"] = write_meta_data.meta_data_source(classes)
    for provider in providers:
        files[f"providers/{provider.skeleton}.h"] = write_skeletons.skeleton_header(provider)
    files["providers/skeletons.h"] = write_skeletons.all_skeletons_header(providers)
    files["providers/skeletons.cpp"] = write_skeletons.skeleton_source(providers)
    files["providers/row_providers.cpp"] = write_skeletons.row_providers_source(providers)
    declarations = mof_model.load_qualifiers(mof)
    files["cimserver/qualifier_table.cpp"] = write_qualifiers.qualifier_table_source(classes, declarations)
    return files


def update(output, files):
    """Brings the folders of the files to this content, touching only what differs. Other folders there are of other generators."""
    for name, content in files.items():
        path = output / name
        if path.is_file() and path.read_text(encoding="utf-8") == content:
            continue
        path.parent.mkdir(parents=True, exist_ok=True)
        path.write_text(content, encoding="utf-8")
    for folder in {(output / name).parent for name in files}:
        for path in folder.iterdir():
            if path.suffix in (".h", ".cpp") and path.relative_to(output).as_posix() not in files:
                path.unlink()


if __name__ == "__main__":
    sys.exit(main(sys.argv[1:]))
