// Only the two nodes and their descriptors are simulated; every other call reaches the system.
#include "tests/sim/simulated_host.h"

#include <sys/wait.h>

#include <atomic>
#include <thread>

extern "C"
{
    int __open_2(const char* path, int flags);
    int __open64_2(const char* path, int flags);
    int __openat_2(int folder, const char* path, int flags);
    int __openat64_2(int folder, const char* path, int flags);
}

namespace
{

class Interposer : public Raw_Host
{
protected:
    Interposer() : Raw_Host("cna") {}
};

using Opener = int (*)(const char* path);

const std::pair<const char*, Opener> openers[] = {
    {"open", [](const char* path) { return open(path, O_RDWR); }},
    {"open64", [](const char* path) { return open64(path, O_RDWR); }},
    {"openat", [](const char* path) { return openat(AT_FDCWD, path, O_RDWR); }},
    {"openat64", [](const char* path) { return openat64(-1, path, O_RDWR); }},
    {"__open_2", [](const char* path) { return __open_2(path, O_RDWR); }},
    {"__open64_2", [](const char* path) { return __open64_2(path, O_RDWR); }},
    {"__openat_2", [](const char* path) { return __openat_2(AT_FDCWD, path, O_RDWR); }},
    {"__openat64_2", [](const char* path) { return __openat64_2(-1, path, O_RDWR); }},
};

TEST_F(Interposer, opens_nodes_by_every_form_of_open)
{
    for (const auto& [form, opener] : openers)
    {
        SCOPED_TRACE(form);
        Open_File node(opener("/dev/hxa"));
        EXPECT_EQ(hxasim::open_descriptors(), 1);
        EXPECT_EQ(instances(node, 'C').first, 2U);
        Open_File null(opener("/dev/null"));
        EXPECT_EQ(write(*null, "x", 1), 1);
        EXPECT_EQ(opener("/no/such/file"), -1);
        EXPECT_EQ(errno, ENOENT);
        EXPECT_EQ(hxasim::open_descriptors(), 1);
    }
    EXPECT_EQ(hxasim::open_descriptors(), 0);
}

TEST_F(Interposer, forgets_a_descriptor_when_it_is_closed)
{
    Open_File node(open("/dev/hxa", O_RDWR | O_CLOEXEC));
    EXPECT_EQ(fcntl(*node, F_GETFD), FD_CLOEXEC);
    int number = *node;
    node.close_now();
    Open_File reused("/dev/null");
    ASSERT_EQ(*reused, number);
    hxa_ioctl_ioc_get_inst_t record{};
    EXPECT_EQ(send(number, "IOCMD_IOC_GET_INST", 'C', record), ENOTTY);
}

TEST_F(Interposer, answers_nothing_on_descriptors_of_an_earlier_host)
{
    Open_File old("/dev/hxa");
    hxasim::load("mixed");
    hxa_ioctl_ioc_get_inst_t record{};
    EXPECT_EQ(send(*old, "IOCMD_IOC_GET_INST", 'C', record), ENODEV);
    EXPECT_EQ(hxasim::open_descriptors(), 1);
    EXPECT_EQ(instances(Open_File("/dev/hxa"), 'C').first, 8U);
    hxasim::unload();
    EXPECT_EQ(send(*old, "IOCMD_IOC_GET_INST", 'C', record), ENODEV);
}

TEST_F(Interposer, serves_threads_and_a_child_that_is_forked_among_them)
{
    std::atomic<bool> stop = false;
    auto work = [&]
    {
        while (!stop)
        {
            Open_File node("/dev/hxa");
            EXPECT_EQ(instances(node, 'C').first, 2U);
            hxasim::inject({.command = "IOCMD_PORT_GET_ATTR", .error = EIO, .times = 1});
            hxasim::take_requests();
        }
    };
    std::thread first(work);
    std::thread second(work);
    for (int round = 0; round < 20; ++round)
    {
        Open_File node("/dev/hxn");
        pid_t child = fork();
        if (child == 0)
        {
            hxa_ioctl_ioc_get_inst_t record{};
            _exit(send(*node, "IOCMD_IOC_GET_INST", 'D', record) == 0 && record.cnt == 2 ? 0 : 1);
        }
        int status = -1;
        EXPECT_EQ(waitpid(child, &status, 0), child);
        EXPECT_EQ(status, 0);
    }
    stop = true;
    first.join();
    second.join();
}

} // namespace
