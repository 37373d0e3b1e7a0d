// The HTTP server of the CIM-XML service: POST to any path.
//
// With credentials every request is asked for HTTP Basic, before its body is kept: 401 without a login or with a wrong one.
// Logins that have to be verified by their hash wait apart from the requests of users who are known, so that nobody without a
// password can take the workers from those; addresses take turns, so that wrong passwords delay none but those who send them. One
// that waits is cut when there are too many connections and its address has most of them.
// Without credentials what may come from a web page is refused: 403 (http_connection.h).
//
// One thread moves bytes for all connections, two run the handler, a few workers do what it leaves to be done, so neither a
// slow client nor a slow operation keeps others from being served. Workers that are stuck are replaced (worker_pool.h). What
// passes a limit is refused with a status: 413 for a body beyond request_bytes (told by its Content-Length, before any of it is
// read, else at its end), 503 when too many requests wait. Clients that do not deliver a request or take an answer in time are
// cut, so is a body without a Content-Length that goes on far beyond the limit, and so may be a client that ends its sending side
// before it has its answer.
#pragma once

#include "cimserver/cimxml/http_message.h"

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <string>

namespace cimserver
{

class Credentials;

struct Http_Endpoint
{
    std::string address = "127.0.0.1"; // numeric, IPv4 or IPv6
    std::uint16_t port = 0;            // 0 picks a free one
    bool tls = false;                  // with what show_identity() shows, else plain HTTP
};

struct Http_Limits
{
    std::size_t request_bytes = std::size_t{1} << 20;
    std::size_t connections = 256;
    std::size_t waiting_requests = 128;               // complete, not yet taken by a worker; fewer, so that others are heard
    std::size_t answer_bytes = std::size_t{64} << 20; // of all answers that clients have not taken
    unsigned workers = 8;
    std::chrono::milliseconds receive{30'000}; // for the head of a request, and again for its body
    std::chrono::milliseconds send{120'000};   // for an answer
};

class Http_Server
{
public:
    // Accepts connections when it returns. Without credentials (null) everybody may ask; they must outlive the server. Throws
    // std::system_error when the port cannot be had.
    Http_Server(const Http_Endpoint& endpoint, const Http_Limits& limits, Credentials* credentials, Http_Handler handler);
    ~Http_Server(); // stops, waiting for running requests without bound
    Http_Server(const Http_Server&) = delete;
    Http_Server& operator=(const Http_Server&) = delete;

    std::uint16_t port() const;

    // Accepts no more connections, lets the running requests finish and their answers leave, refuses others with 503, ends
    // all threads. False when a request still ran after the grace time, or as soon as all that run are stuck: it goes on, the
    // threads too, and neither the server nor what its handler uses may be destroyed without waiting for it.
    bool stop(std::chrono::milliseconds grace);

private:
    class Daemon;
    std::unique_ptr<Daemon> _daemon;
};

} // namespace cimserver
