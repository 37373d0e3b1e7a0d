#include "cimserver/options.h"

#include "cimserver/cimxml/listener.h"
#include "cimserver/model/server_identity.h"

#include <CLI/CLI.hpp>

#include <map>

namespace cimserver
{
namespace
{

constexpr int exit_usage = 2;

std::string check_address(const std::string& text) { return is_address(text) ? "" : text + " is no IPv4 or IPv6 address"; }

// Help shows the numbers of a range, not the type that holds them.
template <class T>
void add_number(CLI::App& app, const std::string& name, T& value, std::size_t least, std::size_t most, const std::string& text,
                const std::string& unit = "NUMBER")
{
    CLI::Range range(least, most);
    range.description(std::to_string(least) + " to " + std::to_string(most));
    app.add_option(name, value, text)->type_name(unit)->check(range)->capture_default_str();
}

void declare_access(CLI::App& app, Options& options)
{
    app.add_option("--users", options.users, "the file of users and their password hashes")
        ->type_name("FILE")
        ->capture_default_str();
    app.add_option("--add-user", options.add_user, "add a user to that file, or give one a new password, and end")
        ->type_name("NAME");
    app.add_flag("--no-auth", options.no_auth, "ask for no credentials (loopback addresses only)");
    app.add_option("--address", options.address, "the address to listen on; any but loopback needs TLS")
        ->type_name("ADDRESS")
        ->check(check_address)
        ->capture_default_str();
    app.add_option("--port", options.port, "TCP port; 0 picks a free one [5988, with TLS 5989]")->type_name("PORT");
    app.add_option("--certificate", options.certificate, "serve TLS with this certificate (PEM)")->type_name("FILE");
    app.add_option("--key", options.key, "the private key of the certificate (PEM)")->type_name("FILE");
}

void declare_limits(CLI::App& app, Http_Limits& limits)
{
    add_number(app, "--max-request", limits.request_bytes, 1024, std::size_t{1} << 30, "largest request", "BYTES");
    add_number(app, "--max-connections", limits.connections, 1, 10'000, "connections served at once");
    add_number(app, "--max-waiting", limits.waiting_requests, 1, 100'000, "requests that may wait for a worker");
    add_number(app, "--workers", limits.workers, 1, 256, "requests answered at once");
}

// Options hold milliseconds, people give seconds.
void add_seconds(CLI::App& app, const std::string& name, std::chrono::milliseconds& value, double least, const std::string& text)
{
    const std::string preset = std::to_string(std::chrono::duration_cast<std::chrono::seconds>(value).count());
    app.add_option_function<double>(
           name, [&value](double seconds) { value = std::chrono::milliseconds(static_cast<long long>(seconds * 1000)); }, text)
        ->type_name("SECONDS")
        ->check(CLI::Range(least, 3600.0).description(least > 0 ? "0.1 to 3600" : "0 to 3600"))
        ->default_str(preset);
}

void declare_indications(CLI::App& app, Options& options)
{
    const std::map<std::string, Indication_Order> orders{{"open-pegasus", Indication_Order::open_pegasus},
                                                         {"sfcb", Indication_Order::sfcb}};
    app.add_option("--state", options.state, "keeps subscriptions over a restart (made if missing)")->type_name("FOLDER");
    app.add_option("--indication-order", options.indication_order, "call indication providers in the order of this server")
        ->type_name("NAME")
        ->transform(CLI::CheckedTransformer(orders).description("open-pegasus or sfcb"))
        ->default_str("open-pegasus");
    app.add_option("--listener-ca", options.delivery.ca_file, "certificates that vouch for HTTPS listeners [the system's]")
        ->type_name("FILE")
        ->check(CLI::Validator(CLI::ExistingFile).description(""));
    add_number(app, "--delivery-attempts", options.delivery.attempts, 1, 100, "how often an indication is tried");
    add_seconds(app, "--delivery-pause", options.delivery.pause, 0, "between attempts");
    add_seconds(app, "--delivery-timeout", options.delivery.timeout, 0.1, "that one attempt may take");
    add_number(app, "--max-indications", options.delivery.waiting, 1, 100'000, "indications that may wait for a listener");
}

void check(const Options& options)
{
    if (options.add_user)
        return;
    if (options.module.empty())
        throw CLI::RequiredError("--module");
    if (options.certificate.empty() != options.key.empty())
        throw CLI::ValidationError("--certificate and --key are given together or not at all");
    if (is_loopback(options.address))
        return;
    if (options.no_auth)
        throw CLI::ValidationError("--no-auth is for loopback addresses only: other hosts reach " + options.address);
    if (options.certificate.empty())
        throw CLI::ValidationError("other hosts reach " + options.address + ": that needs TLS (--certificate and --key)");
}

} // namespace

std::variant<Options, int> read_options(int argc, char** argv)
{
    CLI::App app("Serves a CIM provider module to CIM-XML clients.", "zmlr-cimserver");
    Options options;
    app.set_version_flag("--version", std::string("zmlr-cimserver ") + version());
    app.add_option("--module", options.module, "the provider module to serve (a shared library)")->type_name("FILE");
    add_seconds(app, "--provider-timeout", options.provider_timeout, 0.1, "that a request waits for a provider that hangs");
    declare_access(app, options);
    declare_limits(app, options.limits);
    declare_indications(app, options);
    try
    {
        app.parse(argc, argv);
        check(options);
        return options;
    }
    catch (const CLI::ParseError& error) // a request for help, too
    {
        return app.exit(error) == 0 ? 0 : exit_usage;
    }
}

} // namespace cimserver
