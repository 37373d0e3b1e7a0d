// The command line of zmlr-cimserver.
#pragma once

#include "cimserver/broker/module.h"
#include "cimserver/cimxml/http_server.h"
#include "cimserver/indications/delivery.h"
#include "cimserver/indications/indication_providers.h"

#include <cstdint>
#include <optional>
#include <string>
#include <variant>

namespace cimserver
{

struct Options
{
    std::optional<std::string> add_user; // only add this user to the file
    std::string users = "/etc/zmlr/users";
    bool no_auth = false;

    std::string module;
    std::chrono::milliseconds provider_timeout = Module::usual_patience;
    std::string address = "127.0.0.1";
    std::optional<std::uint16_t> port; // the protocol's own (HTTP 5988, HTTPS 5989) unless given
    std::string certificate;           // both or none: TLS
    std::string key;
    Http_Limits limits;

    std::string state; // the folder that keeps subscriptions; empty: nothing is kept
    Indication_Order indication_order = Indication_Order::open_pegasus;
    Delivery_Limits delivery;
};

// The options, or the exit status of a program that has nothing to serve: 0 after help or the version (printed on standard
// output), 2 for a wrong command line (told on standard error). Wrong is also what would be unsafe: an address that other
// hosts reach without TLS, or without credentials.
std::variant<Options, int> read_options(int argc, char** argv);

} // namespace cimserver
