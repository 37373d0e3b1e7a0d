// What waits for one listener, and what of it was lost. Not safe for several threads at once.
#pragma once

#include "cimserver/security/bounded_log.h"

#include <atomic>
#include <chrono>
#include <cstddef>
#include <deque>
#include <limits>
#include <memory>
#include <string>

namespace cimserver
{

// A message that any number of queues share. `bytes` counts its text while it lives, and must outlive it.
struct Waiting_Message
{
    Waiting_Message(std::string text, std::size_t number, std::atomic<std::size_t>& bytes);
    ~Waiting_Message();
    Waiting_Message(const Waiting_Message&) = delete;
    Waiting_Message& operator=(const Waiting_Message&) = delete;

    const std::string text;
    const std::size_t number; // those made later have higher ones
    std::atomic<std::size_t>& bytes;
};

struct Listener_Queue
{
    static constexpr std::size_t no_number = std::numeric_limits<std::size_t>::max(); // of no message

    Listener_Queue(std::string url_, Bounded_Log& log_) : url(std::move(url_)), log(log_) {}

    // Appends a message. When more than `limit` wait without being under way, the oldest of these is dropped.
    void append(std::shared_ptr<const Waiting_Message> message, std::size_t limit);

    // The oldest message that waits without being under way: its number, `no_number` when there is none; and its end, to be
    // called only when there is one.
    std::size_t oldest_number() const;
    void drop_oldest();

    // On standard error: anything about the listener, within the bounds of the log; how many messages were dropped since it was
    // last told, if any; that all that waits is lost, if any does, whatever the bounds.
    void tell(const std::string& text) const;
    void tell_dropped();
    void tell_end(const std::string& why);

    const std::string url;
    Bounded_Log& log;                                           // outlives it
    std::deque<std::shared_ptr<const Waiting_Message>> waiting; // the first one may be under way
    bool under_way = false;
    bool removed = false;
    unsigned attempts = 0;                       // of the first one
    std::chrono::steady_clock::time_point due{}; // when it may be tried again
    std::size_t dropped = 0;                     // since it was last told
};

// "1 indication is lost"
std::string lost_indications(std::size_t count);

} // namespace cimserver
