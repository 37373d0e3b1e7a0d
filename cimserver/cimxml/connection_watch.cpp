#include "cimserver/cimxml/connection_watch.h"

#include <sys/socket.h>

#include <iterator>
#include <utility>

namespace cimserver
{

using Clock = std::chrono::steady_clock;

struct Connection_Watch::Connection
{
    int socket;
    Phase phase;
    Clock::time_point since;
    Clock::time_point deadline;
    std::size_t answer_bytes;
    bool cut;
    std::list<Connection>::iterator self;
    std::map<std::string, std::size_t>::iterator count; // of its address
};

Connection_Watch::Connection_Watch(const Limits& limits) : _limits(limits), _thread([this] { watch(); }) {}

Connection_Watch::~Connection_Watch()
{
    {
        const std::lock_guard lock(_mutex);
        _stopping = true;
    }
    _changed.notify_all();
    _thread.join();
}

Connection_Watch::Connection* Connection_Watch::add(int socket, const std::string& address)
{
    const std::lock_guard lock(_mutex);
    const Clock::time_point now = Clock::now();
    const auto count = _counts.try_emplace(address).first;
    _connections.push_back({socket, Phase::receiving, now, now + _limits.receive, 0, false, {}, count});
    _connections.back().self = std::prev(_connections.end());
    ++count->second;
    if (_connections.size() > _limits.connections)
        if (Connection* one = in_the_way())
            cut(*one);
    _changed.notify_all();
    return &_connections.back();
}

bool Connection_Watch::enter(Connection* connection, Phase phase, std::size_t answer_bytes)
{
    if (!connection)
        return false;
    const std::lock_guard lock(_mutex);
    connection->phase = phase;
    connection->since = Clock::now();
    connection->deadline = connection->since + (phase == Phase::sending ? _limits.send : _limits.receive);
    hold(*connection, answer_bytes);
    while (Connection* one = _answer_bytes > _limits.answer_bytes ? slowest_taker(connection) : nullptr)
        cut(*one);
    return !connection->cut;
}

void Connection_Watch::remove(Connection* connection)
{
    if (!connection)
        return;
    const std::lock_guard lock(_mutex);
    hold(*connection, 0);
    if (--connection->count->second == 0)
        _counts.erase(connection->count);
    _connections.erase(connection->self);
}

// What a connection that is cut still holds is about to go.
void Connection_Watch::hold(Connection& connection, std::size_t answer_bytes)
{
    _answer_bytes -= connection.answer_bytes;
    connection.answer_bytes = connection.cut ? 0 : answer_bytes;
    _answer_bytes += connection.answer_bytes;
}

void Connection_Watch::cut(Connection& connection)
{
    connection.cut = true;
    hold(connection, 0);
    shutdown(connection.socket, SHUT_RDWR);
}

void Connection_Watch::watch()
{
    std::unique_lock lock(_mutex);
    while (!_stopping)
    {
        if (_connections.empty())
            _changed.wait(lock, [this] { return _stopping || !_connections.empty(); });
        else
            _changed.wait_for(lock, std::chrono::seconds(1), [this] { return _stopping; });
        cut_expired();
    }
}

void Connection_Watch::cut_expired()
{
    const Clock::time_point now = Clock::now();
    for (Connection& connection : _connections)
        if (!connection.cut && connection.phase != Phase::working && connection.phase != Phase::verifying &&
            connection.deadline <= now)
            cut(connection);
}

// Null when all that are not cut are worked for.
Connection_Watch::Connection* Connection_Watch::in_the_way()
{
    Connection* found = nullptr;
    for (Connection& connection : _connections)
        if (connection.phase != Phase::working && !connection.cut &&
            (!found || std::pair(connection.count->second, found->since) > std::pair(found->count->second, connection.since)))
            found = &connection;
    return found;
}

// Null when no other has an answer to take.
Connection_Watch::Connection* Connection_Watch::slowest_taker(const Connection* but_for)
{
    Connection* found = nullptr;
    for (Connection& connection : _connections)
        if (connection.phase == Phase::sending && !connection.cut && &connection != but_for &&
            (!found || connection.since < found->since))
            found = &connection;
    return found;
}

} // namespace cimserver
