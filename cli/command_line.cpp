#include "cli/command_line.h"

#include "cli/commands.h"

#include <CLI/CLI.hpp>

#include <memory>
#include <sstream>

namespace hxa
{

namespace
{

// Builds the options of every command; the one that was given becomes `run`.
class Parser
{
public:
    Parser(Command_Line& result) : _result(result)
    {
        _app.require_subcommand(1);
        _app.fallthrough();
        _app.set_version_flag("--version", "hxa " ZMLR_VERSION);
        _app.add_flag("--json", result.common.json, "answer with JSON");
        _app.add_flag("--yes", result.common.yes, "ask nothing");
        add_list();
        add_stats();
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

    void add_list()
    {
        const auto [app, options] = add("list", "show adapters, ports and IOCs", list);
        app->add_option("adapter", options->adapter, "number, serial number or name; all without");
        app->add_flag("--names", options->names, "only the names of adapters and ports, a line each");
    }

    void add_stats()
    {
        const auto [app, options] = add("stats", "show all counters", stats);
        app->add_option("port", options->port, "adapter or port; all without");
        app->add_flag("--reset", options->reset, "set them to 0 (asks)");
        app->add_option_function<std::vector<std::string>>(
               "--watch", [options = options](const auto& words) { options->watch = seconds(words); },
               "show what rises, again and again")
            ->expected(0, 1)
            ->type_name("SECONDS");
        app->add_option("--count", options->count, "so many times")->type_name("NUMBER");
        app->add_option("--openmetrics", options->openmetrics,
                        "write states and counters of all ports to a file as OpenMetrics text")
            ->type_name("FILE")
            ->excludes("port")
            ->excludes("--reset")
            ->excludes("--watch");
    }

    // One second unless the words are a number.
    static double seconds(const std::vector<std::string>& words)
    {
        double number = 1;
        if (!words.empty() && !words.front().empty() && (!CLI::detail::lexical_cast(words.front(), number) || !(number > 0)))
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
