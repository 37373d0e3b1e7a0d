#include "cimserver/indications/listener_queue.h"

#include <cstdio>

namespace cimserver
{

Waiting_Message::Waiting_Message(std::string text_, std::size_t number_, std::atomic<std::size_t>& bytes_)
    : text(std::move(text_))
    , number(number_)
    , bytes(bytes_)
{
    bytes += text.size();
}

Waiting_Message::~Waiting_Message() { bytes -= text.size(); }

std::string lost_indications(std::size_t count)
{
    return std::to_string(count) + (count == 1 ? " indication is lost" : " indications are lost");
}

void Listener_Queue::append(std::shared_ptr<const Waiting_Message> message, std::size_t limit)
{
    waiting.push_back(std::move(message));
    if (waiting.size() - (under_way ? 1 : 0) > limit)
        drop_oldest();
}

std::size_t Listener_Queue::oldest_number() const
{
    const std::size_t oldest = under_way ? 1 : 0;
    return oldest < waiting.size() ? waiting[oldest]->number : no_number;
}

void Listener_Queue::drop_oldest()
{
    waiting.erase(waiting.begin() + (under_way ? 1 : 0));
    if (!under_way)
        attempts = 0;
    if (++dropped == 1)
        tell("too much waits, indications are lost");
}

void Listener_Queue::tell(const std::string& text) const { log.tell("listener " + url + ": " + text); }

void Listener_Queue::tell_dropped()
{
    if (dropped > 0)
        tell("too much waited, " + lost_indications(dropped));
    dropped = 0;
}

void Listener_Queue::tell_end(const std::string& why)
{
    tell_dropped();
    if (!waiting.empty())
        std::fprintf(stderr, "zmlr-cimserver: listener %s: %s, %s\n", url.c_str(), why.c_str(),
                     lost_indications(waiting.size()).c_str());
}

} // namespace cimserver
