"""The table of the qualifiers that the module itself does not carry, for the embedded CIM server."""

from cpp_text import BANNER, in_name_space, string_literal


def qualifier_table_source(classes):
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
        f"constinit const unsigned qualifier_table_size = {len(rows)};"
    )
    return f'{BANNER}#include "cimserver/qualifier_table.h"\n\n' + in_name_space("cimserver", body)


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
