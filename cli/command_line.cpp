#include "cli/command_line.h"

#include "cli/commands.h"
#include "cli/words.h"

#include <CLI/CLI.hpp>

#include <memory>
#include <sstream>

namespace hxa
{

namespace
{

constexpr double most_seconds = 86400; // between two readings

constexpr auto one_adapter = "number, serial number or name";
constexpr auto all_adapters = "number, serial number or name; all without";
constexpr auto one_port = "ADAPTER/PORT, WWN or MAC";
constexpr auto all_ports = "ADAPTER/PORT, WWN, MAC or an adapter; all without";

// Builds the options of every command; the one that was given becomes `run`.
class Parser
{
public:
    Parser(Command_Line& result) : _result(result)
    {
        _app.require_subcommand(0, 1);
        _app.callback([this] { require_command(); });
        _app.fallthrough();
        _app.set_version_flag("--version", "hxa " ZMLR_VERSION);
        _app.add_flag("--json", result.common.json, "answer with JSON");
        _app.add_flag("--yes", result.common.yes, "ask nothing");
        add_list();
        add_adapter();
        add_port();
        add_stats();
        add_targets();
        add_flash();
        add_diag();
        add_events();
        add_config();
    }

    void parse(int count, const char* const* words) { _app.parse(count, words); }
    void exit(const CLI::ParseError& error)
    {
        std::ostringstream text;
        _result.code = _app.exit(error, text, text) == 0 ? Exit::done : Exit::usage;
        _result.text = text.str();
        _result.run = nullptr;
    }

private:
    // Asked for last, so that a word that is no command is told as such.
    void require_command() const
    {
        if (_app.get_subcommands().empty())
            throw CLI::RequiredError::Subcommand(1);
    }

    // A command whose options live as long as what runs it.
    template <typename Options>
    std::pair<CLI::App*, std::shared_ptr<Options>> add(const std::string& name, const std::string& help,
                                                       void (*command)(Session&, const Options&))
    {
        const auto options = std::make_shared<Options>();
        auto* app = _app.add_subcommand(name, help);
        app->callback([this, options, command] { _result.run = [=](Session& session) { command(session, *options); }; });
        return {app, options};
    }

    // What a command does besides its first word.
    template <typename Options>
    static CLI::App* action(CLI::App* command, const std::shared_ptr<Options>& options, const std::string& name,
                            const std::string& help)
    {
        auto* app = command->add_subcommand(name, help);
        app->parse_complete_callback([options, name] { options->action = name; });
        return app;
    }

    static void take(CLI::App* app, const std::string& name, std::string& into, const std::string& help)
    {
        may_take(app, name, into, help)->required();
    }
    static CLI::Option* may_take(CLI::App* app, const std::string& name, std::string& into, const std::string& help)
    {
        auto* option = app->add_option(name, into, help)->type_name("");
        if (name != "value") // a script's variable that holds nothing shall not stand for all, nor for a card without a name
            option->check([](const std::string& text) { return std::string(text.empty() ? "it is empty" : ""); });
        return option;
    }
    static void take_file(CLI::App* app, std::string& file, const std::string& help)
    {
        app->add_option("--file", file, help)->type_name("FILE")->capture_default_str();
    }
    static void take_keep(CLI::App* app, Keep_Options& keep)
    {
        app->add_flag("--keep", keep.keep, "write it to the drivers' configuration file too (asks)");
        take_file(app, keep.file, "that file");
    }

    void add_list()
    {
        const auto [app, options] = add("list", "show adapters, ports and IOCs", list);
        may_take(app, "adapter", options->adapter, all_adapters);
        app->add_flag("--names", options->names, "only what selects adapters and ports, a line each");
    }

    void add_adapter()
    {
        const auto [app, options] = add("adapter", "list, show and change adapters", adapter);
        app->require_subcommand(0, 1);
        may_take(action(app, options, "show", "show what the cards tell"), "adapter", options->adapter, all_adapters);
        take(action(app, options, "enable", "start all IOCs"), "adapter", options->adapter, one_adapter);
        take(action(app, options, "disable", "stop all IOCs (asks)"), "adapter", options->adapter, one_adapter);
        for (const auto& [name, help] : {std::pair{"name", "name the card"}, {"power", "full, save1, save2 or off (asks)"}})
        {
            auto* change = action(app, options, name, help);
            take(change, "adapter", options->adapter, one_adapter);
            take(change, "value", options->value, help);
            take_keep(change, options->keep);
        }
    }

