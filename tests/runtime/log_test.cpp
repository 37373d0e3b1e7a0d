#include "runtime/log.h"

#include "runtime/file_lock.h"
#include "runtime/value.h"
#include "tests/runtime/home.h"
#include "tests/runtime/sample_classes.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cerrno>
#include <chrono>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <map>
#include <string>
#include <sys/stat.h>
#include <thread>
#include <vector>

using namespace zmlr;
using namespace sample;
using ::testing::ElementsAre;
using ::testing::EndsWith;
using ::testing::MatchesRegex;

namespace
{

constexpr const char* log_source = "FCHBAManager";

void log_one_of_each()
{
    for (Log_Level level : {LL_FATAL, LL_ERR, LL_WARN, LL_INFO, LL_DBG})
        ZMLR_LOG(level, "level %u", static_cast<unsigned>(level));
}

// The log is off: from the first call on, further ones must cost next to nothing.
void log_to_no_avail()
{
    log_one_of_each();
    if (log_wanted(LL_FATAL))
        std::abort();
}

TEST(Log, option_file_decides_what_is_written)
{
    const std::pair<std::string, std::size_t> rows[] = {
        {"LOG_LEVEL=FATAL\n", 1},
        {"LOG_LEVEL = warn", 3},
        {"# LOG_LEVEL=DBG\n\n   \nLOG_LEVEL\t=\t Info \r\n", 4},
        {"OTHER=1\nLOG_LEVEL=DBG\nLOG_LEVEL=ERR\n", 5},
        {"LOG_LEVEL_OLD=DBG\nLOG_LEVEL=ERR\n", 2},
        {std::string(100'000, '\n') + "LOG_LEVEL=ERR\n", 2},
        {"LOG_LEVEL DBG\nlog_level=DBG\n LOG_LEVEL=DBG\nLOG_LEVEL=err\n", 2},
    };
    for (const auto& [options, written] : rows)
    {
        const Home home;
        home.options(options);
        ASSERT_TRUE(home.run(log_one_of_each));
        EXPECT_EQ(home.lines().size(), written) << options;
        EXPECT_TRUE(home.has(".cimple/messages.lock"));
    }
}

TEST(Log, is_off_and_leaves_no_trace_without_a_valid_level)
{
    for (const char* options : {"", "LOG_LEVEL=VERBOSE\n", "LOG_LEVEL=\nLOG_LEVEL=DBG\n", "#LOG_LEVEL=DBG\n", "LOG_LEVEL=DBGS\n",
                                "LOG_LEVEL=DB\n", "log_level=DBG\n"})
    {
        const Home home;
        if (*options)
            home.options(options);
        ASSERT_TRUE(home.run(
            [&]
            {
                log_to_no_avail();
                home.options("LOG_LEVEL=DBG\n");
                log_to_no_avail();
            }));
        EXPECT_FALSE(home.has(".cimple")) << options << " and tried once only";
    }

    const Home home;
    home.options("LOG_LEVEL=DBG\n");
    EXPECT_TRUE(Home::finish(home.start(log_one_of_each, false))) << "HOME is unset";
    EXPECT_FALSE(home.has(".cimple"));
}

TEST(Log, writes_time_level_source_and_line)
{
    const Home home;
    home.options("LOG_LEVEL=INFO\n");
    std::filesystem::create_directory(home.path(".cimple")); // one more call that sets errno
    const std::string large(20000, 'x');
    ASSERT_TRUE(home.run(
        [&large]
        {
            errno = EBUSY;
            log(LL_ERR, "FCHBAManager", 120, "port %s: %d", "10000000C9000001", -5);
            if (errno != EBUSY || log_wanted(LL_DBG) || !log_wanted(LL_INFO))
                std::abort();
            log(LL_WARN, "PortHelper", 7, "already ended\n");
            log(LL_INFO, "PortHelper", 8, "%s", large.c_str());
            log(LL_INFO, "PortHelper", 9, "%s", "");
            log(LL_INFO, "Converter", 11, "%s", "name\r\n2026/11/25 ERR: \x1B[2J\t\xC2\x9B \xE2\x80\xAE\xC3\xA4\xFF\n\n");
            log(LL_DBG, "PortHelper", 10, "not written");
        }));
    const std::string time = "[0-9]{4}/[0-9]{2}/[0-9]{2} [0-9]{2}:[0-9]{2}:[0-9]{2} ";
    EXPECT_THAT(home.lines(), ElementsAre(MatchesRegex(time + "ERR: FCHBAManager\\(120\\): port 10000000C9000001: -5"),
                                          MatchesRegex(time + "WARN: PortHelper\\(7\\): already ended"),
                                          MatchesRegex(time + "INFO: PortHelper\\(8\\): x{16384}"),
                                          MatchesRegex(time + "INFO: PortHelper\\(9\\): "),
                                          EndsWith("Converter(11): name??2026/11/25 ERR: ?[2J\t? ?\xC3\xA4??")));
}

TEST(Log, lines_of_processes_and_threads_never_mix)
{
    constexpr int num_processes = 2;
    constexpr int num_threads = 8;
    constexpr int num_lines = 50;
    const Home home;
    home.options("LOG_LEVEL=INFO\n");

    std::vector<int> processes;
    for (char process = 'A'; process < 'A' + num_processes; ++process)
        processes.push_back(home.start(
            [process]
            {
                std::vector<std::thread> threads;
                for (char thread = 'a'; thread < 'a' + num_threads; ++thread)
                    threads.emplace_back(
                        [=]
                        {
                            const std::string text(5000, thread);
                            for (int i = 0; i < num_lines; ++i)
                                log(LL_INFO, log_source, i, "%c%s.", process, text.c_str());
                        });
                for (std::thread& thread : threads)
                    thread.join();
            }));
    for (int pid : processes)
        EXPECT_TRUE(Home::finish(pid));

    // Each writer's lines are whole and in their order.
    std::map<std::string, int> next;
    for (const std::string& line : home.lines())
    {
        const std::size_t begin = line.find("): ") + 3;
        const std::string text = line.substr(begin);
        ASSERT_EQ(text.size(), 5002U) << line;
        ASSERT_EQ(text.find_first_not_of(text[1], 1), 5001U) << line;
        const std::string source = "FCHBAManager(" + std::to_string(next[text.substr(0, 2)]++) + "): ";
        ASSERT_EQ(line.substr(begin - source.size(), source.size()), source);
    }
    EXPECT_EQ(next.size(), std::size_t{num_processes * num_threads});
    for (const auto& [writer, count] : next)
        EXPECT_EQ(count, num_lines) << writer;
}

TEST(Log, waits_for_another_process_that_holds_the_lock)
{
    const Home home;
    home.options("LOG_LEVEL=FATAL\n");
    ASSERT_TRUE(home.run(log_one_of_each));

    File_Lock lock(home.path(".cimple/messages.lock").c_str());
    ASSERT_TRUE(lock.okay());
    ASSERT_EQ(lock.lock(), 0);
    const int writer = home.start(log_one_of_each);
    std::this_thread::sleep_for(std::chrono::milliseconds(100));
    EXPECT_EQ(home.lines().size(), 1U);
    ASSERT_EQ(lock.unlock(), 0);
    EXPECT_TRUE(Home::finish(writer));
    EXPECT_EQ(home.lines().size(), 2U);

    EXPECT_FALSE(File_Lock(home.path("no such directory/lock").c_str()).okay());
}

// Everything but a plain file is refused at once, and nothing is read without end.
TEST(Log, stays_off_when_something_else_has_the_name_of_a_file)
{
    namespace fs = std::filesystem;
    using Make = void (*)(const std::string& path);
    const Make pipe = [](const std::string& path) { mkfifo(path.c_str(), 0600); };
    const Make file = [](const std::string& path) { std::fclose(std::fopen(path.c_str(), "w")); };
    const Make directory = [](const std::string& path) { fs::create_directory(path); };
    const Make endless_device = [](const std::string& path) { fs::create_symlink("/dev/zero", path); };
    const Make terabyte_of_nothing = [](const std::string& path)
    {
        std::fclose(std::fopen(path.c_str(), "w"));
        fs::resize_file(path, std::uintmax_t{1} << 40);
    };
    const std::pair<const char*, Make> rows[] = {
        {".cimplerc", directory}, {".cimplerc", pipe},        {".cimplerc", endless_device},   {".cimplerc", terabyte_of_nothing},
        {".cimple", file},        {".cimple/messages", pipe}, {".cimple/messages", directory}, {".cimple/messages.lock", pipe},
    };
    for (const auto& [name, make] : rows)
    {
        const Home home;
        const fs::path path(home.path(name));
        if (path.filename() != ".cimplerc")
            home.options("LOG_LEVEL=DBG\n");
        fs::create_directory(path.parent_path());
        make(path);
        EXPECT_TRUE(home.run(log_to_no_avail)) << name;
    }
}

void store_what_does_not_fit()
{
    const auto to = linked(element("a"), disk("d"));
    Value wrong;
    wrong.set_value(element("no disk").steal());
    wrong.get(to.ptr(), find_reference(to->meta_class, "Dependent"));
    wrong.get(to.ptr(), find_property(to->meta_class, "Note"));
    wrong.get(nullptr, find_property(to->meta_class, "Note"));
}

TEST(Log, warnings_name_class_and_feature)
{
    const Home home;
    home.options("LOG_LEVEL=WARN\n");
    ASSERT_TRUE(home.run(
        []
        {
            store_what_does_not_fit();
            if (log_set_level("loud") != -1 || log_set_level("Warn") != 0 || log_enable(true) != -1 || log_enable(false) != 0 ||
                log_enable(false) != -1)
                std::abort();
            store_what_does_not_fit();
            log(LL_WARN, "Other", 1, "still written");
        }));
    const std::string mark = ".* WARN: Value\\([0-9]+\\): ";
    EXPECT_THAT(home.lines(),
                ElementsAre(MatchesRegex(mark + "failed to assign instance of Sample_Element to Sample_Link.Dependent"),
                            MatchesRegex(mark + "type mismatch: Sample_Link.Note"), MatchesRegex(mark + "null instance argument"),
                            MatchesRegex(".*still written")));
}

} // namespace
