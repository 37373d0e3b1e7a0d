// Scenario files: how they are found, and the errors that name the place.
#include "tests/sim/simulated_host.h"
#include "tests/support/rows.h"
#include "tests/support/temporary_folder.h"

namespace
{

using Scenarios = Raw_Host;

TEST_F(Scenarios, name_the_place_of_every_error)
{
    hxasim::load("cna");
    const auto load_text = [](const std::string& json) { return refusal_of([&] { hxasim::load_text(json); }); };
    for (const auto& row : rows_of("wrong_scenarios.txt"))
        EXPECT_EQ(load_text(row[0]), row.at(1)) << row[0];
    EXPECT_THAT(load_text("{\"adapters\":\n [}"), testing::HasSubstr("line 2, column 3"));
    EXPECT_EQ(instances(Open_File("/dev/hxa"), 'C').first, 2U) << "a refused scenario must not replace the host";
}

TEST_F(Scenarios, are_found_by_name_or_by_path)
{
    const Temporary_Folder folder;
    const std::string path = folder.file("host.json", R"({"adapters": [{"kind": "fc-hba", "ports": [{}]}]})");
    hxasim::load(path);
    EXPECT_EQ(instances(Open_File("/dev/hxa"), 'C').first, 1U);
    folder.file("host.json", R"({"adapters": 1})");
    const std::pair<std::string, std::string> refused[] = {{"fc_hba", "fc_hba: no such shipped scenario"},
                                                           {"/no/such.json", "/no/such.json: No such file or directory"},
                                                           {"/dev/zero", "/dev/zero: not a regular file"},
                                                           {path, path + ": adapters: must be a list of at most 128 objects"}};
    for (const auto& row : refused)
        EXPECT_EQ(refusal_of([&] { hxasim::load(row.first); }), row.second);
}

} // namespace
