// zmlr-cimserver: serves a CIM provider module to CIM-XML clients.
//
// Exit status: 0 after a stop, 1 when it cannot serve, 2 for a wrong command line.
#include "cimserver/broker/module.h"
#include "cimserver/broker/request.h"
#include "cimserver/cimxml/http_server.h"
#include "cimserver/cimxml/listener.h"
#include "cimserver/cimxml/service.h"
#include "cimserver/indications/subscriptions.h"
#include "cimserver/interop/name_spaces.h"
#include "cimserver/options.h"
#include "cimserver/process.h"
#include "cimserver/security/credentials.h"
#include "cimserver/security/password_prompt.h"
#include "cimserver/security/tls_identity.h"

#include <chrono>
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

void show_identity_of(const Options& options)
{
    Tls_Identity identity = read_tls_identity(options.certificate, options.key);
    for (const std::string& weakness : weaknesses_of(identity))
        std::fprintf(stderr, "zmlr-cimserver: clients may refuse %s: %s\n", options.certificate.c_str(), weakness.c_str());
    show_identity(std::move(identity));
}

// What is wrong with new files is told. The old certificate counts on; with users that cannot be read nobody is let in.
void reload(const Options& options, Credentials* credentials)
try
{
    if (credentials)
        credentials->reload();
    if (!options.certificate.empty())
        show_identity_of(options);
    std::fprintf(stderr, "zmlr-cimserver: reloaded\n");
}
catch (const std::exception& error)
{
    std::fprintf(stderr, "zmlr-cimserver: not reloaded: %s\n", error.what());
}

Http_Endpoint endpoint_of(const Options& options)
{
    Http_Endpoint endpoint{options.address, http_port, false};
    if (!options.certificate.empty())
    {
        show_identity_of(options);
        endpoint.tls = true;
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

// While it exists clients can subscribe, and the module's indications go to their listeners. The module may raise them on a
// thread of its own: however the server ends, they are disabled before what takes them is gone.
class Offer
{
public:
    Offer(Subscriptions& subscriptions, Server_Name_Spaces& name_spaces, Module& module)
        : _subscriptions(subscriptions)
        , _module(module)
    {
        for (const Subscription_Kind kind :
             {Subscription_Kind::filter, Subscription_Kind::destination, Subscription_Kind::subscription})
            name_spaces.own().serve({class_of(kind), [&subscriptions, kind] { return subscriptions.list(kind); },
                                     [&subscriptions, kind](const Instance& instance)
                                     { return subscriptions.create(kind, instance); },
                                     [&subscriptions, kind](const Object_Path& path) { subscriptions.remove(kind, path); }});
        module.broker().set_indication_sink(&subscriptions);
    }
    ~Offer()
    {
        _subscriptions.stop();
        _module.broker().set_indication_sink(nullptr);
    }
    Offer(const Offer&) = delete;
    Offer& operator=(const Offer&) = delete;

private:
    Subscriptions& _subscriptions;
    Module& _module;
};

// The rest of the work is done for the user who asked.
Http_Work for_user(const std::string& user, Http_Work work)
{
    if (!work.rest)
        return work;
    return {{},
            [user, rest = std::move(work.rest)]
            {
                const Principal_Scope principal(user);
                return rest();
            }};
}

void serve(const Options& options)
{
    handle_signals();
    const std::string service_manager = take_service_manager();
    reserve_descriptors(options.limits.connections);
    const Http_Endpoint endpoint = endpoint_of(options);
    const auto credentials = credentials_of(options);
    const auto store = options.state.empty() ? nullptr : std::make_unique<const Subscription_Store>(options.state);
    Module module(options.module, options.provider_timeout);
    Delivery delivery(options.delivery);
    Subscriptions subscriptions(module, delivery, options.indication_order, store.get());
    Server_Name_Spaces name_spaces(module);
    const Offer offer(subscriptions, name_spaces, module);
    subscriptions.restore();
    Service service(name_spaces);
    Http_Server server(endpoint, options.limits, credentials.get(),
                       [&](const Http_Request& request) { return for_user(request.user, service.handle(request)); });
    std::fprintf(stderr, "zmlr-cimserver: listening on %s%s\n", endpoint_text(endpoint.address, server.port()).c_str(),
                 endpoint.tls ? " (TLS)" : "");
    tell_ready(service_manager);

    while (next_wish() == Wish::reload)
        reload(options, credentials.get());
    if (!server.stop(stop_grace))
    {
        std::fprintf(stderr, "zmlr-cimserver: stopped while a provider does not answer a request\n");
        std::_Exit(EXIT_SUCCESS); // it still uses the module
    }
    subscriptions.stop();
    delivery.stop(delivery_grace);
}

} // namespace

int main(int argc, char** argv)
try
{
    open_standard_descriptors();
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
