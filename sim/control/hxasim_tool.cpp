// hxasim: steers the simulated drivers of a running process through its control socket.
//
// Prints the answer. Exits with 0 when the simulator did it, 1 when it refused, 2 when nobody answers, and as CLI11 has it
// for a command line that makes no sense.
#include "sim/scenario/json.h"

#include <CLI/CLI.hpp>

#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <iostream>
#include <stdexcept>
#include <string>

namespace
{

using hxasim::Json_Value;

constexpr int refused = 1;
constexpr int no_answer = 2;

// One connection, for one question.
class Connection
{
public:
    explicit Connection(const std::string& path) : _path(path), _descriptor(socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0))
    {
        sockaddr_un address{};
        address.sun_family = AF_UNIX;
        if (path.size() >= sizeof(address.sun_path))
            fail(ENAMETOOLONG);
        path.copy(address.sun_path, path.size());
        if (_descriptor < 0 || connect(_descriptor, reinterpret_cast<const sockaddr*>(&address), sizeof(address)) != 0)
            fail(errno);
    }
    Connection(const Connection&) = delete;
    Connection& operator=(const Connection&) = delete;
    ~Connection() { close(_descriptor); }

    std::string ask(const std::string& question)
    {
        put(question + "\n");
        std::string answer;
        while (!answer.ends_with('\n'))
            answer += more();
        return answer;
    }

private:
    [[noreturn]] void fail(int error) const { throw std::runtime_error(_path + ": " + std::strerror(error)); }

    void put(std::string_view bytes) const
    {
        while (!bytes.empty())
        {
            const auto sent = send(_descriptor, bytes.data(), bytes.size(), MSG_NOSIGNAL);
            if (sent < 0)
                fail(errno);
            bytes.remove_prefix(static_cast<std::size_t>(sent));
        }
    }

    std::string more() const
    {
        std::array<char, 4096> bytes;
        const auto count = recv(_descriptor, bytes.data(), bytes.size(), 0);
        if (count <= 0)
            fail(count < 0 ? errno : ECONNRESET);
        return {bytes.data(), static_cast<std::size_t>(count)};
    }

    std::string _path;
    int _descriptor;
};

// A number where the argument is one, else the word.
Json_Value as_value(const std::string& argument)
{
    const bool decimal = !argument.empty() && argument.find_first_not_of("0123456789") == std::string::npos;
    return decimal && argument.size() < 20 ? Json_Value{std::uint64_t{std::stoull(argument)}} : Json_Value{argument};
}

// OFFSET:HEX
Json_Value as_patch(const std::string& argument)
{
    const auto colon = std::min(argument.find(':'), argument.size());
    return {Json_Value::Members{{"offset", as_value(argument.substr(0, colon))},
                                {"bytes", {argument.substr(std::min(colon + 1, argument.size()))}}}};
}

// The command line, which fills in the question to the simulator.
class Command_Line
{
public:
    Command_Line()
    {
        _app.require_subcommand(1);
        _app.add_option("--socket", socket, "the control socket")->type_name("FILE")->envname("HXASIM_CONTROL")->required();
        add_event();
        add_adapter("unplug", "pull a card out");
        add_adapter("plug", "put a card back");
        add_port("port", "link", "take the link of a port up or down", {"up", "down"});
        add_port("sfp", "module", "insert or remove the module in the cage of a port", {"insert", "remove"});
        add_fault();
        add("clear-faults", "forget all faults");
        add("requests", "count the requests that the drivers were sent");
        add("status", "show the host");
    }

    void parse(int count, const char* const* words) { _app.parse(count, words); }
    int exit(const CLI::ParseError& error) { return _app.exit(error); }

    std::string socket;
    Json_Value::Members question;

private:
    CLI::App* add(const std::string& name, const std::string& help)
    {
        auto* command = _app.add_subcommand(name, help);
        command->callback([this, name] { question["request"] = {name}; });
        return command;
    }

    // `kind` is what help says of the value: its unit, or what it names.
    CLI::Option* take(CLI::App* command, const std::string& option, const std::string& key, const std::string& kind,
                      const std::string& help)
    {
        const auto store = [this, key](const std::string& value) { question[key] = as_value(value); };
        return command->add_option_function<std::string>(option, store, help)->type_name(kind);
    }

