// Golden texts of the test classes.
#include "cimserver/cimxml/class_writer.h"

#include "test_classes.h"

#include <gtest/gtest.h>

using namespace cimserver;

namespace
{

std::string class_text(const zmlr::Meta_Class& meta_class, const Class_Selection& selection)
{
    Xml_Writer writer;
    write_class(writer, meta_class, selection);
    return writer.take();
}

const std::string description = "<QUALIFIER NAME=\"Description\" TYPE=\"string\" TRANSLATABLE=\"true\"><VALUE>";

std::string fixed(const std::string& name)
{
    return "<QUALIFIER NAME=\"" + name + "\" TYPE=\"boolean\" OVERRIDABLE=\"false\"><VALUE>true</VALUE></QUALIFIER>";
}

} // namespace

TEST(class_writer, writes_local_features_with_their_qualifiers)
{
    const std::string in = fixed("In");
    const std::string in_false = "<QUALIFIER NAME=\"In\" TYPE=\"boolean\" OVERRIDABLE=\"false\"><VALUE>false</VALUE></QUALIFIER>";
    EXPECT_EQ(
        class_text(test::TST_Port, {}),
        "<CLASS NAME=\"TST_Port\" SUPERCLASS=\"TST_Element\">" + description + "A port.</VALUE></QUALIFIER>" +
            "<PROPERTY NAME=\"Name\" TYPE=\"string\">" + fixed("Key") + fixed("Required") +
            "<QUALIFIER NAME=\"Override\" TYPE=\"string\" TOSUBCLASS=\"false\"><VALUE>Name</VALUE></QUALIFIER>" + description +
            "The port&apos;s WWN.</VALUE></QUALIFIER></PROPERTY>" +
            "<PROPERTY NAME=\"Speed\" TYPE=\"uint64\"><QUALIFIER NAME=\"Counter\" TYPE=\"boolean\"><VALUE>true</VALUE>"
            "</QUALIFIER><QUALIFIER NAME=\"Read\" TYPE=\"boolean\"><VALUE>false</VALUE></QUALIFIER><VALUE>1</VALUE></PROPERTY>"
            "<PROPERTY.ARRAY NAME=\"Modes\" TYPE=\"uint16\" ARRAYSIZE=\"4\"><QUALIFIER NAME=\"Write\" TYPE=\"boolean\">"
            "<VALUE>true</VALUE></QUALIFIER><QUALIFIER NAME=\"ValueMap\" TYPE=\"string\"><VALUE.ARRAY><VALUE>2</VALUE>"
            "<VALUE>..</VALUE></VALUE.ARRAY></QUALIFIER><QUALIFIER NAME=\"Values\" TYPE=\"string\" TRANSLATABLE=\"true\">"
            "<VALUE.ARRAY><VALUE>Point &amp; point</VALUE><VALUE>Reserved</VALUE></VALUE.ARRAY></QUALIFIER>"
            "<VALUE.ARRAY><VALUE>2</VALUE><VALUE>65535</VALUE></VALUE.ARRAY></PROPERTY.ARRAY>"
            "<PROPERTY NAME=\"Setting\" TYPE=\"string\" EmbeddedObject=\"instance\"><QUALIFIER NAME=\"EmbeddedInstance\" "
            "TYPE=\"string\"><VALUE>TST_Element</VALUE></QUALIFIER></PROPERTY>"
            "<METHOD NAME=\"Reset\" TYPE=\"uint32\"><PARAMETER NAME=\"Force\" TYPE=\"boolean\">" +
            in + description +
            "Even now.</VALUE></QUALIFIER></PARAMETER><PARAMETER.REFERENCE NAME=\"Job\" REFERENCECLASS=\"TST_Element\">" +
            in_false + fixed("Out") + "</PARAMETER.REFERENCE><PARAMETER.ARRAY NAME=\"Codes\" TYPE=\"uint8\">" + in +
            fixed("Out") + "</PARAMETER.ARRAY></METHOD></CLASS>");
}

TEST(class_writer, writes_what_was_selected)
{
    Class_Selection selection;
    selection.local_only = false;
    selection.qualifiers = false;
    selection.class_origin = true;
    selection.properties = {"STATUS", "Nonsense"};
    EXPECT_EQ(class_text(test::TST_Port, selection),
              "<CLASS NAME=\"TST_Port\" SUPERCLASS=\"TST_Element\">"
              "<PROPERTY NAME=\"Status\" TYPE=\"string\" CLASSORIGIN=\"TST_Element\" PROPAGATED=\"true\"><VALUE>O&lt;K</VALUE>"
              "</PROPERTY><METHOD NAME=\"Reset\" TYPE=\"uint32\" CLASSORIGIN=\"TST_Port\"><PARAMETER NAME=\"Force\" "
              "TYPE=\"boolean\"></PARAMETER><PARAMETER.REFERENCE NAME=\"Job\" REFERENCECLASS=\"TST_Element\">"
              "</PARAMETER.REFERENCE><PARAMETER.ARRAY NAME=\"Codes\" TYPE=\"uint8\"></PARAMETER.ARRAY></METHOD></CLASS>");

    selection.properties = {"Status"};
    selection.class_origin = false;
    selection.qualifiers = true;
    EXPECT_NE(class_text(test::TST_Port, selection).find(description + "How it is.</VALUE>"), std::string::npos);

    EXPECT_EQ(class_text(test::TST_Link, {}),
              "<CLASS NAME=\"TST_Link\">" + fixed("Association") +
                  "<PROPERTY.REFERENCE NAME=\"Antecedent\" REFERENCECLASS=\"TST_Element\">" + fixed("Key") +
                  "</PROPERTY.REFERENCE><PROPERTY.REFERENCE NAME=\"Dependent\" REFERENCECLASS=\"TST_Port\">" + fixed("Key") +
                  fixed("Weak") + "</PROPERTY.REFERENCE></CLASS>");
}
