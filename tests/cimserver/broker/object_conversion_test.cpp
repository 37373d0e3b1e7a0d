// Instances of a request become instances of their class, or are refused; embedded ones above all.
#include "cimserver/object_conversion.h"

#include "loaded_module.h"

namespace cimserver
{
namespace
{

class Object_Conversion : public Loaded_Module
{
protected:
    static std::string element(const std::string& class_name, const std::string& inside)
    {
        return "<INSTANCE CLASSNAME=\"" + class_name + "\">" + inside + "</INSTANCE>";
    }
    static std::string property(const std::string& name, const std::string& value)
    {
        return "<PROPERTY NAME=\"" + name + "\" TYPE=\"string\"><VALUE>" + value + "</VALUE></PROPERTY>";
    }

    Instance typed(std::vector<Named_Value> keys, std::vector<Named_Value> properties)
    {
        const Instance given{{"", "root/zemlar", "tst_disk", std::move(keys)}, std::move(properties)};
        const Repository& classes = module.repository();
        return typed_instance(classes, *classes.find("TST_Disk"), given, CIM_ERR_NO_SUCH_PROPERTY);
    }

    Instance embedded(const std::string& xml)
    {
        const Instance disk = typed({}, {{"detail", text(xml)}});
        return *std::get<std::shared_ptr<const Instance>>(disk.properties.at(0).value.content);
    }
};

TEST_F(Object_Conversion, an_embedded_instance_has_the_types_of_its_own_class)
{
    const Instance tape =
        embedded("<?xml version=\"1.0\"?>" + element("tst_tape", property("speed", " 0x10 ") + property("ID", "t")));
    EXPECT_EQ(tape.path.class_name, "TST_Tape");
    EXPECT_EQ(tape.path.name_space, "root/zemlar");
    ASSERT_EQ(tape.properties.size(), 2U);
    EXPECT_EQ(tape.properties[0].name, "Speed");
    EXPECT_EQ(tape.properties[0].value.type, CMPI_uint32);
    EXPECT_EQ(std::get<std::uint64_t>(tape.properties[0].value.content), 16U);
}

TEST_F(Object_Conversion, an_embedded_instance_that_is_none_is_refused)
{
    std::string nested = element("TST_Disk", "");
    for (int i = 0; i < 5; ++i)
    {
        std::string escaped;
        for (const char c : nested)
            escaped += c == '<' ? "&lt;" : c == '&' ? "&amp;" : std::string(1, c);
        nested = element("TST_Disk", property("Detail", escaped));
    }
    const std::string cases[] = {
        "",
        "tape0",
        "<INSTANCE",
        "<CLASS NAME=\"TST_Tape\"/>",
        "<INSTANCE/>",
        element("TST_Unknown", ""),
        element("TST_Alert", ""),
        element("TST_Tape", property("Colour", "red")),
        element("TST_Tape", property("Speed", "fast")),
        element("TST_Tape", property("Speed", "1") + property("SPEED", "2")),
        element("TST_Tape", "<PROPERTY NAME=\"Speed\" TYPE=\"uint32\"><VALUE>1</VALUE><VALUE>2</VALUE></PROPERTY>"),
        "<!DOCTYPE x><INSTANCE CLASSNAME=\"TST_Tape\"/>",
        nested,
    };
    for (const std::string& xml : cases)
        EXPECT_EQ(error_of([&] { embedded(xml); }), CIM_ERR_INVALID_PARAMETER) << xml;
}

TEST_F(Object_Conversion, keys_stand_in_the_path_and_among_the_properties)
{
    const Instance by_path = typed({{"ID", text("disk1")}}, {{"name", text("x")}});
    ASSERT_EQ(by_path.properties.size(), 2U);
    EXPECT_EQ(by_path.properties[1].name, "Id");
    EXPECT_EQ(std::get<std::string>(by_path.properties[1].value.content), "disk1");

    const Instance by_property = typed({}, {{"id", text("disk1")}});
    ASSERT_EQ(by_property.path.keys.size(), 1U);
    EXPECT_EQ(by_property.path.keys[0].name, "Id");

    EXPECT_EQ(typed({{"Id", text("disk1")}}, {{"Id", text("disk1")}}).properties.size(), 1U);
    EXPECT_EQ(error_of([&] { typed({{"Id", text("disk1")}}, {{"Id", text("disk2")}}); }), CIM_ERR_INVALID_PARAMETER);
    EXPECT_EQ(error_of([&] { typed({}, {{"Colour", text("red")}}); }), CIM_ERR_NO_SUCH_PROPERTY);
    EXPECT_EQ(error_of([&] { typed({}, {{"Reset", text("a method")}}); }), CIM_ERR_NO_SUCH_PROPERTY);
}

TEST_F(Object_Conversion, a_null_is_a_null_of_its_type)
{
    constexpr CMPIType strings = CMPI_string | CMPI_ARRAY;
    const Instance disk =
        typed({}, {{"Uint16s", {}}, {"Detail", {}}, {"Strings", {strings, std::vector<Value>{{CMPI_string, {}}}}}});
    EXPECT_TRUE(disk.properties[0].value.null());
    EXPECT_EQ(disk.properties[0].value.type, CMPI_uint16 | CMPI_ARRAY);
    EXPECT_EQ(disk.properties[1].value.type, CMPI_instance);
    EXPECT_TRUE(std::get<std::vector<Value>>(disk.properties[2].value.content).at(0).null());
}

} // namespace
} // namespace cimserver
