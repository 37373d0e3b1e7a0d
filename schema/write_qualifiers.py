"""The table of the qualifiers that the module itself does not carry, for the embedded CIM server."""

from cpp_text import BANNER, in_name_space, string_literal


def qualifier_table_source(classes):
    rows = sorted(_rows(classes), key=lambda row: tuple(text.lower() for text in row[:3]))
    texts, table = [], []
    for number, (cls, feature, name, value) in enumerate(rows):
        array = isinstance(value, list)
        values = value if array else [value]
        texts.append(f"constexpr const char* texts_{number}[] = {{{', '.join(string_literal(text) for text in values)}}};")
        table.append(
            f"    {{{string_literal(cls)}, {string_literal(feature)}, {string_literal(name)},"
            f" {'true' if array else 'false'}, texts_{number}, {len(values)}}},"
        )
    body = (
        "namespace\n{\n\n" + "\n".join(texts) + "\n\n} // namespace\n\n"
        "constinit const Qualifier_Row qualifier_table[] = {\n" + "\n".join(table) + "\n};\n"
        f"constinit const unsigned qualifier_table_size = {len(rows)};"
    )
    return f'{BANNER}#include "cimserver/qualifier_table.h"\n\n' + in_name_space("cimserver", body)


def _rows(classes):
    """(class, feature or "", qualifier, value); an overriding feature has the rows of what it overrides, too."""
    for cls in classes:
        yield from ((cls.name, "", name, value) for name, value in cls.documentation.items() if value)
        for feature in filter(cls.is_local, cls.features):
            yield from ((cls.name, feature.name, name, value) for name, value in feature.documentation.items() if value)
