// Cuts connections that take too long, however they do it: silent ones and those that move a byte now and then.
//
// A connection has a deadline while the server waits for the client, and none while the client waits for the server. When
// there are more connections than the limit, one of the address that has most is cut at once: the one that has waited longest,
// unless the server works for it. When the answers that wait hold too much memory it is the one that has not taken its answer for
// longest. So slow clients, and those who guess passwords, never keep others out.
#pragma once

#include <chrono>
#include <condition_variable>
#include <cstddef>
#include <list>
#include <map>
#include <mutex>
#include <string>
#include <thread>

namespace cimserver
{

class Connection_Watch
{
public:
    enum class Phase
    {
        receiving, // the client has to deliver a request
        verifying, // the login waits for its turn: no deadline, but others may need the room
        working,   // the server has to answer: no deadline
        sending    // the client has to take the answer
    };

    struct Limits
    {
        std::size_t connections;
        std::size_t answer_bytes; // of all answers that wait; a single one may be larger
        std::chrono::milliseconds receive;
        std::chrono::milliseconds send;
    };

    struct Connection;

    explicit Connection_Watch(const Limits& limits);
    ~Connection_Watch();
    Connection_Watch(const Connection_Watch&) = delete;
    Connection_Watch& operator=(const Connection_Watch&) = delete;

    // Watches a client's socket, receiving, until remove(), which must come before the socket is closed. Cutting is a shutdown of
    // the socket: its owner sees it end and closes it. Deadlines are kept to a second. Throws std::bad_alloc; the other functions
    // do nothing with a null.
    Connection* add(int socket, const std::string& address);
    // A new phase, or the same one from now on; with the size of the answer that waits. False when the connection is cut.
    bool enter(Connection* connection, Phase phase, std::size_t answer_bytes = 0);
    void remove(Connection* connection);

private:
    void watch();
    void cut_expired();
    Connection* in_the_way();
    Connection* slowest_taker(const Connection* but_for);
    void cut(Connection& connection);
    void hold(Connection& connection, std::size_t answer_bytes);

    Limits _limits;
    std::mutex _mutex;
    std::condition_variable _changed;
    std::list<Connection> _connections;
    std::map<std::string, std::size_t> _counts; // of connections, by address
    std::size_t _answer_bytes = 0;              // of connections that are not cut
    bool _stopping = false;
    std::thread _thread;
};

} // namespace cimserver
