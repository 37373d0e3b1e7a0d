"""Per served class a skeleton: its base class, its methods with their default answer, their dispatch, its procedure."""

import re
from dataclasses import dataclass

from cpp_text import BANNER, field_type, in_name_space, method_record
from mof_model import FLAGS, Model_Error

_KINDS = {  # interfaces of providers.def: base class, procedure template
    "INSTANCE": ("Instance_Provider", "instance_provider_proc"),
    "ASSOCIATION": ("Association_Provider", "association_provider_proc"),
    "INDICATION": ("Indication_Provider", "indication_provider_proc"),
}

_ROW_PROVIDERS = {  # words of providers.def: the template that serves the class by its row of a table, and its header
    "ENUMERATED": ("Enumerating_Provider", "providers/enumerating_provider.h"),
    "JOINED": ("Joining_Provider", "providers/joining_provider.h"),
    "DIAGNOSTIC_TEST": ("Diagnostic_Test_Provider", "providers/diagnostic_test_provider.h"),
}

_PROC_PARAMETERS = "const Registration* registration, int operation, " + ", ".join(f"void* arg{i}" for i in range(8))
_ROW = re.compile(r"^ZMLR_PROVIDER\(\s*(\w+)\s*,\s*(\w+)\s*,\s*(\w+)\s*\)", re.MULTILINE)


@dataclass(frozen=True)
class Provider:
    """One row of providers.def."""

    cls: object
    interfaces: str
    state: str

    @property
    def skeleton(self):
        return f"{self.cls.name}_Provider_Skeleton"

    @property
    def create(self):
        return f"create_{self.cls.name}_Provider"

    @property
    def proc(self):
        return f"__cimple_{self.cls.name}_Provider_proc"


def load_providers(file, classes):
    """The rows of providers.def. Raises Model_Error for a row that names an unknown class, kind or state."""
    known = {cls.name: cls for cls in classes}
    providers = []
    for name, interfaces, state in _ROW.findall(file.read_text(encoding="utf-8")):
        if name not in known:
            raise Model_Error(f"{file}: {name} is not declared in the MOF")
        if interfaces not in _KINDS or state not in ("WRITTEN", "SKELETON", *_ROW_PROVIDERS):
            raise Model_Error(f"{file}: {name}: {interfaces}, {state}: unknown interfaces or provider state")
        providers.append(Provider(known[name], interfaces, state))
    if not providers:
        raise Model_Error(f"{file}: no ZMLR_PROVIDER rows")
    return providers


def skeleton_header(provider):
    cls, skeleton = provider.cls, provider.skeleton
    methods = "".join(f"    virtual {_signature(method, cls, method.name)};\n" for method in cls.methods)
    base = _KINDS[provider.interfaces][0]
    body = (
        _forward_declarations(cls)
        + f"// Every operation of {cls.name} with its default answer: what a provider does not override.\n"
        + f"class {skeleton} : public {base}<{cls.name}>\n{{\npublic:\n"
        + (methods + "\n" if methods else "")
        + "    // Calls the method of the parameter record's name: its status, or -1 when the class has none.\n"
        + f"    static int invoke({skeleton}& provider, const {cls.name}* self, Instance* parameters);\n"
        + "};\n\n"
        + f"{skeleton}* {provider.create}();\n"
        + f"int {provider.proc}({_PROC_PARAMETERS});"
    )
    includes = ["cmpi/provider.h", "cmpi/registration.h", f"schema/{cls.name}.h"]
    return f"{BANNER}#pragma once\n\n" + _includes(includes) + "\n" + in_name_space("zmlr", body)


def all_skeletons_header(providers):
    return f"{BANNER}#pragma once\n\n" + _includes(f"providers/{provider.skeleton}.h" for provider in providers)


def skeleton_source(providers):
    records = {method.owner for provider in providers for method in provider.cls.methods}
    includes = ["cmpi/provider_proc.h", "providers/skeletons.h"] + [f"schema/{owner}.h" for owner in records]
    sections = [_definitions(provider) for provider in providers]
    return BANNER + _includes(includes) + "\n" + in_name_space("zmlr", "\n\n".join(sections))


def row_providers_source(providers):
    bound = [(provider, *_ROW_PROVIDERS[provider.state]) for provider in providers if provider.state in _ROW_PROVIDERS]
    includes = {"providers/skeletons.h", *(header for _, _, header in bound)}
    functions = [
        f"{provider.skeleton}* {provider.create}()\n{{\n"
        f'    return new {template}<{provider.skeleton}>("{provider.cls.name}_Provider");\n}}'
        for provider, template, _ in bound
    ]
    return BANNER + _includes(includes) + "\n" + in_name_space("zmlr", "\n\n".join(functions))


def _includes(files):
    return "".join(f'#include "{file}"\n' for file in sorted(files))


def _forward_declarations(cls):
    parameters = [parameter for method in cls.methods for parameter in method.parameters]
    names = {parameter.type for parameter in parameters if parameter.is_reference and not parameter.array}
    return "".join(f"struct {name};\n" for name in sorted(names)) + ("\n" if names else "")


def _signature(method, cls, name, named=True):
    arguments = [f"const {cls.name}*" + (" self" if named else "")]
    arguments += [_argument(parameter) + (f" {parameter.name}" if named else "") for parameter in method.parameters]
    return f"Invoke_Method_Status {name}({', '.join(arguments)})"


def _argument(parameter):
    """The type of a method argument: inputs are read only, outputs (and in/outs) are written in place."""
    output = bool(parameter.flags & FLAGS["Out"])
    if parameter.is_reference and not parameter.array:
        return f"{parameter.type}*&" if output else f"const {parameter.type}*"
    return f"{field_type(parameter)}&" if output else f"const {field_type(parameter)}&"


def _definitions(provider):
    cls, skeleton = provider.cls, provider.skeleton
    parts = [f"// {cls.name}"]
    parts += [
        f"{_signature(method, cls, f'{skeleton}::{method.name}', named=False)} {{ return INVOKE_METHOD_UNSUPPORTED; }}"
        for method in cls.methods
    ]
    parts.append(_invoke(cls, skeleton))
    if provider.state == "SKELETON":
        parts.append(f"{skeleton}* {provider.create}() {{ return new {skeleton}; }}")
    parts.append(_proc(provider))
    return "\n".join(parts)


def _invoke(cls, skeleton):
    if not cls.methods:
        return f"int {skeleton}::invoke({skeleton}&, const {cls.name}*, Instance*) {{ return -1; }}"
    return (
        f"int {skeleton}::invoke({skeleton}& provider, const {cls.name}* self, Instance* parameters)\n{{\n"
        + "    const char* name = record_of(parameters)->name;\n"
        + "".join(_dispatch(method) for method in cls.methods)
        + "    return -1;\n}"
    )


def _dispatch(method):
    arguments = ", ".join(f"record->{parameter.name}" for parameter in method.parameters)
    return (
        f'    if (eqi(name, "{method.name}"))\n    {{\n'
        f"        auto* record = static_cast<{method_record(method)}*>(parameters);\n"
        f"        return static_cast<int>(provider.{method.name}(self, {arguments}));\n"
        "    }\n"
    )


def _proc(provider):
    arguments = ", ".join(f"arg{i}" for i in range(8))
    parameters = _PROC_PARAMETERS.replace(" registration,", ",", 1)
    return (
        f"int {provider.proc}({parameters})\n{{\n"
        f"    void* const arguments[] = {{{arguments}}};\n"
        f"    return {_KINDS[provider.interfaces][1]}<{provider.skeleton}>(operation, {provider.create}, arguments);\n}}"
    )