    void add_port()
    {
        const auto [app, options] = add("port", "list, show and change ports", port);
        app->require_subcommand(0, 1);
        may_take(action(app, options, "show", "show what the ports tell"), "port", options->port, all_ports);
        may_take(action(app, options, "sfp", "show the modules in the ports"), "port", options->port, all_ports);
        auto* virtual_ports =
            action(app, options, "virtual", "show the virtual ports that the drivers' configuration file names");
        may_take(virtual_ports, "port", options->port, all_ports);
        take_file(virtual_ports, options->keep.file, "that file");
        for (const auto& [name, help] : {std::pair{"enable", "put into service"}, {"disable", "put out of service (asks)"}})
        {
            auto* change = action(app, options, name, help);
            take(change, "port", options->port, one_port);
            take_keep(change, options->keep);
        }
        auto* beacon = action(app, options, "beacon", "turn the light on by which a person finds the port, or off");
        take(beacon, "port", options->port, one_port);
        take(beacon, "value", options->value, "on or off");
        beacon->add_option("--seconds", options->seconds, "until it goes off by itself; 0: never")->type_name("NUMBER");
        beacon->add_flag("--link", options->link, "the light at the other end of the link too");
        const std::pair<const char*, const char*> settings[] = {
            {"name", "a text"},
            {"speed", "auto, or 1, 2, 4, 8, 10 Gbit/s; from the next start of the link"},
            {"topology", "p2p, loop or auto; from the next start of the link"},
            {"frame-size", "largest data field of a frame, bytes; from the next start of the link"},
            {"address", "address on a loop, hexadecimal, or any"},
            {"trunk", "ports of the card that become one link (0,1), or off (asks)"},
        };
        for (const auto& [name, help] : settings)
        {
            auto* change = action(app, options, name, std::string("set: ") + help);
            take(change, "port", options->port, one_port);
            take(change, "value", options->value, help);
            take_keep(change, options->keep);
        }
    }

    void add_stats()
    {
        const auto [app, options] = add("stats", "show all counters", stats);
        may_take(app, "port", options->port, all_ports);
        app->add_flag("--reset", options->reset, "set them to 0 (asks)");
        app->add_option_function<std::vector<std::string>>(
               "--watch", [options = options](const auto& words) { options->watch = seconds(words); },
               "show what rises, again and again")
            ->expected(0, 1)
            ->type_name("SECONDS")
            ->excludes("--reset");
        app->add_option("--count", options->count, "so many times")->type_name("NUMBER")->needs("--watch");
        app->add_option("--openmetrics", options->openmetrics,
                        "write states and counters of all ports to a file as OpenMetrics text")
            ->type_name("FILE")
            ->excludes("port")
            ->excludes("--reset")
            ->excludes("--watch");
    }

    void add_targets()
    {
        const auto [app, options] = add("targets", "show remote ports and the units behind them", targets);
        may_take(app, "port", options->port, all_ports);
        app->add_flag("--no-luns", options->no_luns, "send no SCSI commands");
    }

    void add_flash()
    {
        const auto [app, options] = add("flash", "show and write the flash of adapters", flash);
        app->require_subcommand(0, 1);
        may_take(action(app, options, "show", "show versions and partitions"), "adapter", options->adapter, all_adapters);
        auto* update = action(app, options, "update", "write the images of a boot code archive (asks)");
        take(update, "adapter", options->adapter, "number, serial number or name; all: every adapter");
        take(update, "file", options->file, "the archive");
        for (const auto& [name, help] : {std::pair{"read", "copy a partition to a file"},
                                         {"write", "write a file to a partition (asks)"},
                                         {"erase", "erase a partition (asks)"}})
        {
            auto* act = action(app, options, name, help);
            take(act, "adapter", options->adapter, one_adapter);
            take(act, "partition", options->partition, "TYPE or TYPE/INSTANCE, as listed");
            if (std::string(name) != "erase")
                take(act, "file", options->file, "the file");
        }
        auto* option_rom = action(app, options, "option-rom", "whether the host finds the option ROM when it starts (asks)");
        take(option_rom, "adapter", options->adapter, one_adapter);
        take(option_rom, "value", options->value, "on or off");
    }

