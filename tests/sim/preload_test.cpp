// The simulator preloaded into a program that was not linked with it.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <array>
#include <cstdio>
#include <fstream>
#include <memory>
#include <string>

namespace
{

// Standard output and error of the probe under this environment.
std::string run_probe(const std::string& environment)
{
    std::string command = "env " + environment + " " PROBE " 2>&1";
    std::unique_ptr<FILE, int (*)(FILE*)> pipe(popen(command.c_str(), "r"), pclose);
    std::string output;
    std::array<char, 256> line{};
    while (pipe && fgets(line.data(), line.size(), pipe.get()))
        output += line.data();
    return output;
}

std::string run_preloaded(const std::string& scenario) { return run_probe("LD_PRELOAD=" SIMULATOR " " + scenario); }

TEST(Preload, serves_the_scenario_of_the_environment)
{
    EXPECT_EQ(run_preloaded("HXASIM_SCENARIO=mixed"), "/dev/hxa: 8\n/dev/hxn: 4\n");
    EXPECT_EQ(run_preloaded("HXASIM_SCENARIO=no-driver"),
              "/dev/hxa: open: No such file or directory\n/dev/hxn: open: No such file or directory\n");
}

TEST(Preload, applies_the_faults_of_the_scenario)
{
    std::string path = testing::TempDir() + "sim_preload_test.json";
    std::ofstream(path) << R"({"generate": {"kind": "cna"}, "faults": [{"node": "/dev/hxn", "error": "EIO"}]})";
    EXPECT_EQ(run_preloaded("HXASIM_SCENARIO=" + path), "/dev/hxa: 2\n/dev/hxn: ioctl: Input/output error\n");
    std::remove(path.c_str());
}

TEST(Preload, says_what_is_wrong_with_a_scenario_once_and_has_no_device)
{
    EXPECT_EQ(run_preloaded("HXASIM_SCENARIO=nonesuch"), "hxasim: HXASIM_SCENARIO=nonesuch: nonesuch: no such shipped scenario\n"
                                                         "/dev/hxa: open: No such device\n/dev/hxn: open: No such device\n");
}

TEST(Preload, shortens_sleeps_as_the_environment_says)
{
    const std::string served = "/dev/hxa: 2\n/dev/hxn: 2\n";
    const std::string cna = "PROBE_SLEEP=3600 HXASIM_SCENARIO=cna HXASIM_TIME_SCALE=";
    EXPECT_EQ(run_preloaded(cna + "0.00001"), served);
    EXPECT_EQ(run_preloaded("HXASIM_SCENARIO=cna PROBE_SLEEP=0 HXASIM_TIME_SCALE=2"),
              "hxasim: HXASIM_TIME_SCALE=2: must be a number from 0 to 1\n" + served);
}

TEST(Preload, is_transparent_without_a_scenario) { EXPECT_EQ(run_preloaded(""), run_probe("-u LD_PRELOAD")); }

} // namespace
