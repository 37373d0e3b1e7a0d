// The control socket of a simulated process: one thread that answers lines with lines, to several clients at once.
#pragma once

#include <poll.h>
#include <pthread.h>

#include <list>
#include <mutex>
#include <string>
#include <string_view>
#include <vector>

namespace hxasim
{

// The host process does not notice it: the thread takes no signals, a broken connection raises none, descriptors are closed
// on exec, and a forked child has neither thread nor descriptors. A line is at most 64 KiB; who sends a longer one is told
// and hung up on. A client that keeps silent, or does not read its answers, holds up nobody; when there are too many, the one
// that has been silent longest is hung up on.
class Control_Server
{
public:
    using Handler = std::string (*)(std::string_view line);

    explicit Control_Server(Handler handler) : _handler(handler) {}

    // Serves a socket of mode 0600 at `path`, after ending the one that was served; an empty path only ends that. A socket
    // that nobody serves any more is replaced. Throws std::runtime_error when it cannot be made.
    void serve(const std::string& path);

    void before_fork() { _mutex.lock(); }
    void after_fork_in_parent() { _mutex.unlock(); }
    void after_fork_in_child();

private:
    struct Client
    {
        int descriptor;
        std::string input = {};
        std::string output = {};
        bool last_answer = false; // hang up after it
    };
    using Clients = std::list<Client>; // the one that has been silent longest first

    static void* run(void* server) noexcept;
    void start();
    void end();
    void remove_socket();
    void close_all();
    void work();
    std::vector<pollfd> waiting() const;
    void attend(const std::vector<pollfd>& descriptors);
    void accept_client();
    void hang_up(Clients::iterator client);
    bool attend(Client& client);
    bool receive(Client& client);
    bool converse(Client& client);
    bool send(Client& client);

    Handler _handler;
    std::mutex _serving; // one serve() at a time
    std::mutex _mutex;   // everything below; the thread lets go of it only to wait
    std::string _path;   // empty: not serving
    int _listener = -1;
    int _wake = -1;          // eventfd that ends the thread
    bool _may_accept = true; // false: out of descriptors a moment ago
    bool _stopping = false;
    Clients _clients;
    pthread_t _thread{};
};

} // namespace hxasim
