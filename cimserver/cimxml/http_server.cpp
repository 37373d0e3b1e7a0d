#include "cimserver/cimxml/http_server.h"

#include "cimserver/cimxml/connection_watch.h"
#include "cimserver/cimxml/http_connection.h"
#include "cimserver/cimxml/listener.h"
#include "cimserver/cimxml/worker_pool.h"
#include "cimserver/security/bounded_log.h"
#include "cimserver/security/credentials.h"
#include "cimserver/security/tls_identity.h"

#include <microhttpd.h>
#include <sys/socket.h>

#include <atomic>
#include <cerrno>
#include <condition_variable>
#include <mutex>
#include <new>
#include <optional>
#include <string_view>
#include <system_error>
#include <utility>
#include <vector>

namespace cimserver
{
namespace
{

using Clock = std::chrono::steady_clock;

// Room for the head of a request; a longer head is refused by the HTTP library.
constexpr std::size_t head_bytes = 32 * 1024;

// Connections that are being cut still count until the library closes them.
constexpr unsigned spare_connections = 64;

// A client hears of a refused body only when it has sent all of it. One that goes on beyond this many times the limit is cut.
constexpr std::size_t max_excess = 4;

constexpr unsigned handlers = 2;
constexpr unsigned spare_workers = 64; // for those that hang

// One request on its way: filled by the byte mover, answered by a worker while the connection is suspended. One that is
// answered already, because its login is refused, is only drained.
struct Exchange
{
    Http_Request request;
    std::function<Http_Answer()> rest; // of the work
    std::optional<Login> login;        // while it is verified
    std::size_t received = 0;          // bytes of the body, kept or not
    bool submitted = false;
    std::optional<Http_Answer> answer;

    void receive(std::string_view bytes, std::size_t limit)
    {
        received += bytes.size();
        if (received <= limit && !answer)
            request.body.append(bytes);
        else
            std::string().swap(request.body);
    }
};

} // namespace

class Http_Server::Daemon
{
public:
    Daemon(const Http_Endpoint& endpoint, const Http_Limits& limits, Credentials* credentials, Http_Handler handler);
    ~Daemon();

    std::uint16_t port() const { return _listener.port(); }
    bool stop(Clock::time_point deadline);

private:
    // What the HTTP library calls. No exception leaves them.
    static MHD_Result on_request(void* self, MHD_Connection* connection, const char* url, const char* method,
                                 const char* http_version, const char* data, std::size_t* size, void** context) noexcept;
    static void on_completed(void* self, MHD_Connection* connection, void** context, MHD_RequestTerminationCode) noexcept;
    static void on_connection(void* self, MHD_Connection* connection, void** context,
                              MHD_ConnectionNotificationCode code) noexcept;

    void start(const Http_Endpoint& endpoint);
    MHD_Result begin(MHD_Connection* connection, std::string_view method, void** context);
    void log_in(MHD_Connection* connection, Exchange& exchange);
    MHD_Result finish(MHD_Connection* connection, Exchange& exchange);
    void submit(MHD_Connection* connection, Exchange& exchange);

    // What the pools' threads do for an exchange. False: another of them goes on.
    using Step = bool (Daemon::*)(MHD_Connection*, Exchange&);
    bool verify(MHD_Connection* connection, Exchange& exchange);
    bool handle(MHD_Connection* connection, Exchange& exchange);
    bool work(MHD_Connection* connection, Exchange& exchange);
    Worker_Pool::Job job(MHD_Connection* connection, Exchange& exchange, Step step);
    void hand_over(MHD_Connection* connection, Worker_Pool& pool, Worker_Pool::Job job, const std::string& whose = "");
    void run(MHD_Connection* connection, Exchange& exchange, Step step) noexcept;
    bool enter(MHD_Connection* connection, Connection_Watch::Phase phase, std::size_t answer_bytes = 0);

    const Http_Limits _limits;
    Credentials* const _credentials;
    const Http_Handler _handler;
    Listener _listener;
    std::atomic<bool> _stopping = false;

    std::mutex _mutex;
    std::condition_variable _answered;
    std::size_t _unanswered = 0; // submitted, the answer not yet sent

