// Only the two nodes and their descriptors are simulated; every other call reaches the system.
#include "tests/sim/simulated_host.h"

#include <sys/stat.h>
#include <sys/syscall.h>
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

class Interposer : public Simulated_Host
{
protected:
    Interposer() : Simulated_Host("cna") {}
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

TEST_F(Interposer, leaves_other_files_to_the_system)
{
    std::string path = testing::TempDir() + "sim_interposer_test";
    unlink(path.c_str());
    Open_File file(open(path.c_str(), O_RDWR | O_CREAT | O_EXCL, 0640));
    ASSERT_GE(*file, 0);
    struct stat status = {};
    fstat(*file, &status);
    EXPECT_EQ(status.st_mode & 0777 & ~0640U, 0U);
    EXPECT_NE(status.st_mode & 0400, 0U);
    ASSERT_EQ(write(*file, "12345", 5), 5);
    lseek(*file, 2, SEEK_SET);
    int unread = 0;
    EXPECT_EQ(ioctl(*file, FIONREAD, &unread), 0);
    EXPECT_EQ(unread, 3);
    EXPECT_EQ(ioctl(*file, code_of("IOCMD_IOC_GET_INST", 'C'), &unread), -1);
    EXPECT_EQ(errno, ENOTTY);
    EXPECT_EQ(close(-1), -1);
    EXPECT_EQ(errno, EBADF);
    unlink(path.c_str());
    EXPECT_TRUE(hxasim::take_requests().empty());
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

TEST_F(Interposer, has_no_nodes_without_drivers_or_without_a_scenario)
{
    hxasim::load("no-driver");
    for (const char* path : {"/dev/hxa", "/dev/hxn"})
    {
        EXPECT_EQ(open(path, O_RDWR), -1);
        EXPECT_EQ(errno, ENOENT);
    }
    hxasim::unload();
    EXPECT_EQ(Open_File("/dev/hxa").operator*(), static_cast<int>(syscall(SYS_openat, AT_FDCWD, "/dev/hxa", O_RDWR)));
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
