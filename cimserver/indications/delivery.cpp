#include "cimserver/indications/delivery.h"

#include "cimserver/indications/export_transfer.h"
#include "cimserver/indications/listener_queue.h"
#include "cimserver/model/names.h"

#include <algorithm>
#include <new>

namespace cimserver
{
namespace
{

constexpr std::chrono::milliseconds longest_wait{60'000};

bool has_part(CURLU* url, CURLUPart part)
{
    char* text = nullptr;
    const bool there = curl_url_get(url, part, &text, 0) == CURLUE_OK && text && *text;
    curl_free(text);
    return there;
}

} // namespace

bool is_listener_url(const std::string& url)
{
    const bool printable = std::ranges::all_of(url, [](char c) { return c > ' ' && c < 0x7F; });
    const std::string lower = lower_name(url);
    if (!printable || !(lower.starts_with("http://") || lower.starts_with("https://")))
        return false;
    const std::unique_ptr<CURLU, void (*)(CURLU*)> parts(curl_url(), curl_url_cleanup);
    if (!parts)
        throw std::bad_alloc();
    return curl_url_set(parts.get(), CURLUPART_URL, url.c_str(), 0) == CURLUE_OK && has_part(parts.get(), CURLUPART_HOST) &&
           !has_part(parts.get(), CURLUPART_USER) && !has_part(parts.get(), CURLUPART_PASSWORD);
}

class Delivery::Transfer : public Export_Transfer
{
public:
    Transfer(std::shared_ptr<Listener_Queue> listener_, const Delivery_Limits& limits)
        : Export_Transfer(listener_->url, {listener_->waiting.front(), &listener_->waiting.front()->text}, limits.timeout,
                          limits.ca_file)
        , listener(std::move(listener_))
    {
    }

