"""The constant meta-data of all classes: one source, and the header that declares the repository.

The numbers of the layout are the compiler's: sizeof and offsetof of the records. Static assertions hold what generic code
relies on: a feature lies at one offset in a class and in all its subclasses, and a null flag lies directly behind its value.
"""

import hashlib

from cpp_text import BANNER, TYPES, in_name_space, method_record, string_literal, type_code, value_literal, value_type


def repository_name(classes):
    """The repository's name carries a hash of the class set: the same classes have the same name in every build."""
    names = "\n".join(sorted(cls.name for cls in classes))
    return "__meta_repository_" + hashlib.sha256(names.encode()).hexdigest()[:32].upper()


def repository_header(classes):
    name = repository_name(classes)
    body = (
        f"// The {len(classes)} classes of the module: the served ones and their ancestors.\n"
        f"extern const Meta_Repository {name};\n\n"
        f"inline const Meta_Repository& meta_repository() {{ return {name}; }}"
    )
    return f'{BANNER}#pragma once\n\n#include "runtime/meta.h"\n\n' + in_name_space("zmlr", body)


def meta_data_source(classes):
    repository = repository_name(classes)
    includes = ["schema/repository.h"] + [f"schema/{cls.name}.h" for cls in classes]
    sections = [_layout_assertions()]
    sections += [_class_section(cls, repository) for cls in classes]
    sections.append(_repository(classes, repository))
    return (
        BANNER
        + "".join(f'#include "{include}"\n' for include in sorted(includes))
        + "\n#include <cstddef>\n\n"
        + '#pragma GCC diagnostic ignored "-Winvalid-offsetof"\n\n'
        + in_name_space("zmlr", "\n\n".join(sections))
    )


def _layout_assertions():
    values = [cpp for _, cpp in TYPES.values()] + ["Array<uint8>", "Array<String>", "Array<Instance*>"]
    return "\n".join(f"static_assert(offsetof(Property<{value}>, null) == sizeof({value}));" for value in values)


def _class_section(cls, repository):
    parts = [f"// {cls.name}"]
    for feature in cls.features:
        if cls.is_local(feature):
            parts.append(_method(feature) if feature.is_method else _field(feature, _feature_object(feature), cls.name))
    parts.append(_inherited_offsets(cls))
    parts.append(feature_array(f"_{cls.name}_MFA", [_feature_object(feature) for feature in cls.features]))
    parts.append(_meta_class(cls, repository))
    return "\n".join(part for part in parts if part)


def _feature_object(feature):
    if feature.is_method:
        return f"{method_record(feature)}::static_meta_class"
    return f"_{feature.owner}_{feature.name}"


def head(flags, name):
    return f"{{0}}, {flags:#010x}, {string_literal(name)}, nullptr, 0"


def _field(feature, name, record):
    """The object of a property, reference or parameter, with its default in front of it."""
    offset = f"offsetof({record}, {feature.name})"
    if feature.is_reference:
        array = 1 if feature.array else 0
        return (
            f"constinit const Meta_Reference {name} ="
            f" {{{{{head(feature.flags, feature.name)}}}, {array}, &{feature.type}::static_meta_class, {offset}}};"
        )
    default, pointer = default_value(feature, name)
    return default + (
        f"constinit const Meta_Property {name} ="
        f" {{{{{head(feature.flags, feature.name)}}}, {type_code(feature.type)}, {feature.array}, {offset}, {pointer}}};"
    )


def default_value(feature, name):
    """The Meta_Value of a default and how to point at it."""
    if feature.default is None:
        return "", "nullptr"
    values = feature.default if feature.array else [feature.default]
    text = feature.type in ("string", "datetime")
    # A scalar text is pointed at directly, an array of texts through an array of pointers.
    if text and not feature.array:
        storage = f"constinit const char {name}_default[] = {value_literal(feature.type, values[0])};"
    else:
        element = "char* const" if text else value_type(feature.type)
        literals = ", ".join(value_literal(feature.type, value) for value in values)
        storage = f"constinit const {element} {name}_default[] = {{{literals}}};"
    meta_value = f"constinit const Meta_Value {name}_value = {{{name}_default, {len(values)}}};"
    return f"{storage}\n{meta_value}\n", f"&{name}_value"


def feature_array(name, objects):
    rows = "".join(f"    &{name},\n" for name in objects)
    return f"constinit const Meta_Feature* const {name}[] = {{\n{rows}}};"


def _method(method):
    """The parameter objects of a method and its Meta_Method."""
    record = method_record(method)
    prefix = f"_{method.owner}_{method.name}"
    names = [f"{prefix}_{parameter.name}" for parameter in method.parameters]
    parts = [_field(parameter, name, record) for parameter, name in zip(method.parameters, names)]
    parts.append(feature_array(f"{prefix}_MFA", names))
    parts.append(
        f"constinit const Meta_Method {record}::static_meta_class ="
        f" {{{{{{{head(method.flags, method.name)}}}, {prefix}_MFA, {len(names)}, sizeof({record})}},"
        f" {type_code(method.return_type)}}};"
    )
    return "\n".join(parts)


def _inherited_offsets(cls):
    return "\n".join(
        f"static_assert(offsetof({cls.name}, {field.name}) == offsetof({field.owner}, {field.name}));"
        for field in cls.fields
        if not cls.is_local(field)
    )


def _meta_class(cls, repository):
    local = ", ".join("{1}" if cls.is_local(feature) else "{0}" for feature in cls.features)
    superclass = f"&{cls.superclass.name}::static_meta_class" if cls.superclass else "nullptr"
    keys = sum(feature.is_key for feature in cls.features)
    return (
        f"constinit const Meta_Feature_Local _{cls.name}_locals[] = {{{local}}};\n"
        f"constinit const Meta_Class {cls.name}::static_meta_class ="
        f" {{{{{{{head(cls.flags, cls.name)}}}, _{cls.name}_MFA, {len(cls.features)}, sizeof({cls.name})}},"
        f" _{cls.name}_locals, {superclass}, {keys}, &{repository}}};"
    )


def _repository(classes, repository):
    rows = "".join(f"    &{cls.name}::static_meta_class,\n" for cls in classes)
    return (
        "// The repository\n"
        f"constinit const Meta_Class* const _meta_classes[] = {{\n{rows}}};\n"
        f"constinit const Meta_Repository {repository} = {{_meta_classes, {len(classes)}}};"
    )
