// The HTTP server of the CIM-XML service: POST to any path, on the loopback interface.
//
// One thread moves bytes for all connections, a few workers run the handler, so neither a slow client nor a slow operation
// keeps others from being served. What passes a limit is refused with a status: 413 for a body beyond request_bytes (told
// by its Content-Length, before any of it is read, else at its end), 503 when too many requests wait. Clients that do not
// deliver a request or take an answer in time are cut, so is a body without a Content-Length that goes on far beyond the
// limit, and so may be a client that ends its sending side before it has its answer.
#pragma once

#include "cimserver/cimxml/http_message.h"

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <memory>

namespace cimserver
{

struct Http_Limits
{
    std::size_t request_bytes = std::size_t{1} << 20;
    std::size_t connections = 256;
    std::size_t waiting_requests = 256; // complete, not yet taken by a worker
    unsigned workers = 8;
    std::chrono::milliseconds receive{30'000}; // for the head of a request, and again for its body
    std::chrono::milliseconds send{120'000};   // for an answer
};

class Http_Server
{
public:
    // Accepts connections when it returns; port 0 picks a free one. Throws std::system_error when the port cannot be had.
    Http_Server(std::uint16_t port, const Http_Limits& limits, Http_Handler handler);
    ~Http_Server(); // stops, waiting for running requests without bound
    Http_Server(const Http_Server&) = delete;
    Http_Server& operator=(const Http_Server&) = delete;

    std::uint16_t port() const;

    // Accepts no more connections, lets the running requests finish and their answers leave, refuses others with 503, ends
    // all threads. False when a request still ran after the grace time: it goes on, the threads too, and neither the server
    // nor what its handler uses may be destroyed without waiting for it.
    bool stop(std::chrono::milliseconds grace);

private:
    class Daemon;
    std::unique_ptr<Daemon> _daemon;
};

} // namespace cimserver
