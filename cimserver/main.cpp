// zmlr-cimserver: serves a CIM provider module to CIM-XML clients on the loopback interface.
//
// Exit status: 0 after a clean stop, 1 when it cannot serve or a request did not end in time, 2 for a wrong command line.
#include "cimserver/broker/module.h"
#include "cimserver/cimxml/http_server.h"
#include "cimserver/cimxml/service.h"
#include "cimserver/cimxml/version.h"
#include "cimserver/module_operations.h"

#include <CLI/CLI.hpp>
#include <semaphore.h>

#include <chrono>
#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <exception>
#include <string>

namespace
{

// How long a stop waits for the requests that run.
constexpr std::chrono::seconds stop_grace{10};

constexpr int exit_usage = 2; // a command line that cannot be served

sem_t stop_asked;

struct Options
{
    std::string module;
    std::uint16_t port = 5988;
    cimserver::Http_Limits limits;
};

void declare(CLI::App& app, Options& options)
{
    app.set_version_flag("--version", std::string("zmlr-cimserver ") + cimserver::version());
    app.add_option("--module", options.module, "the provider module to serve (a shared library)")->required();
    app.add_option("--port", options.port, "TCP port on 127.0.0.1; 0 picks a free one")->capture_default_str();
    app.add_option("--max-request", options.limits.request_bytes, "largest request, in bytes")
        ->check(CLI::Range(std::size_t{1024}, std::size_t{1} << 30))
        ->capture_default_str();
    app.add_option("--max-connections", options.limits.connections, "connections served at once")
        ->check(CLI::Range(1, 10000))
        ->capture_default_str();
    app.add_option("--max-waiting", options.limits.waiting_requests, "requests that may wait for a worker")
        ->check(CLI::Range(1, 100000))
        ->capture_default_str();
    app.add_option("--workers", options.limits.workers, "requests answered at once")
        ->check(CLI::Range(1, 256))
        ->capture_default_str();
}

void ask_to_stop(int) { sem_post(&stop_asked); }

// Handles the signals: what is blocked or ignored stays so in every program that the module starts.
void handle_signals()
{
    sem_init(&stop_asked, 0, 0);
    std::signal(SIGTERM, ask_to_stop);
    std::signal(SIGINT, ask_to_stop);
    std::signal(SIGPIPE, [](int) {});
}

void wait_for_stop()
{
    while (sem_wait(&stop_asked) != 0)
    {
    }
}

void serve(const Options& options)
{
    handle_signals();
    cimserver::Module module(options.module);
    cimserver::Module_Operations operations(module);
    cimserver::Service service(operations);
    cimserver::Http_Server server(options.port, options.limits,
                                  [&](const cimserver::Http_Request& request) { return service.answer(request); });
    std::fprintf(stderr, "zmlr-cimserver: listening on 127.0.0.1:%u\n", static_cast<unsigned>(server.port()));

    wait_for_stop();
    if (!server.stop(stop_grace))
    {
        std::fprintf(stderr, "zmlr-cimserver: a request did not finish in time\n");
        std::_Exit(EXIT_FAILURE); // it still uses the module
    }
}

} // namespace

int main(int argc, char** argv)
{
    CLI::App app("Serves a CIM provider module to CIM-XML clients on the loopback interface.", "zmlr-cimserver");
    Options options;
    declare(app, options);
    try
    {
        app.parse(argc, argv);
        serve(options);
        return EXIT_SUCCESS;
    }
    catch (const CLI::ParseError& error) // a request for help, too
    {
        return app.exit(error) == EXIT_SUCCESS ? EXIT_SUCCESS : exit_usage;
    }
    catch (const std::exception& error)
    {
        std::fprintf(stderr, "zmlr-cimserver: %s\n", error.what());
        return EXIT_FAILURE;
    }
}
