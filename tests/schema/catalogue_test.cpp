// The classes as clients know them, and what the table of providers says of them.
#include "runtime/features.h"
#include "schema/repository.h"

#include <gtest/gtest.h>

#include <bit>
#include <fstream>
#include <iterator>
#include <span>
#include <string>

namespace zmlr
{
namespace
{

// "Name : Superclass (kind) Key Key>Class": the keys in their order, with the class at the end of each reference.
std::string described(const Meta_Class* meta_class)
{
    std::string text = meta_class->name;
    text += meta_class->super_meta_class ? std::string(" : ") + meta_class->super_meta_class->name : "";
    for (const uint32 flag : {Flag_Abstract, Flag_Association, Flag_Aggregation, Flag_Indication})
        text += meta_class->flags & flag ? std::string(" (") + flag_names[std::countr_zero(flag)] + ")" : "";
    for (const Meta_Feature* feature : features_of(meta_class))
        if (is_key(feature))
            text += std::string(" ") + feature->name +
                    (is_reference(feature) ? std::string(">") + as_reference(feature)->meta_class->name : "");
    return text + "\n";
}

// A change of the file is a change of what clients see.
TEST(Catalogue, is_the_one_that_clients_know)
{
    std::string catalogue;
    for (const Meta_Class* meta_class : std::span(meta_repository().meta_classes, meta_repository().num_meta_classes))
        catalogue += described(meta_class);
    std::ifstream golden(TEST_TABLES "/catalogue.txt");
    EXPECT_EQ(catalogue, std::string(std::istreambuf_iterator<char>(golden), {}));
}

// What a provider offers must be what its class is.
TEST(Catalogue, every_registered_class_is_of_the_kind_that_its_provider_serves)
{
    constexpr uint32 INSTANCE = 0, ASSOCIATION = Flag_Association, INDICATION = Flag_Indication;
    constexpr std::pair<const char*, uint32> rows[] = {
#define ZMLR_PROVIDER(class_name, interfaces, state) {#class_name, interfaces},
#include "providers/providers.def"
#undef ZMLR_PROVIDER
    };
    EXPECT_EQ(std::size(rows), 75u); // all but the abstraction over the diagnostic tests
    for (const auto& [name, kind] : rows)
    {
        const Meta_Class* meta_class = find_meta_class(&meta_repository(), name);
        ASSERT_NE(meta_class, nullptr) << name;
        EXPECT_EQ(meta_class->flags & (Flag_Association | Flag_Indication | Flag_Abstract), kind) << name;
    }
}

} // namespace
} // namespace zmlr
