// The control socket of a simulated process, and the tool that talks to it.
#include "tests/sim/simulated_host.h"
#include "tests/support/rows.h"
#include "tests/support/temporary_folder.h"

#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/un.h>
#include <sys/wait.h>

#include <cstdio>
#include <memory>

namespace
{

using testing::HasSubstr;

class Control : public Raw_Host
{
protected:
    Control() : Raw_Host("cna") { hxasim::serve_control(_path); }
    ~Control() override { hxasim::serve_control(""); }

    // A socket that bind() or connect() was called on; none when that failed.
    static Open_File socket_at(const std::string& path, int (*call)(int, const sockaddr*, socklen_t) noexcept)
    {
        Open_File made(socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0));
        sockaddr_un address{};
        address.sun_family = AF_UNIX;
        path.copy(address.sun_path, sizeof(address.sun_path) - 1);
        if (call(*made, reinterpret_cast<const sockaddr*>(&address), sizeof(address)) != 0)
            made.close_now();
        return made;
    }

    Open_File connected() const
    {
        return socket_at(_path, [](int made, const sockaddr* to, socklen_t size) noexcept { return connect(made, to, size); });
    }

    static void put(const Open_File& client, std::string_view bytes)
    {
        while (!bytes.empty())
        {
            const auto sent = ::send(*client, bytes.data(), bytes.size(), MSG_NOSIGNAL);
            if (sent < 0)
                return;
            bytes.remove_prefix(static_cast<std::size_t>(sent));
        }
    }

    // The next `lines` lines, or what came before the end.
    static std::string get(const Open_File& client, int lines = 1)
    {
        std::string answer;
        char byte = 0;
        while (lines > 0 && recv(*client, &byte, 1, 0) == 1)
        {
            answer += byte;
            lines -= byte == '\n';
        }
        return answer;
    }

    std::string ask(const std::string& line) const
    {
        const auto client = connected();
        put(client, line + "\n");
        return get(client);
    }

    // What the tool prints, and how it ends.
    std::pair<int, std::string> tool(const std::string& words) const
    {
        const auto command = "HXASIM_CONTROL=" + _path + " " TOOL " " + words + " 2>&1";
        std::unique_ptr<FILE, int (*)(FILE*)> pipe(popen(command.c_str(), "r"), pclose);
        std::string output;
        std::array<char, 256> line{};
        while (fgets(line.data(), line.size(), pipe.get()))
            output += line.data();
        const int status = pclose(pipe.release());
        return {WEXITSTATUS(status), output};
    }

    const Temporary_Folder _folder;
    const std::string _path = _folder.path("control");
};

constexpr const char* done = "{\"ok\":true}\n";

std::string refusal(const std::string& why) { return "{\"error\":\"" + why + "\",\"ok\":false}\n"; }

TEST_F(Control, answers_every_request_with_one_line)
{
    hxasim::load_text(R"({"adapters": [{"kind": "fc-hba", "option_rom": false, "ports": [{}]}]})");
    Raw_Host::ask<hxa_ioctl_gen_t>(Open_File("/dev/hxa"), "IOCMD_FLASH_ENABLE_OPTROM", '\xB5', 0);
    for (const auto& row : rows_of("control_requests.txt"))
        EXPECT_EQ(ask(row[0]), row.at(1) + "\n") << row[0];
    hxasim::unload();
    EXPECT_EQ(ask(R"({"request": "unplug", "adapter": 0})"), refusal("no host is loaded"));
    EXPECT_THAT(ask("{"), HasSubstr("parse error"));
    EXPECT_THAT(ask(std::string(60'000, '[')), HasSubstr("parse error"));
}

TEST_F(Control, serves_its_own_user_in_the_place_of_a_dead_socket_only)
{
    struct stat status = {};
    ASSERT_EQ(stat(_path.c_str(), &status), 0);
    EXPECT_EQ(status.st_mode, mode_t{S_IFSOCK | 0600});
    hxasim::serve_control("");
    EXPECT_NE(stat(_path.c_str(), &status), 0);
    const auto serve = [](const std::string& path) { return refusal_of([&] { hxasim::serve_control(path); }); };
    ASSERT_GE(*socket_at(_path + "x", bind), 0); // and nobody listens, or cleans up
    EXPECT_EQ(serve(_path + "x"), "done");
    hxasim::serve_control(_path);

    EXPECT_EQ(serve(_folder.file("mine", "mine")), "bind: Address already in use");
    EXPECT_EQ(serve("/no/such/folder/socket"), "bind: No such file or directory");
    EXPECT_EQ(serve(std::string(200, 'x')), "socket: File name too long");
}

TEST_F(Control, keeps_answering_whatever_clients_do)
{
    std::vector<Open_File> silent;
    for (int i = 0; i < 20; ++i)
        silent.push_back(connected());
    put(silent.back(), R"({"request": "requests"}   )");
    EXPECT_EQ(ask(R"({"request": "clear-faults"})"), done);
    const auto two = connected();
    put(two, "{\"request\": \"clear-faults\"}\n{\"request\": \"clear-faults\"}\n{\"request\":");
    EXPECT_EQ(get(two, 2), std::string(done) + done);
    put(two, " \"clear-faults\"}\n");
    EXPECT_EQ(get(two), done);
    const auto long_line = connected();
    put(long_line, std::string(70'000, ' '));
    EXPECT_EQ(get(long_line, 2), refusal("line longer than 65536 bytes"));
    const auto deaf = connected();
    for (int i = 0; i < 2000; ++i)
        if (::send(*deaf, "{\"request\": \"status\"}\n", 22, MSG_NOSIGNAL | MSG_DONTWAIT) < 0)
            break;
    EXPECT_EQ(ask(R"({"request": "clear-faults"})"), done);
}

TEST_F(Control, leaves_nothing_open_in_a_child)
{
    const auto client = connected();
    int keep_alive[2];
    ASSERT_EQ(pipe(keep_alive), 0);
    const pid_t child = fork();
    if (child == 0)
    {
        close(keep_alive[1]);
        char byte = 0;
        _exit(read(keep_alive[0], &byte, 1) == 0 ? 0 : 1);
    }
    hxasim::serve_control("");
    EXPECT_EQ(get(client), "") << "the child holds no connection open";
    close(keep_alive[0]);
    close(keep_alive[1]);
    int status = -1;
    waitpid(child, &status, 0);
    EXPECT_EQ(status, 0);
}

TEST_F(Control, has_a_tool)
{
    const struct
    {
        const char* words;
        int status;
        const char* output;
    } cases[] = {
        {"event port online --data 1000000533000001 --instance 1", 0, "\"ok\": true"},
        {"sfp 0 1 remove", 0, "\"ok\": true"},
        {"plug 7", 1, "no adapter 7"},
        {"fault --command IOCMD_SCSI_CMND --remote-port 2100000000000001 --lun 1 --cdb 12 --scsi-status 2 --data 0:81 --times 3",
         0, "\"ok\": true"},
        {"status", 0, "\"faults\": 1"},
        {"port 0 1 sideways", 105, "sideways"},
        {"", 106, "subcommand"},
        {"--socket /no/such/socket status", 2, "hxasim: /no/such/socket: No such file or directory"},
    };
    for (const auto& [words, status, output] : cases)
    {
        const auto [ended, said] = tool(words);
        EXPECT_EQ(ended, status) << words << ": " << said;
        EXPECT_THAT(said, HasSubstr(output)) << words;
    }
    EXPECT_THAT(tool("status").second, HasSubstr("\"port\": \"linkdown\""));
}

} // namespace
