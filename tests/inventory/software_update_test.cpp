// Boot code on its way into the flash, and the commands that this module runs in a process that it does not know.
#include "inventory/fchba_manager.h"
#include "inventory/shell_command.h"
#include "inventory/software_update_helper.h"
#include "tests/hxal/boot_files.h"
#include "tests/inventory/inventory_fixture.h"

#include <sys/wait.h>
#include <unistd.h>

#include <chrono>
#include <csignal>

using namespace zmlr;
using namespace std::chrono_literals;
using testing::Contains;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;

namespace
{

class Software_Update : public Inventory_Test
{
protected:
    ~Software_Update() override
    {
        signal(SIGCHLD, SIG_DFL);
        signal(SIGUSR1, SIG_DFL);
        unlink(_file.c_str());
        close(_inherited);
    }

    const std::string _file = testing::TempDir() + "update-" + std::to_string(getpid());
    int _inherited = -1;
};

int update(const char* address, const std::string& file)
{
    const Ref<ZEMLAR_PortController> controller(ZEMLAR_PortController::create());
    controller->DeviceID.set(address);
    const SoftwareUpdateHelper& helper = SoftwareUpdateHelper::getSoftwareUpdateHelperInstance();
    return helper.UpdatePortControllerSoftware(*controller.ptr(), file.c_str());
}

void reap_all(int)
{
    while (waitpid(-1, nullptr, WNOHANG) > 0)
    {
    }
}

} // namespace

TEST_F(Software_Update, writes_the_image_to_the_card_of_the_controller)
{
    const Bytes image = {1, 2, 3, 4, 5, 6, 7, 8};
    Archive()
        .add("boot.txt", bytes_of("IMAGE\nTYPE = C\nPORT = 1\nID = 13, 14, 17, 21\n"))
        .add("configuration", image)
        .save(_file);
    plug_text(R"({"adapters": [{"kind": "cna"}, {"kind": "fc-hba"}]})");

    EXPECT_EQ(update("200000051E100100", _file), HXA_STATUS_OK);
    char read[8] = {};
    hxal_flash_read_part(hxal_adapter_get_port(2), HXA_FLASH_PART_FWCFG, 1, read, sizeof read, HXA_FALSE);
    EXPECT_EQ(Bytes(read, std::end(read)), image);
    log();
    EXPECT_EQ(update("200000051EFFFFFF", _file), HXA_STATUS_NO_ADAPTER);
    EXPECT_THAT(log(), Not(Contains(HasSubstr("status="))));
}

TEST_F(Software_Update, has_no_access_point_on_a_host_without_a_name)
{
    fake_host.name.reset();
    EXPECT_THAT(FCHBAManager::getFCHBAManager().getInstances(CLASSID_RemoteServiceAccessPoint), IsEmpty());
    EXPECT_THAT(log(), Contains("WARN AccessPointHelper: getHostInfo returned localhost"));
}

TEST_F(Software_Update, runs_commands_apart_from_the_process)
{
    _inherited = dup(STDOUT_FILENO); // as a server that forgets to close on exec leaves them
    ASSERT_GT(_inherited, STDERR_FILENO);
    ASSERT_TRUE(std::freopen("/proc/self/status", "r", stdin));
    signal(SIGUSR1, SIG_IGN);
    const std::string nap = "sleep 60." + std::to_string(getpid());
    const struct
    {
        std::string command;
        int status;
        std::string line;
    } rows[] = {
        // clang-format off
        {"exit 3", 3, ""},
        {"kill -9 $$", -1, ""},
        {"printf 'one\\ntwo\\n'", 0, "one"},
        {"printf '%200s' | tr ' ' x", 0, std::string(128, 'x')},
        {"read line", 1, ""},
        {"umask", 0, "0077"},
        {"cd /proc/self/fd; echo *", 0, "0 1 2 3"}, // 3: the folder
        {"grep -c 'Sig\\(Blk\\|Ign\\):.0*$' /proc/self/status", 0, "2"},
        {nap + " & " + nap, -1, ""}, // longer than its limit
        {"sleep 0.2; pgrep -fx '" + nap + "'", 1, ""},
        {"truncate -s 200M " + _file, 153, ""},
        // clang-format on
    };
    for (const sighandler_t handler : {SIG_DFL, SIG_IGN, static_cast<sighandler_t>(reap_all)})
    {
        signal(SIGCHLD, handler);
        const auto start = std::chrono::steady_clock::now();
        for (const auto& row : rows)
        {
            First_Line line;
            const auto limit = row.command.starts_with(nap) ? 1s : 50s;
            EXPECT_EQ(run_shell_command(row.command.c_str(), limit, &line), row.status) << row.command;
            EXPECT_EQ(line.text, row.line) << row.command;
        }
        EXPECT_EQ(run_shell_command("exit 3", 50s), 3);
        EXPECT_LT(std::chrono::steady_clock::now() - start, 40s);
    }
}
