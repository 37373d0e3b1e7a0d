#include "cimserver/indications/delivery.h"

#include "cimserver/broker/names.h"
#include "cimserver/indications/export_transfer.h"

#include <algorithm>
#include <cstdio>
#include <deque>
#include <new>
#include <optional>

namespace cimserver
{
namespace
{

using Message = std::shared_ptr<const std::string>;

constexpr std::chrono::milliseconds longest_wait{60'000};

void tell(const std::string& url, const std::string& text)
{
    std::fprintf(stderr, "zmlr-cimserver: listener %s: %s\n", url.c_str(), text.c_str());
}

std::string indications(std::size_t count)
{
    return std::to_string(count) + (count == 1 ? " indication is lost" : " indications are lost");
}

struct Free_Url
{
    void operator()(CURLU* url) const { curl_url_cleanup(url); }
};

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
    const std::unique_ptr<CURLU, Free_Url> parts(curl_url());
    if (!parts)
        throw std::bad_alloc();
    return curl_url_set(parts.get(), CURLUPART_URL, url.c_str(), 0) == CURLUE_OK && has_part(parts.get(), CURLUPART_HOST) &&
           !has_part(parts.get(), CURLUPART_USER) && !has_part(parts.get(), CURLUPART_PASSWORD);
}

struct Delivery::Listener
{
    const std::string url;
    std::deque<Message> waiting; // the first one may be under way
    bool under_way = false;
    bool removed = false;
    unsigned attempts = 0;   // of the first one
    Clock::time_point due{}; // when it may be tried again
    std::size_t lost = 0;    // since it was last told
};

class Delivery::Transfer : public Export_Transfer
{
public:
    Transfer(std::shared_ptr<Listener> listener_, const Delivery_Limits& limits)
        : Export_Transfer(listener_->url, listener_->waiting.front(), limits.timeout, limits.ca_file)
        , listener(std::move(listener_))
    {
    }

    const std::shared_ptr<Listener> listener;
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
                _listeners.emplace(url, std::make_shared<Listener>(Listener{url, {}}));
        for (const auto& [url, listener] : _listeners)
            listener->removed = !urls.contains(url);
        std::erase_if(_listeners, [](const auto& entry) { return entry.second->removed; });
    }
    curl_multi_wakeup(_multi);
}

void Delivery::send(const std::string& url, std::string message)
{
    auto shared = std::make_shared<const std::string>(std::move(message));
    {
        const std::lock_guard lock(_mutex);
        const auto found = _listeners.find(url);
        if (_stopping || found == _listeners.end())
            return;
        Listener& listener = *found->second;
        listener.waiting.push_back(std::move(shared));
        if (listener.waiting.size() > _limits.waiting + (listener.under_way ? 1 : 0))
        {
            listener.waiting.erase(listener.waiting.begin() + (listener.under_way ? 1 : 0));
            if (++listener.lost == 1)
                tell(url, "its queue is full, indications are lost");
        }
    }
    curl_multi_wakeup(_multi);
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
        if (!listener->waiting.empty())
            tell(url, "the server stops, " + indications(listener->waiting.size()));
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
            listener->under_way = true;
            curl_multi_add_handle(_multi, _transfers.back()->handle());
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
void Delivery::settle(Listener& listener, const Transfer& transfer, int curl_result)
{
    const auto result = static_cast<CURLcode>(curl_result);
    const Export_Outcome outcome = transfer.outcome(result);
    listener.under_way = false;
    ++listener.attempts;
    if (outcome == Export_Outcome::not_taken && listener.attempts < _limits.attempts && !_stopping)
    {
        listener.due = Clock::now() + _limits.pause;
        tell(listener.url, transfer.problem(result) + "; attempt " + std::to_string(listener.attempts) + " of " +
                               std::to_string(_limits.attempts));
        return;
    }
    if (outcome != Export_Outcome::taken)
        tell(listener.url, transfer.problem(result) + "; " + indications(1));
    if (listener.lost > 0)
        tell(listener.url, "its queue was full, " + indications(listener.lost));
    listener.lost = 0;
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
