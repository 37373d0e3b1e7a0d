// Registrations of tests for events, and what their callbacks heard.
#pragma once

#include "hxal/aen.h"
#include "tests/hxal/library_fixture.h"

#include <chrono>
#include <condition_variable>
#include <functional>
#include <mutex>
#include <string>
#include <vector>

// What callbacks were told, in order, by whatever thread.
class Heard
{
public:
    void add(std::string text)
    {
        const std::lock_guard lock(_mutex);
        _texts.push_back(std::move(text));
        _changed.notify_all();
    }

    // The texts since the last call, once there are `count`; fewer when they do not come.
    std::vector<std::string> take(std::size_t count = 0)
    {
        std::unique_lock lock(_mutex);
        _changed.wait_for(lock, std::chrono::seconds(30), [&] { return _texts.size() >= count; });
        return std::exchange(_texts, {});
    }

private:
    std::mutex _mutex;
    std::condition_variable _changed;
    std::vector<std::string> _texts;
};

// One registration: what is heard of it is its name and the event. It ends with the listener.
struct Listener
{
    Heard* heard = nullptr;
    std::string name = {};
    std::function<void()> then = {}; // in the callback
    std::function<hxa_status_t()> unregister = {};

    Listener(Heard& to, std::string called) : heard(&to), name(std::move(called)) {}
    Listener(const Listener&) = delete;
    Listener& operator=(const Listener&) = delete;
    ~Listener() { end(); }

    hxa_status_t end()
    {
        auto how = std::exchange(unregister, {});
        return how ? how() : HXA_STATUS_OK;
    }

    // Once it was heard the listener may be gone.
    void hear(const std::string& what)
    {
        if (then)
            then();
        heard->add(name + " " + what);
    }
};

template <typename Data> void hear_event(void* listener, uint32_t event, const Data*, hxa_timeval_t)
{
    static_cast<Listener*>(listener)->hear(std::to_string(event));
}

// What `enlist` returned, which stores the handle where it is told; the listener unregisters it.
template <typename Handle> hxa_status_t keep(Listener& listener, hxa_status_t (*delist)(Handle*), auto enlist)
{
    Handle* handle = nullptr;
    const hxa_status_t status = enlist(&handle);
    if (status == HXA_STATUS_OK)
        listener.unregister = [=] { return delist(handle); };
    return status;
}

// One for each kind, with the full form of the callback unless told otherwise.

inline hxa_status_t listen_adapter(Listener& to, const hxal_adapter_t* adapter, hxal_adapter_aen_cbfn_t callback = hear_event,
                                   uint32_t flag = 0)
{
    return keep(to, hxal_adapter_aen_unregister,
                [&](auto handle) { return hxal_adapter_aen_register(adapter, callback, &to, handle, flag); });
}

inline hxa_status_t listen_port(Listener& to, const hxal_t* ioc, hxa_port_aen_data_t data)
{
    return keep(to, hxal_port_aen_unregister,
                [&](auto handle) { return hxal_port_aen_register(ioc, hear_event, &to, &data, handle); });
}

inline hxa_status_t listen_lport(Listener& to, const hxal_t* ioc, hxa_lport_aen_data_t data,
                                 hxal_lport_aen_cbfn_t callback = hear_event, uint32_t flag = 0)
{
    return keep(to, hxal_lport_aen_unregister,
                [&](auto handle) { return hxal_lport_aen_register(ioc, callback, &to, &data, handle, flag); });
}

inline hxa_status_t listen_rport(Listener& to, const hxal_t* ioc, hxa_rport_aen_data_t data)
{
    return keep(to, hxal_rport_aen_unregister,
                [&](auto handle) { return hxal_rport_aen_register(ioc, hear_event, &to, &data, handle); });
}

inline hxa_status_t listen_itnim(Listener& to, const hxal_t* ioc, hxa_itnim_aen_data_t data,
                                 hxal_itnim_aen_cbfn_t callback = hear_event, uint32_t flag = 0)
{
    return keep(to, hxal_itnim_aen_unregister,
                [&](auto handle) { return hxal_itnim_aen_register(ioc, callback, &to, &data, handle, flag); });
}

inline hxa_status_t listen_audit(Listener& to, const hxal_t* ioc, hxa_audit_aen_data_t data)
{
    return keep(to, hxal_audit_aen_unregister,
                [&](auto handle) { return hxal_audit_aen_register(ioc, hear_event, &to, &data, handle); });
}

inline hxa_status_t listen_ioc(Listener& to, const hxal_t* ioc)
{
    return keep(to, hxal_ioc_aen_unregister, [&](auto handle) { return hxal_ioc_aen_register(ioc, hear_event, &to, handle); });
}

inline hxa_status_t listen_ethport(Listener& to, const hxal_t* ioc)
{
    return keep(to, hxal_ethport_aen_unregister,
                [&](auto handle) { return hxal_ethport_aen_register(ioc, hear_event, &to, nullptr, handle); });
}

// A scanned host with one two-port CNA: instances 0 and 1 of both drivers.
class Aen : public Library_Test
{
protected:
    Aen() { scan_anew(); }

    void scan_anew()
    {
        scan(one_cna);
        adapter = hxal_adapter_open_idx(1);
        fc = hxal_adapter_get_fcioc(adapter, 0);
        fc1 = hxal_adapter_get_fcioc(adapter, 1);
        eth = hxal_adapter_get_ethioc(adapter, 0);
    }

    Heard heard;
    const hxal_adapter_t* adapter = nullptr;
    const hxal_t* fc = nullptr;
    const hxal_t* fc1 = nullptr;
    const hxal_t* eth = nullptr;
};