    const std::shared_ptr<Listener_Queue> listener;
};

Delivery::Delivery(const Delivery_Limits& limits) : _limits(limits)
{
    static const CURLcode initialised = curl_global_init(CURL_GLOBAL_DEFAULT);
    _multi = initialised == CURLE_OK ? curl_multi_init() : nullptr;
    if (!_multi)
        throw std::bad_alloc();
    _thread = std::thread([this] { run(); });
}

Delivery::~Delivery()
{
    stop(std::chrono::milliseconds(0));
    curl_multi_cleanup(_multi);
}

void Delivery::keep(const std::set<std::string>& urls)
{
    {
        const std::lock_guard lock(_mutex);
        for (const std::string& url : urls)
            if (!_listeners.contains(url))
                _listeners.emplace(url, std::make_shared<Listener_Queue>(url, _log));
        for (const auto& [url, listener] : _listeners)
        {
            listener->removed = !urls.contains(url);
            if (listener->removed)
                listener->tell_end("nobody subscribes for it any more");
        }
        std::erase_if(_listeners, [](const auto& entry) { return entry.second->removed; });
    }
    curl_multi_wakeup(_multi);
}

void Delivery::send(const std::vector<std::string>& urls, std::string text)
{
    {
        const std::lock_guard lock(_mutex);
        if (_stopping)
            return;
        const auto message = std::make_shared<const Waiting_Message>(std::move(text), ++_last_number, _bytes);
        make_room();
        for (const std::string& url : urls)
            if (const auto found = _listeners.find(url); found != _listeners.end())
                found->second->append(message, _limits.waiting);
    }
    curl_multi_wakeup(_multi);
}

// The oldest message gives way in every queue that holds it: only then its memory is free.
void Delivery::make_room()
{
    while (_bytes > _limits.bytes)
    {
        std::size_t oldest = Listener_Queue::no_number;
        for (const auto& [url, listener] : _listeners)
            oldest = std::min(oldest, listener->oldest_number());
        if (oldest == Listener_Queue::no_number)
            return;
        for (const auto& [url, listener] : _listeners)
            if (listener->oldest_number() == oldest)
                listener->drop_oldest();
    }
}

void Delivery::stop(std::chrono::milliseconds grace)
{
    {
        const std::lock_guard lock(_mutex);
        if (!_stopping)
            _deadline = Clock::now() + grace;
        _stopping = true;
    }
    curl_multi_wakeup(_multi);
    if (_thread.joinable())
        _thread.join();
}

void Delivery::run()
{
    while (!finished())
    {
        abandon_removed();
        start_due();
        int running = 0;
        curl_multi_perform(_multi, &running);
        end_transfers();
        curl_multi_poll(_multi, nullptr, 0, static_cast<int>(time_to_next().count()), nullptr);
    }
    for (const auto& transfer : _transfers)
        curl_multi_remove_handle(_multi, transfer->handle());
    _transfers.clear();
}

bool Delivery::finished()
{
    const std::lock_guard lock(_mutex);
    if (!_stopping)
        return false;
    std::size_t left = 0;
    for (const auto& [url, listener] : _listeners)
        left += listener->waiting.size();
    if (left > 0 && Clock::now() < _deadline)
        return false;
    for (const auto& [url, listener] : _listeners)
        listener->tell_end("the server stops");
    return true;
}

// Memory may be out: what cannot be started now is tried again after a pause.
void Delivery::start_due()
{
    const std::lock_guard lock(_mutex);
    for (const auto& [url, listener] : _listeners)
    {
        if (listener->under_way || listener->waiting.empty() || (listener->due > Clock::now() && !_stopping))
            continue;
        try
        {
            _transfers.push_back(std::make_unique<Transfer>(listener, _limits));
            listener->under_way = curl_multi_add_handle(_multi, _transfers.back()->handle()) == CURLM_OK;
            if (!listener->under_way)
            {
                _transfers.pop_back();
                throw std::bad_alloc();
            }
        }
        catch (const std::bad_alloc&)
        {
            listener->due = Clock::now() + _limits.pause;
        }
    }
}

void Delivery::end_transfers()
{
    int left = 0;
    while (const CURLMsg* message = curl_multi_info_read(_multi, &left))
    {
        const CURLcode result = message->data.result;
        const auto ended = std::ranges::find(_transfers, message->easy_handle, [](const auto& t) { return t->handle(); });
        curl_multi_remove_handle(_multi, (*ended)->handle());
        {
            const std::lock_guard lock(_mutex);
            if (!(*ended)->listener->removed)
                settle(*(*ended)->listener, **ended, result);
        }
        _transfers.erase(ended);
    }
}

void Delivery::abandon_removed()
{
    const std::lock_guard lock(_mutex);
    std::erase_if(_transfers,
                  [this](const auto& transfer)
                  {
                      if (transfer->listener->removed)
                          curl_multi_remove_handle(_multi, transfer->handle());
                      return transfer->listener->removed;
                  });
}

// A server that stops tries nothing twice.
void Delivery::settle(Listener_Queue& listener, const Transfer& transfer, int curl_result)
{
    const auto result = static_cast<CURLcode>(curl_result);
    const Export_Outcome outcome = transfer.outcome(result);
    listener.under_way = false;
    ++listener.attempts;
    listener.tell_dropped();
    if (outcome == Export_Outcome::not_taken && listener.attempts < _limits.attempts && !_stopping)
    {
        listener.due = Clock::now() + _limits.pause;
        listener.tell(transfer.problem(result) + "; attempt " + std::to_string(listener.attempts) + " of " +
                      std::to_string(_limits.attempts));
        return;
    }
    if (outcome != Export_Outcome::taken)
        listener.tell(transfer.problem(result) + "; " + lost_indications(1));
    listener.waiting.pop_front();
    listener.attempts = 0;
    listener.due = {};
}

std::chrono::milliseconds Delivery::time_to_next()
{
    const std::lock_guard lock(_mutex);
    auto wait = longest_wait;
    const auto until = [&](Clock::time_point time)
    {
        const auto left = std::chrono::ceil<std::chrono::milliseconds>(time - Clock::now());
        wait = std::clamp(left, std::chrono::milliseconds(0), wait);
    };
    for (const auto& [url, listener] : _listeners)
        if (!listener->waiting.empty() && !listener->under_way)
            until(listener->due);
    if (_stopping)
        until(_deadline);
    return wait;
}

} // namespace cimserver