    Bounded_Log _refusals{"more logins were refused"};
    Connection_Watch _watch;
    Worker_Pool _verifiers;
    Worker_Pool _handlers;
    Worker_Pool _pool;
    MHD_Daemon* _http = nullptr;
};

Http_Server::Daemon::Daemon(const Http_Endpoint& endpoint, const Http_Limits& limits, Credentials* credentials,
                            Http_Handler handler)
    : _limits(limits)
    , _credentials(credentials)
    , _handler(std::move(handler))
    , _listener(endpoint.address, endpoint.port)
    , _watch({limits.connections, limits.answer_bytes, limits.receive, limits.send})
    , _verifiers({1, 0, limits.connections + spare_connections})
    , _handlers({handlers, 0, limits.waiting_requests})
    , _pool({limits.workers, spare_workers, limits.waiting_requests})
{
    start(endpoint);
    if (!_http)
        throw std::system_error(errno, std::generic_category(), "cannot start the HTTP server");
}

void Http_Server::Daemon::start(const Http_Endpoint& endpoint)
{
    std::vector<MHD_OptionItem> tls;
    if (endpoint.tls)
        tls = {{MHD_OPTION_HTTPS_CERT_CALLBACK2, 0, identity_callback()},
               {MHD_OPTION_HTTPS_PRIORITIES, 0, const_cast<char*>(tls_priorities)}};
    tls.push_back({MHD_OPTION_END, 0, nullptr});

    const unsigned tls_flag = endpoint.tls ? MHD_USE_TLS : MHD_NO_FLAG;
    const unsigned flags = MHD_USE_EPOLL_INTERNAL_THREAD | MHD_ALLOW_SUSPEND_RESUME | tls_flag;
    // clang-format off
    _http = MHD_start_daemon(flags, 0, nullptr, nullptr, on_request, this,
                             MHD_OPTION_LISTEN_SOCKET, _listener.socket(),
                             MHD_OPTION_CONNECTION_LIMIT, static_cast<unsigned>(_limits.connections) + spare_connections,
                             MHD_OPTION_CONNECTION_MEMORY_LIMIT, head_bytes,
                             MHD_OPTION_STRICT_FOR_CLIENT, 1,
                             MHD_OPTION_NOTIFY_COMPLETED, on_completed, this,
                             MHD_OPTION_NOTIFY_CONNECTION, on_connection, this,
                             MHD_OPTION_ARRAY, tls.data(),
                             MHD_OPTION_END);
    // clang-format on
}

Http_Server::Daemon::~Daemon()
{
    while (!stop(Clock::now() + std::chrono::hours(1)))
    {
    }
}

bool Http_Server::Daemon::stop(Clock::time_point deadline)
{
    if (!_http)
        return true;
    if (!_stopping.exchange(true))
    {
        MHD_quiesce_daemon(_http);
        _listener.refuse();
    }
    if (!_verifiers.stop(deadline) || !_handlers.stop(deadline) || !_pool.stop(deadline))
        return false;
    {
        std::unique_lock lock(_mutex); // a client that does not take its answer does not keep the server from stopping
        _answered.wait_until(lock, deadline, [this] { return _unanswered == 0; });
    }
    MHD_stop_daemon(_http);
    _http = nullptr;
    return true;
}

MHD_Result Http_Server::Daemon::on_request(void* self, MHD_Connection* connection, const char*, const char* method, const char*,
                                           const char* data, std::size_t* size, void** context) noexcept
{
    auto& daemon = *static_cast<Daemon*>(self);
    try
    {
        if (!*context)
            return daemon.begin(connection, method, context);
        auto& exchange = *static_cast<Exchange*>(*context);
        const bool verified = std::exchange(exchange.login, std::nullopt).has_value();
        if (verified)
            daemon.enter(connection, Connection_Watch::Phase::receiving);
        if (*size == 0)
            return verified ? MHD_YES : daemon.finish(connection, exchange);
        exchange.receive({data, std::exchange(*size, 0)}, daemon._limits.request_bytes);
        return exchange.received <= max_excess * daemon._limits.request_bytes ? MHD_YES : MHD_NO; // which closes the connection
    }
    catch (...)
    {
        return MHD_NO;
    }
}

void Http_Server::Daemon::on_completed(void* self, MHD_Connection* connection, void** context,
                                       MHD_RequestTerminationCode) noexcept
{
    auto& daemon = *static_cast<Daemon*>(self);
    const std::unique_ptr<Exchange> exchange(static_cast<Exchange*>(*context));
    *context = nullptr;
    daemon.enter(connection, Connection_Watch::Phase::receiving);
    if (!exchange || !exchange->submitted)
        return;
    const std::lock_guard lock(daemon._mutex);
    --daemon._unanswered;
    daemon._answered.notify_all();
}

void Http_Server::Daemon::on_connection(void* self, MHD_Connection* connection, void** context,
                                        MHD_ConnectionNotificationCode code) noexcept
{
    Connection_Watch& watch = static_cast<Daemon*>(self)->_watch;
    if (code != MHD_CONNECTION_NOTIFY_STARTED)
        return watch.remove(static_cast<Connection_Watch::Connection*>(*context));
    const int socket = MHD_get_connection_info(connection, MHD_CONNECTION_INFO_CONNECTION_FD)->connect_fd;
    try
    {
        *context = watch.add(socket, client_address(connection));
    }
    catch (const std::bad_alloc&)
    {
        shutdown(socket, SHUT_RDWR);
    }
}

// The head of a request has arrived: refuse it, or go on to its body.
MHD_Result Http_Server::Daemon::begin(MHD_Connection* connection, std::string_view method, void** context)
{
    if (method != MHD_HTTP_METHOD_POST)
        return reply(connection, {MHD_HTTP_METHOD_NOT_ALLOWED, "", ""});
    if (!_credentials && may_be_a_web_page(connection))
        return reply(connection, {MHD_HTTP_FORBIDDEN, "", ""});
    if (announces_more_than(connection, _limits.request_bytes))
        return reply(connection, {MHD_HTTP_CONTENT_TOO_LARGE, "", ""});
    enter(connection, Connection_Watch::Phase::receiving);
    auto exchange = std::make_unique<Exchange>();
    exchange->request.cim_operation = header_of(connection, "CIMOperation");
    if (_credentials)
        log_in(connection, *exchange);
    *context = exchange.release();
    return MHD_YES;
}

// A client that is refused is heard to its end all the same: one that still sends might not see the answer.
void Http_Server::Daemon::log_in(MHD_Connection* connection, Exchange& exchange)
{
    const auto login = read_basic_login(header_of(connection, MHD_HTTP_HEADER_AUTHORIZATION));
    if (!login)
    {
        exchange.answer = {MHD_HTTP_UNAUTHORIZED, "", ""};
        return;
    }
    exchange.request.user = login->name;
    if (_credentials->remembers(*login))
        return;

    exchange.login = login;
    enter(connection, Connection_Watch::Phase::verifying);
    hand_over(connection, _verifiers, job(connection, exchange, &Daemon::verify), client_address(connection));
}

// A connection that was cut meanwhile costs no hash.
bool Http_Server::Daemon::verify(MHD_Connection* connection, Exchange& exchange)
{
    if (!enter(connection, Connection_Watch::Phase::verifying))
        return true;
    if (_credentials->verify(*exchange.login))
    {
        exchange.answer.reset();
        return true;
    }
    _refusals.tell("refused the login of \"" + printable_name(exchange.login->name) + "\" from " + client_address(connection));
    exchange.answer = {MHD_HTTP_UNAUTHORIZED, "", ""};
    return true;
}

// Called when the body is complete, and again when the answer is there.
MHD_Result Http_Server::Daemon::finish(MHD_Connection* connection, Exchange& exchange)
{
    if (!exchange.answer && exchange.received > _limits.request_bytes)
        exchange.answer = {MHD_HTTP_CONTENT_TOO_LARGE, "", ""};
    if (!exchange.answer)
    {
        submit(connection, exchange);
        return MHD_YES;
    }
    enter(connection, Connection_Watch::Phase::sending, exchange.answer->body.size());
    return reply(connection, *exchange.answer);
}

void Http_Server::Daemon::submit(MHD_Connection* connection, Exchange& exchange)
{
    exchange.submitted = true;
    {
        const std::lock_guard lock(_mutex);
        ++_unanswered;
    }
    enter(connection, Connection_Watch::Phase::working);
    hand_over(connection, _handlers, job(connection, exchange, &Daemon::handle));
}

bool Http_Server::Daemon::handle(MHD_Connection* connection, Exchange& exchange)
{
    Http_Work made = _handler(exchange.request);
    exchange.rest = std::move(made.rest);
    if (exchange.rest)
        return !_pool.submit(job(connection, exchange, &Daemon::work));
    exchange.answer = std::move(made.answer);
    return true;
}

bool Http_Server::Daemon::work(MHD_Connection*, Exchange& exchange)
{
    exchange.answer = exchange.rest();
    return true;
}

// When too much waits, or the server stops before the step is run, the answer says so.
Worker_Pool::Job Http_Server::Daemon::job(MHD_Connection* connection, Exchange& exchange, Step step)
{
    exchange.answer = {MHD_HTTP_SERVICE_UNAVAILABLE, "", ""};
    return [this, connection, &exchange, step] { run(connection, exchange, step); };
}

// The connection is suspended first: a worker may resume it before submit() returns.
void Http_Server::Daemon::hand_over(MHD_Connection* connection, Worker_Pool& pool, Worker_Pool::Job job, const std::string& whose)
{
    MHD_suspend_connection(connection);
    if (!pool.submit(std::move(job), whose))
        MHD_resume_connection(connection);
}

void Http_Server::Daemon::run(MHD_Connection* connection, Exchange& exchange, Step step) noexcept
{
    bool over = true;
    try
    {
        over = _stopping || (this->*step)(connection, exchange);
    }
    catch (...)
    {
        exchange.answer = {MHD_HTTP_INTERNAL_SERVER_ERROR, "", ""};
    }
    if (over)
        MHD_resume_connection(connection);
}

bool Http_Server::Daemon::enter(MHD_Connection* connection, Connection_Watch::Phase phase, std::size_t answer_bytes)
{
    void* context = MHD_get_connection_info(connection, MHD_CONNECTION_INFO_SOCKET_CONTEXT)->socket_context;
    return _watch.enter(static_cast<Connection_Watch::Connection*>(context), phase, answer_bytes);
}

Http_Server::Http_Server(const Http_Endpoint& endpoint, const Http_Limits& limits, Credentials* credentials, Http_Handler handler)
    : _daemon(std::make_unique<Daemon>(endpoint, limits, credentials, std::move(handler)))
{
}

Http_Server::~Http_Server() = default;

std::uint16_t Http_Server::port() const { return _daemon->port(); }

bool Http_Server::stop(std::chrono::milliseconds grace) { return _daemon->stop(Clock::now() + grace); }

} // namespace cimserver