    CLI::Option* take_text(CLI::App* command, const std::string& option, const std::string& key, const std::string& kind,
                           const std::string& help)
    {
        const auto store = [this, key](const std::string& value) { question[key] = {value}; };
        return command->add_option_function<std::string>(option, store, help)->type_name(kind);
    }

    void add_event()
    {
        auto* command = add("event", "raise an event");
        take(command, "category", "category", "NAME", "adapter, port, lport, rport, itnim, audit, ioc or ethport; or a number")
            ->required();
        take(command, "event", "event", "NAME", "online, sfp-pom, linkdown, ...; or a number")->required();
        add_place(command);
        take(command, "--level", "level", "NUMBER", "of a sfp-pom: 1 normal, 2 warning, 3 alarm");
        take_text(command, "--data", "data", "BYTES", "event data, hexadecimal, instead of the IOC's own");
        take(command, "--count", "count", "NUMBER", "raise it so many times");
    }

    void add_place(CLI::App* command)
    {
        take_text(command, "--node", "node", "FILE", "/dev/hxa or /dev/hxn");
        take(command, "--instance", "instance", "NUMBER", "of the IOC");
    }

    CLI::App* add_adapter(const std::string& name, const std::string& help)
    {
        auto* command = add(name, help);
        take(command, "adapter", "adapter", "NUMBER", "number in the scenario, from 0")->required();
        return command;
    }

    void add_port(const std::string& name, const std::string& key, const std::string& help, std::vector<std::string> words)
    {
        auto* command = add_adapter(name, help);
        take(command, "number", "port", "NUMBER", "number on the card, from 0")->required();
        take(command, key, key, "", "")->required()->check(CLI::IsMember(std::move(words)));
    }

    void add_fault()
    {
        auto* command = add("fault", "make requests go wrong");
        take_text(command, "--command", "command", "NAME", "IOCMD_...; without it every command");
        add_place(command);
        take_text(command, "--remote-port", "remote_port", "WWN", "WWN of the remote port that the request names");
        take(command, "--lun", "lun", "NUMBER", "of a SCSI command");
        take_text(command, "--cdb", "cdb", "BYTES", "hexadecimal, what the command block of a SCSI command begins with");
        take(command, "--error", "error", "ERRNO", "fail the call with this errno");
        take(command, "--status", "status", "CODE", "answer with this record status");
        take(command, "--scsi-status", "scsi_status", "CODE", "answer a SCSI command with this status");
        take(command, "--garbage", "garbage", "SEED", "answer random bytes");
        take(command, "--delay", "delay", "MILLISECONDS", "answer that much later");
        take(command, "--skip", "skip", "NUMBER", "let so many requests pass first");
        take(command, "--times", "times", "NUMBER", "then strike so many; without it all");
        take_patches(command, "--answer", "answer", "bytes of the answer to overwrite, hexadecimal");
        take_patches(command, "--data", "data", "bytes of the data that come with it to overwrite, hexadecimal");
    }

    void take_patches(CLI::App* command, const std::string& option, const std::string& key, const std::string& help)
    {
        command
            ->add_option_function<std::vector<std::string>>(
                option,
                [this, key](const std::vector<std::string>& patches)
                {
                    Json_Value::List list;
                    for (const auto& patch : patches)
                        list.push_back(as_patch(patch));
                    question[key] = {list};
                },
                help)
            ->type_name("OFFSET:BYTES");
    }

    CLI::App _app{"Steers the simulated drivers of a running process."};
};

} // namespace

int main(int argument_count, char** arguments)
{
    Command_Line command_line;
    try
    {
        command_line.parse(argument_count, arguments);
        const auto answer = Connection(command_line.socket).ask(hxasim::json_text({command_line.question}));
        std::cout << hxasim::indented_json(answer) << '\n';
        return hxasim::Json_Document(answer).root("answer").boolean("ok", false) ? EXIT_SUCCESS : refused;
    }
    catch (const CLI::ParseError& error)
    {
        return command_line.exit(error);
    }
    catch (const std::exception& error)
    {
        std::cerr << "hxasim: " << error.what() << '\n';
        return no_answer;
    }
}
