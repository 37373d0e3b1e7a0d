// Cuts connections that take too long, however they do it: silent ones and those that move a byte now and then.
//
// A connection has a deadline while the server waits for the client, and none while the client waits for the server. When
// there are more connections than the limit, the one that has kept the server waiting longest for a request is cut at once,
// so that slow clients never keep others out.
#pragma once

#include <chrono>
#include <condition_variable>
#include <cstddef>
#include <list>
#include <mutex>
#include <thread>

namespace cimserver
{

class Connection_Watch
{
public:
    enum class Phase
    {
        receiving, // the client has to deliver a request
        working,   // the server has to answer: no deadline
        sending    // the client has to take the answer
    };

    struct Limits
    {
        std::size_t connections;
        std::chrono::milliseconds receive;
        std::chrono::milliseconds send;
    };

    struct Connection;

    explicit Connection_Watch(const Limits& limits);
    ~Connection_Watch();
    Connection_Watch(const Connection_Watch&) = delete;
    Connection_Watch& operator=(const Connection_Watch&) = delete;

    // Watches a socket, receiving, until remove(), which must come before the socket is closed. Cutting is a shutdown of the
    // socket: its owner sees it end and closes it. Deadlines are kept to a second. Null, and the socket cut, when memory is
    // out; the other functions do nothing with a null.
    Connection* add(int socket) noexcept;
    void enter(Connection* connection, Phase phase); // a new phase, or the same one from now on
    void remove(Connection* connection);

private:
    void watch();
    void cut_expired();
    void cut_slowest();

    Limits _limits;
    std::mutex _mutex;
    std::condition_variable _changed;
    std::list<Connection> _connections;
    bool _stopping = false;
    std::thread _thread;
};

} // namespace cimserver
