#include "cimserver/cimxml/connection_watch.h"

#include <sys/socket.h>

#include <iterator>
#include <new>

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

Connection_Watch::Connection* Connection_Watch::add(int socket) noexcept
try
{
    const std::lock_guard lock(_mutex);
    const Clock::time_point now = Clock::now();
    _connections.push_back({socket, Phase::receiving, now, now + _limits.receive, 0, false, {}});
    _connections.back().self = std::prev(_connections.end());
    if (_connections.size() > _limits.connections)
        if (Connection* one = slowest(false, nullptr))
            cut(*one);
    _changed.notify_all();
    return &_connections.back();
}
catch (const std::bad_alloc&)
{
    shutdown(socket, SHUT_RDWR);
    return nullptr;
}

void Connection_Watch::enter(Connection* connection, Phase phase, std::size_t answer_bytes)
{
    if (!connection)
        return;
    const std::lock_guard lock(_mutex);
    connection->phase = phase;
    connection->since = Clock::now();
    connection->deadline = connection->since + (phase == Phase::sending ? _limits.send : _limits.receive);
    hold(*connection, answer_bytes);
    while (_answer_bytes > _limits.answer_bytes)
    {
        Connection* one = slowest(true, connection);
        if (!one)
            return;
        cut(*one);
    }
}

void Connection_Watch::remove(Connection* connection)
{
    if (!connection)
        return;
    const std::lock_guard lock(_mutex);
    hold(*connection, 0);
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
        if (!connection.cut && connection.phase != Phase::working && connection.deadline <= now)
            cut(connection);
}

// The one for which the server has waited longest; null when it waits for none.
Connection_Watch::Connection* Connection_Watch::slowest(bool sending_only, const Connection* but_for)
{
    Connection* found = nullptr;
    for (Connection& connection : _connections)
    {
        const bool waited_for = connection.phase == Phase::sending || (connection.phase == Phase::receiving && !sending_only);
        if (waited_for && !connection.cut && &connection != but_for && (!found || connection.since < found->since))
            found = &connection;
    }
    return found;
}

} // namespace cimserver
