"""The qualifiers for the embedded CIM server: those that the module itself does not carry, and the declarations of all."""

from cpp_text import BANNER, in_name_space, string_literal
from mof_model import FLAGS

SCOPES = ("CLASS", "ASSOCIATION", "INDICATION", "PROPERTY", "REFERENCE", "METHOD", "PARAMETER")


def qualifier_table_source(classes, declarations):
    rows = sorted(_rows(classes), key=lambda row: tuple(text.lower() for text in row[:4]))
    texts, table = [], []
    for number, (cls, feature, parameter, name, value) in enumerate(rows):
        array = isinstance(value, list)
        values = value if array else [value]
        texts.append(f"constexpr const char* texts_{number}[] = {{{', '.join(string_literal(text) for text in values)}}};")
        table.append(
            f"    {{{', '.join(string_literal(text) for text in (cls, feature, parameter, name))},"
            f" {'true' if array else 'false'}, texts_{number}, {len(values)}}},"
        )
    body = (
        "namespace\n{\n\n" + "\n".join(texts) + "\n\n} // namespace\n\n"
        "constinit const Qualifier_Row qualifier_table[] = {\n" + "\n".join(table) + "\n};\n"
        f"constinit const unsigned qualifier_table_size = {len(rows)};\n\n"
        "constinit const Qualifier_Declaration qualifier_declarations[] = {\n" + "\n".join(map(_declaration, declarations)) + "\n};\n"
        f"constinit const unsigned num_qualifier_declarations = {len(declarations)};"
    )
    return f'{BANNER}#include "cimserver/model/qualifier_table.h"\n\n' + in_name_space("cimserver", body)


def _declaration(declared):
    scopes = " ".join(scope for scope in SCOPES if declared.scopes.get("ANY") or declared.scopes.get(scope))
    value = "nullptr" if declared.value is None else string_literal(str(declared.value).lower())
    boolean = [declared.is_array, declared.overridable is not False, declared.tosubclass is not False, bool(declared.translatable)]
    # What is true unless said otherwise is not written from a flag, nor is what is no boolean.
    flag = FLAGS.get(declared.name, 0) if declared.type == "boolean" and not declared.value else 0
    return (
        f"    {{{string_literal(declared.name)}, {string_literal(declared.type)}, {value},"
        f" {', '.join('true' if flag_ else 'false' for flag_ in boolean)}, {string_literal(scopes)}, {flag:#010x}}},"
    )


def _rows(classes):
    """(class, feature, parameter, qualifier, value), "" for what is of the class or the feature itself.

    An overriding feature has the rows of what it overrides, too.
    """
    for cls in classes:
        yield from _rows_of(cls, cls.name, "", "")
        for feature in filter(cls.is_local, cls.features):
            yield from _rows_of(feature, cls.name, feature.name, "")
            for parameter in feature.parameters if feature.is_method else []:
                yield from _rows_of(parameter, cls.name, feature.name, parameter.name)


def _rows_of(element, *place):
    return ((*place, name, value) for name, value in element.documentation.items() if value)
