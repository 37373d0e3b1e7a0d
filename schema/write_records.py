"""One header per class: the record of its instances and the parameter records of the methods that it declares."""

from cpp_text import BANNER, field_type, in_name_space, method_record


def record_header(cls):
    local_methods = [method for method in cls.methods if cls.is_local(method)]
    records = [_instance_record(cls)] + [_parameter_record(method) for method in local_methods]
    forward = _forward_declarations(cls, local_methods)
    body = "\n\n".join(([forward] if forward else []) + records)
    return f'{BANNER}#pragma once\n\n#include "runtime/instance.h"\n\n' + in_name_space("zmlr", body)


def _instance_record(cls):
    description = " ".join((cls.documentation.get("Description") or "").split())
    return (
        (f"// {description}\n" if description else "")
        + f"struct {cls.name} : Instance\n{{\n"
        + _fields(cls.fields)
        + "\n    static const Meta_Class static_meta_class;\n"
        + f"    static {cls.name}* create(bool defaults = true) {{ return zmlr::create<{cls.name}>(defaults); }}\n"
        + "};"
    )


def _parameter_record(method):
    return (
        f"// The parameters of {method.owner}.{method.name}.\n"
        + f"struct {method_record(method)} : Instance\n{{\n"
        + _fields(method.parameters)
        + "\n    static const Meta_Method static_meta_class;\n"
        + "};"
    )


def _fields(features):
    return "".join(f"    {field_type(feature)} {feature.name};\n" for feature in features)


def _forward_declarations(cls, methods):
    features = cls.fields + [parameter for method in methods for parameter in method.parameters]
    names = {feature.type for feature in features if feature.is_reference and not feature.array} - {cls.name}
    return "\n".join(f"struct {name};" for name in sorted(names))
