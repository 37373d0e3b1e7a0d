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
    Clock::time_point deadline;
    bool cut;
    std::list<Connection>::iterator self;
};

namespace
{

void cut(Connection_Watch::Connection& connection)
{
    connection.cut = true;
    shutdown(connection.socket, SHUT_RDWR);
}

} // namespace

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
    const Clock::time_point deadline = Clock::now() + _limits.receive;
    _connections.push_back({socket, Phase::receiving, deadline, false, {}});
    _connections.back().self = std::prev(_connections.end());
    if (_connections.size() > _limits.connections)
        cut_slowest();
    _changed.notify_all();
    return &_connections.back();
}
catch (const std::bad_alloc&)
{
    shutdown(socket, SHUT_RDWR);
    return nullptr;
}

void Connection_Watch::enter(Connection* connection, Phase phase)
{
    if (!connection)
        return;
    const std::lock_guard lock(_mutex);
    connection->phase = phase;
    connection->deadline = Clock::now() + (phase == Phase::sending ? _limits.send : _limits.receive);
}

void Connection_Watch::remove(Connection* connection)
{
    if (!connection)
        return;
    const std::lock_guard lock(_mutex);
    _connections.erase(connection->self);
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

void Connection_Watch::cut_slowest()
{
    Connection* slowest = nullptr;
    for (Connection& connection : _connections)
        if (!connection.cut && connection.phase == Phase::receiving && (!slowest || connection.deadline < slowest->deadline))
            slowest = &connection;
    if (slowest)
        cut(*slowest);
}

} // namespace cimserver
