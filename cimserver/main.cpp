// zmlr-cimserver: serves a CIM provider module to CIM-XML clients.
//
// Exit status: 0 after a clean stop, 1 when it cannot serve or a request did not end in time, 2 for a wrong command line.
#include "cimserver/broker/module.h"
#include "cimserver/broker/principal.h"
#include "cimserver/cimxml/http_server.h"
#include "cimserver/cimxml/listener.h"
#include "cimserver/cimxml/service.h"
#include "cimserver/indications/subscription_classes.h"
#include "cimserver/name_spaces.h"
#include "cimserver/options.h"
#include "cimserver/security/credentials.h"
#include "cimserver/security/password_prompt.h"
#include "cimserver/security/tls_identity.h"

#include <semaphore.h>

#include <chrono>
#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <exception>
#include <memory>
#include <stdexcept>
#include <string>

namespace
{

using namespace cimserver;

// How long a stop waits for the requests that run.
constexpr std::chrono::seconds stop_grace{10};
constexpr std::chrono::seconds delivery_grace{3}; // and for the listeners

constexpr std::uint16_t http_port = 5988; // as registered for WBEM
constexpr std::uint16_t https_port = 5989;

sem_t stop_asked;

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

Http_Endpoint endpoint_of(const Options& options)
{
    Http_Endpoint endpoint{options.address, http_port, std::nullopt};
    if (!options.certificate.empty())
    {
        endpoint.tls = read_tls_identity(options.certificate, options.key);
        endpoint.port = https_port;
    }
    endpoint.port = options.port.value_or(endpoint.port);
    return endpoint;
}

// Null when nobody has to prove who he is.
std::unique_ptr<Credentials> credentials_of(const Options& options)
try
{
    return options.no_auth ? nullptr : std::make_unique<Credentials>(options.users);
}
catch (const std::runtime_error& error)
{
    throw std::runtime_error(std::string(error.what()) + " (--add-user NAME adds a user to the file)");
}

// From now on clients can subscribe, and the module's indications go to their listeners.
void offer(Subscriptions& subscriptions, Name_Spaces& operations, Module& module)
{
    using enum Subscription_Kind;
    for (const Subscription_Kind kind : {filter, destination, subscription})
        operations.interop().serve(make_subscription_class(kind, subscriptions));
    module.broker().set_indication_sink(&subscriptions);
}

void serve(const Options& options)
{
    handle_signals();
    const Http_Endpoint endpoint = endpoint_of(options);
    const auto credentials = credentials_of(options);
    const auto store = options.state.empty() ? nullptr : std::make_unique<const Subscription_Store>(options.state);
    Module module(options.module);
    Delivery delivery(options.delivery);
    Subscriptions subscriptions(module, delivery, options.indication_order, store.get());
    Name_Spaces operations(module);
    offer(subscriptions, operations, module);
    subscriptions.restore();
    Service service(operations);
    Http_Server server(endpoint, options.limits, credentials.get(),
                       [&](const Http_Request& request)
                       {
                           const Principal_Scope principal(request.user);
                           return service.answer(request);
                       });
    std::fprintf(stderr, "zmlr-cimserver: listening on %s%s\n", endpoint_text(endpoint.address, server.port()).c_str(),
                 endpoint.tls ? " (TLS)" : "");

    wait_for_stop();
    if (!server.stop(stop_grace))
    {
        std::fprintf(stderr, "zmlr-cimserver: a request did not finish in time\n");
        std::_Exit(EXIT_FAILURE); // it still uses the module
    }
    subscriptions.stop();
    delivery.stop(delivery_grace);
}

} // namespace

int main(int argc, char** argv)
try
{
    const auto options = read_options(argc, argv);
    if (const int* status = std::get_if<int>(&options))
        return *status;
    const auto& read = std::get<Options>(options);
    if (read.add_user)
        store_user(read.users, *read.add_user, ask_password());
    else
        serve(read);
    return EXIT_SUCCESS;
}
catch (const std::exception& error)
{
    std::fprintf(stderr, "zmlr-cimserver: %s\n", error.what());
    return EXIT_FAILURE;
}
