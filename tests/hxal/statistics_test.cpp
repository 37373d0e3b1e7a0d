// Counters by name: every name beside its counter, converted on status 0 only.
#include "tests/hxal/golden.h"
#include "tests/hxal/library_fixture.h"

#include <algorithm>
#include <cerrno>
#include <span>

namespace
{

// Counters that are their own position, from 0.
std::string counting(std::size_t size)
{
    std::string list;
    for (std::size_t i = 0; i < size; ++i)
        list += (i == 0 ? "[" : ", ") + std::to_string(i);
    return list + "]";
}

class Statistics : public Library_Test
{
protected:
    Statistics()
    {
        scan(R"({"adapters": [
            {"kind": "fc-hba", "ports": [{"counters": {"fc": )" +
             counting(29) + R"(, "qos": [8, 9],
                                                       "logical_port": )" +
             counting(43) + R"(}}]},
            {"kind": "cna", "ports": [{"counters": {"ethernet": )" +
             counting(38) + R"(, "fcoe": )" + counting(45) + R"(}}]}]})");
        fc = hxal_ioc_open_idx(0);
        fcoe = hxal_ioc_open_idx(1);
        ethernet = hxal_ioc_open_idx(2);
    }

    // The names of the pairs, read with one request. Their values have to be their positions, but for the first, which may have
    // counted on for a second or two; the pair behind the last has to be untouched.
    template <typename Pair, typename Read> static std::string names(int count, Read read)
    {
        Pair pairs[64];
        std::memset(pairs, 0xEE, sizeof pairs);
        EXPECT_EQ(read(pairs), HXA_STATUS_OK);
        EXPECT_EQ(commands().size(), 1u);
        std::string lines;
        for (int i = 0; i < count; ++i)
        {
            lines += std::string(pairs[i].name) + "\n";
            EXPECT_TRUE(i == 0 || pairs[i].value == static_cast<unsigned>(i)) << pairs[i].name << " " << pairs[i].value;
        }
        EXPECT_LE(pairs[0].value, 120u);
        EXPECT_EQ(pairs[count].name[0], static_cast<char>(0xEE));
        return lines + "\n";
    }

    static std::string port_names(const hxal_t* ioc, int count)
    {
        return names<hxal_stats_long_t>(count, [=](hxal_stats_long_t* pairs) { return hxal_port_get_stats(ioc, pairs); });
    }

    hxal_t* fc = nullptr;
    hxal_t* fcoe = nullptr;
    hxal_t* ethernet = nullptr;
};

TEST_F(Statistics, carry_the_names_of_their_kind)
{
    const auto of_fcoe = [this](hxal_stats_long_t* out) { return hxal_fcoe_get_stats(fcoe, out); };
    const auto of_logical = [this](hxal_stats_t* out) { return hxal_lport_get_stats(fc, 0, fc->pwwn, out); };
    const std::string of_ethernet = port_names(ethernet, HXAL_ETH_PORT_STATS);
    EXPECT_EQ(port_names(fcoe, HXAL_ETH_PORT_STATS), of_ethernet);
    EXPECT_EQ(port_names(fc, HXAL_FC_PORT_STATS) + of_ethernet + names<hxal_stats_long_t>(HXAL_FCOE_STATS, of_fcoe) +
                  names<hxal_stats_t>(HXAL_LPORT_STATS, of_logical),
              golden("statistics.txt"));
}

TEST_F(Statistics, are_converted_on_status_0_only)
{
    hxal_stats_long_t pairs[HXAL_FCOE_STATS];
    hxal_stats_t short_pairs[HXAL_LPORT_STATS];
    for (const hxa_status_t status : {HXA_STATUS_EINTR, HXA_STATUS_DEVBUSY})
    {
        hxasim::clear_faults();
        if (status == HXA_STATUS_EINTR)
            fail("", EINTR);
        else
            distort("", 0, {HXA_STATUS_DEVBUSY, 0, 0, 0}, {}, "");
        std::memset(pairs, 0xEE, sizeof pairs);
        std::memset(short_pairs, 0xEE, sizeof short_pairs);
        EXPECT_EQ(hxal_port_get_stats(fc, pairs), status);
        EXPECT_EQ(hxal_fcoe_get_stats(fcoe, pairs), status);
        EXPECT_EQ(hxal_lport_get_stats(fc, 0, fc->pwwn, short_pairs), status);
        EXPECT_THAT(std::as_bytes(std::span(pairs)), testing::Each(std::byte{0xEE}));
        EXPECT_THAT(std::as_bytes(std::span(short_pairs)), testing::Each(std::byte{0xEE}));
    }

    hxasim::take_requests();
    const hxa_status_t refused[] = {hxal_port_get_stats(nullptr, pairs),     hxal_lport_get_stats(nullptr, 0, 0, short_pairs),
                                    hxal_fcoe_get_stats(nullptr, pairs),     hxal_port_get_stats(fc, nullptr),
                                    hxal_lport_get_stats(fc, 0, 0, nullptr), hxal_fcoe_get_stats(fcoe, nullptr)};
    EXPECT_THAT(refused, testing::Each(HXA_STATUS_EINVAL));
    EXPECT_THAT(commands(), testing::IsEmpty());
}

TEST_F(Statistics, of_an_fc_port_under_fcoe_names_are_its_quality_of_service)
{
    hxal_stats_long_t pairs[HXAL_FCOE_STATS];
    EXPECT_EQ(hxal_fcoe_get_stats(fc, pairs), HXA_STATUS_OK);
    EXPECT_EQ(pairs[0].value, 8u | uint64_t{9} << 32);
}

TEST(Name_Value_Pairs, are_cut_to_their_field)
{
    const std::string longest(70, 'l');
    const char* names[] = {longest.c_str()};
    const uint64_t values[] = {UINT64_MAX};
    hxal_stats_long_t pair;
    hxal_stats_long_to_nv_pair(values, &pair, names, 1);
    EXPECT_EQ(std::string(pair.name), std::string(63, 'l'));
    EXPECT_EQ(pair.value, UINT64_MAX);
}

} // namespace
