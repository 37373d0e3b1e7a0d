// The generated qualifier table: usable by binary search, and every code has its text.
#include "cimserver/model/qualifier_table.h"
#include "schema/repository.h"

#include <gtest/gtest.h>

#include <set>
#include <span>
#include <string>
#include <strings.h>

namespace
{

using cimserver::Qualifier_Row;

std::span<const Qualifier_Row> rows() { return {cimserver::qualifier_table, cimserver::qualifier_table_size}; }

const Qualifier_Row* find(const char* class_name, const char* feature_name, const char* name, const char* parameter = "")
{
    for (const Qualifier_Row& row : rows())
        if (!strcasecmp(row.class_name, class_name) && !strcasecmp(row.feature_name, feature_name) &&
            !strcasecmp(row.parameter_name, parameter) && !strcasecmp(row.name, name))
            return &row;
    return nullptr;
}

TEST(Qualifier_Table, is_sorted_without_duplicates)
{
    const auto order = [](const Qualifier_Row& a, const Qualifier_Row& b)
    {
        int result = strcasecmp(a.class_name, b.class_name);
        result = result ? result : strcasecmp(a.feature_name, b.feature_name);
        result = result ? result : strcasecmp(a.parameter_name, b.parameter_name);
        return result ? result : strcasecmp(a.name, b.name);
    };
    for (std::size_t i = 1; i < rows().size(); i++)
        EXPECT_LT(order(rows()[i - 1], rows()[i]), 0) << rows()[i].class_name << "." << rows()[i].feature_name;
}

TEST(Qualifier_Table, every_code_has_one_text)
{
    unsigned maps = 0;
    for (const Qualifier_Row& row : rows())
    {
        if (std::string(row.name) != "ValueMap")
            continue;
        SCOPED_TRACE(std::string(row.class_name) + "." + row.feature_name);
        maps++;
        const Qualifier_Row* texts = find(row.class_name, row.feature_name, "Values", row.parameter_name);
        ASSERT_NE(texts, nullptr);
        EXPECT_TRUE(row.array && texts->array);
        EXPECT_EQ(row.num_values, texts->num_values);
        EXPECT_EQ(std::set<std::string>(row.values, row.values + row.num_values).size(), row.num_values);
    }
    EXPECT_GT(maps, 40u);
}

// The meta-data's flag and the table's row go together: the one says that it is an instance, the other of which class.
TEST(Qualifier_Table, every_embedded_instance_has_its_class_and_every_served_class_a_description)
{
    const zmlr::Meta_Repository& repository = zmlr::meta_repository();
    for (const zmlr::Meta_Class* c : std::span(repository.meta_classes, repository.num_meta_classes))
    {
        EXPECT_TRUE(find(c->name, "", "Description") || !std::string(c->name).starts_with("ZEMLAR_")) << c->name;
        for (zmlr::uint32 i = 0; i < c->num_meta_features; i++)
        {
            const zmlr::Meta_Feature* feature = c->meta_features[i];
            const bool flagged = c->locals[i].local && (feature->flags & zmlr::Flag_EmbeddedInstance) != 0;
            EXPECT_EQ(find(c->name, feature->name, "EmbeddedInstance") != nullptr, flagged) << c->name << "." << feature->name;
        }
    }
}

} // namespace
