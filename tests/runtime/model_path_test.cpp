#include "runtime/model_path.h"

#include "tests/runtime/sample_classes.h"
#include "tests/support/rows.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

using namespace zmlr;
using namespace sample;

namespace
{

// What a path is written as after it has been read, or "-" when it is not one.
std::string rewritten(const Meta_Class* meta_class, const std::string& path)
{
    const Ref<Instance> instance(model_path_to_instance(meta_class, path.c_str()));
    String again;
    if (!instance || instance_to_model_path(instance.ptr(), again) != 0)
        return "-";
    return again.c_str();
}

// A class named Keyed whose only feature is a key K of the type.
struct Keyed
{
    explicit Keyed(Type type, sint16 subscript = 0)
        : key(*property<Sample_Element>("Delta"))
        , meta_class(Sample_Setting::static_meta_class)
    {
        key.name = "K";
        key.flags |= Flag_Key;
        key.type = static_cast<uint16>(type);
        key.subscript = subscript;
        meta_class.name = "Keyed";
        meta_class.meta_features = features;
        meta_class.num_meta_features = 1;
        meta_class.size = sizeof(Sample_Element);
    }

    Meta_Property key;
    const Meta_Feature* features[1] = {&key};
    Meta_Class meta_class;
};

TEST(Model_Path, values_of_every_type)
{
    for (const auto& row : rows_of("model_paths.txt"))
    {
        Type type = UINT8;
        if (type_name_to_type(row[0].c_str(), type) != 0)
        {
            EXPECT_EQ(model_path_to_instance(&Sample_Element::static_meta_class, row.at(1).c_str()), nullptr) << row[1];
            continue;
        }
        const Keyed keyed(type);
        const std::string written = row.at(2) == "refused" ? "-" : "Keyed.K=" + row[2];
        EXPECT_EQ(rewritten(&keyed.meta_class, "keyed.k=" + row[1]), written) << row[0] << " " << row[1];
    }

    const std::string largest = "Keyed.K=-179769313486231570" + std::string(291, '0') + ".000000";
    const Keyed real(REAL64), array(UINT32, -1);
    EXPECT_EQ(rewritten(&real.meta_class, rewritten(&real.meta_class, largest)).size(), largest.size());
    EXPECT_EQ(rewritten(&array.meta_class, "Keyed.K=1"), "-");
    String path;
    EXPECT_EQ(instance_to_model_path(Ref<Instance>(create(&array.meta_class, false)).ptr(), path), -1);
}

TEST(Model_Path, references_are_quoted_paths)
{
    String path;
    EXPECT_EQ(instance_to_model_path(linked(element("a"), disk("d")).ptr(), path), 0);
    const std::string written = R"(Sample_Link.Antecedent="Sample_Element.Name=\"a\"",Dependent="Sample_Disk.Name=\"d\"")";
    EXPECT_EQ(path, written.c_str());
    EXPECT_EQ(rewritten(&Sample_Link::static_meta_class, written), written);

    // The keys in another order, a class of the repository, a subclass at the far end, escapes of both levels.
    const Ref<Instance> read(model_path_to_instance(
        &Sample_Person::static_meta_class,
        R"(sample_link.DEPENDENT="Sample_Disk.Name=\"d\"",Antecedent="Sample_Disk.Name=\"C:\\\\ \\\"x\\\"\"")"));
    const auto* link = cast<Sample_Link>(static_cast<const Instance*>(read.ptr()));
    ASSERT_NE(link, nullptr);
    EXPECT_EQ(link->Antecedent->meta_class, &Sample_Disk::static_meta_class);
    EXPECT_EQ(link->Antecedent->Name.value, R"(C:\ "x")");
    EXPECT_TRUE(link->Note.null);
    const char* const half = R"(Sample_Link.Dependent="Sample_Disk.Name=\"d\"")";
    EXPECT_FALSE(keys_non_null(Ref<Instance>(model_path_to_instance(link->meta_class, half)).ptr()));

    const auto own = element("a");
    EXPECT_EQ(instance_to_model_path(own.ptr(), own->Name.value), 0);
    EXPECT_EQ(own->Name.value, "Sample_Element.Name=\"a\"") << "into the key itself";

    EXPECT_EQ(instance_to_model_path(linked(element("a"), {}).ptr(), path), -1);
    const Ref<Sample_Element> nameless(create<Sample_Element>());
    EXPECT_EQ(instance_to_model_path(linked(nameless, disk("d")).ptr(), path), -1);
    EXPECT_EQ(instance_to_model_path(Ref<Sample_Setting>(create<Sample_Setting>()).ptr(), path), -1);
}

TEST(Model_Path, no_length_and_no_depth_harms)
{
    const std::string quotes(10000, '"');
    std::string nested;
    for (int i = 0; i < 10000; ++i)
        nested += R"(Sample_Link.Antecedent=\")";
    const std::string rows[] = {
        "Sample_Element.Name=" + quotes,
        "Sample_Link.Antecedent=\"" + nested,
        "Sample_Link.Antecedent=\"" + nested + "\"",
        std::string(1 << 20, 'a'),
        std::string(1 << 20, '\\'),
        "Sample_Element.Name=\"" + std::string(1 << 20, '\xFF'),
    };
    for (const std::string& row : rows)
        EXPECT_EQ(model_path_to_instance(&Sample_Element::static_meta_class, row.c_str()), nullptr) << row.substr(0, 100);

    const std::string name(1 << 20, 'a');
    EXPECT_EQ(rewritten(&Sample_Element::static_meta_class, "Sample_Element.Name=\"" + name + "\""),
              "Sample_Element.Name=\"" + name + "\"");
}

} // namespace
