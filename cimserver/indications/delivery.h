// Delivery: sends indications to listeners, as CIM-XML export over HTTP or HTTPS.
//
// Each listener has a queue of its own and gets its messages in their order, one at a time: the next one leaves when the one
// before it has been taken or given up. One thread serves all listeners, so a slow one holds up neither the others nor
// whoever raises indications.
//
// What a listener does not take (no connection, no answer in time, HTTP status 408, 429 or 5xx) is tried again after a pause,
// a few times; what it refuses (another status, or a CIM error) is not. When a queue is full its oldest waiting message gives
// way; when all queues together hold too much, the oldest one of all does. Everything that is lost is told on standard error.
#pragma once

#include "cimserver/security/bounded_log.h"

#include <atomic>
#include <chrono>
#include <cstddef>
#include <map>
#include <memory>
#include <mutex>
#include <set>
#include <string>
#include <thread>
#include <vector>

namespace cimserver
{

struct Listener_Queue;

struct Delivery_Limits
{
    unsigned attempts = 3;
    std::chrono::milliseconds pause{20'000};   // between attempts
    std::chrono::milliseconds timeout{15'000}; // of one attempt, from connecting to the end of the answer
    std::size_t waiting = 1000;                // messages per listener
    std::size_t bytes = std::size_t{64} << 20; // of the messages of all listeners; one that several wait for counts once
    std::string ca_file;                       // certificates that vouch for HTTPS listeners; empty: the system's
};

// Whether a text is the URL of a listener that can be served: http or https, a host, no user or password (every client could
// read them), printable ASCII only.
bool is_listener_url(const std::string& url);

class Delivery
{
public:
    explicit Delivery(const Delivery_Limits& limits);
    ~Delivery(); // stops at once
    Delivery(const Delivery&) = delete;
    Delivery& operator=(const Delivery&) = delete;

    // From now on there are these listeners and no others: new ones begin with an empty queue, what waits for one that is
    // gone is dropped.
    void keep(const std::set<std::string>& urls);

    // Appends a message to the queue of each of these listeners, without waiting for anything; who is no listener is left out.
    void send(const std::vector<std::string>& urls, std::string text);

    // Takes no more messages, tries those that wait once more until the time is over, and ends. Later calls do nothing.
    void stop(std::chrono::milliseconds grace);

private:
    using Clock = std::chrono::steady_clock;
    class Transfer;

    void make_room();
    void run();
    bool finished();
    void start_due();
    void end_transfers();
    void abandon_removed();
    void settle(Listener_Queue& listener, const Transfer& transfer, int curl_result);
    std::chrono::milliseconds time_to_next();

    const Delivery_Limits _limits;
    Bounded_Log _log{"more lines about listeners"};
    std::atomic<std::size_t> _bytes = 0; // of the messages that live
    std::mutex _mutex;                   // guards what follows, and the listeners
    std::size_t _last_number = 0;        // of a message
    std::map<std::string, std::shared_ptr<Listener_Queue>> _listeners;
    bool _stopping = false;
    Clock::time_point _deadline;

    void* _multi;                                      // of libcurl
    std::vector<std::unique_ptr<Transfer>> _transfers; // the thread's own
    std::thread _thread;
};

} // namespace cimserver
