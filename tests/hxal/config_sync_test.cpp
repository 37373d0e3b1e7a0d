// Replacing the file: the new one whole, or the old one untouched.
#include "config_fixture.h"

#include <fcntl.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

namespace
{

using testing::UnorderedElementsAre;

class Config_Sync : public Config_Model
{
protected:
    Config_Sync() { parse({"hxa1-port-speed = 4;"}); }

    static struct stat status_of(const std::string& path)
    {
        struct stat status = {};
        EXPECT_EQ(::stat(path.c_str(), &status), 0) << path;
        return status;
    }

    // The status of a sync in a process of its own, prepared so.
    template <typename Prepare> static int sync_after(Prepare prepare, const std::string& path)
    {
        const pid_t child = ::fork();
        if (child == 0)
            ::_exit(prepare() ? static_cast<int>(hxal_config_sync(path.c_str())) : 255);
        int result = 0;
        EXPECT_EQ(::waitpid(child, &result, 0), child);
        return WIFEXITED(result) ? WEXITSTATUS(result) : -1;
    }

    static bool is_root() { return ::geteuid() == 0; }

    // Permissions do not bind root.
    static bool as_user()
    {
        return !is_root() || (::setresgid(65534, 65534, 65534) == 0 && ::setresuid(65534, 65534, 65534) == 0);
    }

    // A limit of the process, whose signal must not end it.
    static bool on_a_full_disk()
    {
        const rlimit room = {.rlim_cur = 512, .rlim_max = 512};
        return ::setrlimit(RLIMIT_FSIZE, &room) == 0;
    }
};

TEST_F(Config_Sync, makes_a_file_for_its_owner_alone)
{
    EXPECT_EQ(hxal_config_sync(path("hxa.conf").c_str()), HXA_STATUS_OK);
    EXPECT_EQ(content(path("hxa.conf")), written());
    EXPECT_EQ(status_of(path("hxa.conf")).st_mode & 07777, 0600u);
    EXPECT_THAT(names(), UnorderedElementsAre("hxa.conf"));
}

TEST_F(Config_Sync, replaces_a_file_and_keeps_owner_and_mode)
{
    const std::string conf = file("hxa.conf", std::string(100000, '#'));
    const auto [user, group] = is_root() ? std::pair{12345u, 54321u} : std::pair{::getuid(), ::getgid()};
    ASSERT_EQ(::chown(conf.c_str(), user, group) | ::chmod(conf.c_str(), 0640), 0);
    const auto before = status_of(conf);
    EXPECT_EQ(hxal_config_sync(conf.c_str()), HXA_STATUS_OK);
    const auto after = status_of(conf);
    EXPECT_EQ(content(conf), written());
    EXPECT_EQ(after.st_mode & 07777, 0640u);
    EXPECT_EQ(std::pair(after.st_uid, after.st_gid), std::pair(user, group));
    EXPECT_NE(after.st_ino, before.st_ino) << "written in place";
    EXPECT_THAT(names(), UnorderedElementsAre("hxa.conf"));
}

TEST_F(Config_Sync, follows_a_link_that_stays)
{
    std::filesystem::create_directory(path("etc"));
    const std::string conf = file("etc/hxa.conf", "");
    std::filesystem::create_symlink(conf, path("link"));
    EXPECT_EQ(hxal_config_sync(path("link").c_str()), HXA_STATUS_OK);
    EXPECT_EQ(content(conf), written());
    EXPECT_TRUE(std::filesystem::is_symlink(path("link")));
}

TEST_F(Config_Sync, answers_45_where_no_file_can_be_opened)
{
    ASSERT_EQ(::mkfifo(path("fifo").c_str(), 0600), 0);
    std::filesystem::create_symlink(path("nowhere"), path("link"));
    std::filesystem::create_directory(path("directory"));
    const std::string device = "/dev/full";
    for (const std::string& what : {path("missing/hxa.conf"), path("directory"), path("fifo"), path("link"), device,
                                    std::string(), path(std::string(300, 'x')), path(std::string(5000, '/') + "x")})
        EXPECT_EQ(hxal_config_sync(what.c_str()), HXA_STATUS_EFOPEN) << what;
    EXPECT_EQ(hxal_config_sync(nullptr), HXA_STATUS_EFOPEN);
    EXPECT_THAT(names(), UnorderedElementsAre("fifo", "link", "directory"));
}

TEST_F(Config_Sync, leaves_alone_what_a_process_has_open)
{
    const std::string log = file("log", "mine");
    const int descriptor = ::open(log.c_str(), O_RDWR | O_CLOEXEC);
    std::filesystem::create_symlink("/dev/fd/" + std::to_string(descriptor), path("link"));
    std::filesystem::create_symlink("link", path("stdout"));
    for (const std::string& what : {path("link"), path("stdout"), "/proc/self/fd/" + std::to_string(descriptor)})
        EXPECT_EQ(hxal_config_sync(what.c_str()), HXA_STATUS_EFOPEN) << what;
    ::close(descriptor);
    EXPECT_EQ(content(log), "mine");
    EXPECT_THAT(names(), UnorderedElementsAre("log", "link", "stdout"));
}

TEST_F(Config_Sync, asks_for_the_permission_to_write)
{
    std::filesystem::permissions(path("."), std::filesystem::perms(0755));
    const std::string conf = file("hxa.conf", "old");
    ASSERT_EQ(::chmod(conf.c_str(), 0444), 0);
    EXPECT_EQ(sync_after(as_user, conf), HXA_STATUS_EFOPEN);
    ASSERT_EQ(::chmod(conf.c_str(), 0666) | ::chmod(path(".").c_str(), 0555), 0);
    EXPECT_EQ(sync_after(as_user, conf), HXA_STATUS_EFOPEN) << "no room for the temporary file";
    ASSERT_EQ(::chmod(path(".").c_str(), 0777), 0);
    EXPECT_EQ(sync_after(as_user, conf), is_root() ? HXA_STATUS_FAILED : HXA_STATUS_OK) << "root's file stays root's";
    EXPECT_EQ(content(conf), is_root() ? "old" : written());
    EXPECT_THAT(names(), UnorderedElementsAre("hxa.conf"));
}

TEST_F(Config_Sync, leaves_the_old_file_on_a_full_disk)
{
    const std::string conf = file("hxa.conf", "old");
    EXPECT_EQ(sync_after(on_a_full_disk, conf), HXA_STATUS_FAILED);
    EXPECT_EQ(content(conf), "old");
    EXPECT_EQ(sync_after(on_a_full_disk, path("new.conf")), HXA_STATUS_FAILED);
    EXPECT_THAT(names(), UnorderedElementsAre("hxa.conf"));
}

} // namespace