    void add_diag()
    {
        const auto [app, options] = add("diag", "test adapters and ports", diag);
        app->require_subcommand(1);
        const auto test = [app = app, options = options](const char* name, const char* help, bool of_adapter)
        {
            auto* act = action(app, options, name, help);
            take(act, of_adapter ? "adapter" : "port", options->element, of_adapter ? one_adapter : one_port);
            return act;
        };
        const auto take_pattern = [options = options](CLI::App* act)
        {
            act->add_option_function<std::string>(
                   "--pattern", [options](const auto& text) { options->pattern = read_number(text, 0xFFFFFFFF, 16, "pattern"); },
                   "what is written, hexadecimal; A5A5A5A5 by itself")
                ->type_name("HEX");
        };
        test("temperature", "read the sensor of the card", true);
        take_pattern(test("memory", "test the memory of the card (asks, takes it out of service)", true));
        auto* loopback = test("loopback", "send frames from the port to itself (asks, takes it out of service)", false);
        loopback->add_option("--mode", options->mode, "internal, external or cable")->type_name("MODE")->capture_default_str();
        loopback->add_option("--speed", options->speed, "of an FC port: auto, or Gbit/s")
            ->type_name("SPEED")
            ->capture_default_str();
        loopback->add_flag("--ethernet", options->ethernet, "the Ethernet function of the port");
        loopback->add_option("--count", options->count, "frames; 8192 by itself")->type_name("NUMBER");
        take_pattern(loopback);
        auto* ping = test("ping", "send a pattern to the firmware and back", false);
        ping->add_option("--count", options->count, "how often; once by itself")->type_name("NUMBER");
        take_pattern(ping);
        test("queue", "test a queue between driver and firmware", false)
            ->add_option("--queue", options->number, "its number")
            ->type_name("NUMBER");
        auto* registers = test("registers", "read registers", false);
        registers
            ->add_option_function<std::string>(
                "--offset",
                [options = options](const auto& text) { options->number = read_number(text, 0xFFFFFFFF, 16, "offset"); },
                "of the first, hexadecimal")
            ->type_name("HEX");
        registers->add_option("--count", options->count, "32-bit words; one by itself")
            ->type_name("NUMBER")
            ->check(CLI::Range(1, 65536));
    }

    void add_events()
    {
        const auto [app, options] = add("events", "follow what happens, until interrupted", events);
        may_take(app, "port", options->port, all_ports);
        app->add_option("--count", options->count, "end after so many")->type_name("NUMBER");
    }

    void add_config()
    {
        const auto [app, options] = add("config", "show and change the drivers' configuration file", config);
        app->require_subcommand(0, 1);
        take_file(app, options->file, "the file");
        action(app, options, "show", "show what is set");
        action(app, options, "sync", "write the file anew, with every card and port of the host (asks)");
        auto* set = action(app, options, "set", "set what the driver takes when it starts (asks)");
        take(set, "port", options->port, one_port);
        take(set, "setting", options->setting, "as the file names it: qdepth, pathtov, ...");
        take(set, "value", options->value, "as the file has it");
    }

    // One second unless the words are a number.
    static double seconds(const std::vector<std::string>& words)
    {
        double number = 1;
        if (!words.empty() && !words.front().empty() &&
            (!CLI::detail::lexical_cast(words.front(), number) || !(number > 0 && number <= most_seconds)))
            throw CLI::ValidationError("--watch", "\"" + words.front() + "\" is no number of seconds");
        return number;
    }

    Command_Line& _result;
    CLI::App _app{"Shows and changes the FC and converged adapters of this host."};
};

} // namespace

Command_Line read_command_line(int count, const char* const* words)
{
    Command_Line result;
    Parser parser(result);
    try
    {
        parser.parse(count, words);
    }
    catch (const CLI::ParseError& error)
    {
        parser.exit(error);
    }
    return result;
}

} // namespace hxa
