// Scenario files: how they are found, and the errors that name the place.
#include "tests/sim/simulated_host.h"
#include "tests/support/rows.h"
#include "tests/support/temporary_folder.h"

#include <numeric>

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

TEST_F(Scenarios, hold_texts_that_are_none_and_counters_that_differ)
{
    hxasim::load_text(
        R"({"adapters": [{"kind": "fc-hba", "serial": {"hex": "41FF00"}, "ports": [{"counters": {"from": 100}}]}]})");
    Open_File hxa("/dev/hxa");
    EXPECT_EQ(digits_of(info(hxa, 'C', 0).serialnum).substr(0, 8), "41FF0000");
    hxa_pport_stats_t counters{};
    hxa_ioctl_port_stats_t record{};
    record.buf_size = sizeof(counters);
    record.buf_ptr = reinterpret_cast<std::uintptr_t>(&counters);
    EXPECT_EQ(send(*hxa, "IOCMD_PORT_GET_STATS", 'C', record), 0);
    EXPECT_EQ(counters.fc.tx_frames, 101U);
    EXPECT_EQ(counters.fc.err_enc, 128U);
}

TEST_F(Scenarios, carry_vital_product_data_that_holds_together)
{
    hxasim::load_text(R"({"adapters": [{"kind": "fc-hba", "fru_number": "FRU1234567890ABC"}]})");
    const auto vpd = ask<hxa_ioctl_ioc_attr_t>(Open_File("/dev/hxa"), "IOCMD_IOC_GET_ATTR", 'C', 0).attr.adapter_attr.vpd;
    const std::string data(std::begin(vpd.data), std::end(vpd.data));
    EXPECT_THAT(data.substr(175), testing::StartsWith("FRU1234567890ABC"));
    EXPECT_EQ(std::accumulate(vpd.data, vpd.data + data.find("RV") + 4, 0) % 256, 0);
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
