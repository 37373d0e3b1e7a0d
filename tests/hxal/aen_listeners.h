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

    // Registers for a kind of event, in the full form of the callback unless told otherwise: on an IOC, or for an adapter, which
    // may be missing, with what the kind looks at in `filter`.
    template <typename Callback = std::nullptr_t>
    hxa_status_t listen(hxa_aen_category_t kind, const hxal_t* ioc, const hxa_aen_data_t& filter = {}, Callback short_form = {});
    template <typename Callback = std::nullptr_t> hxa_status_t listen(const hxal_adapter_t* adapter, Callback short_form = {});

private:
    // What `enlist` returned, which stores the handle where it is told; the listener unregisters it.
    template <typename Handle> hxa_status_t keep(hxa_status_t (*delist)(Handle*), auto enlist)
    {
        Handle* handle = nullptr;
        const hxa_status_t status = enlist(&handle);
        if (status == HXA_STATUS_OK)
            unregister = [=] { return delist(handle); };
        return status;
    }
};

template <typename Data> void hear_event(void* listener, uint32_t event, const Data*, hxa_timeval_t)
{
    static_cast<Listener*>(listener)->hear(std::to_string(event));
}

// The callback as a registration takes it: in the full form, or the short one in disguise.
template <typename Full_Form, typename Short_Form> Full_Form form_of(Short_Form callback, Full_Form full)
{
    if constexpr (std::is_null_pointer_v<Short_Form>)
        return full;
    else
        return reinterpret_cast<Full_Form>(reinterpret_cast<void (*)()>(callback));
}

template <typename Callback> hxa_status_t Listener::listen(const hxal_adapter_t* adapter, Callback short_form)
{
    const uint32_t flag = std::is_null_pointer_v<Callback> ? 0 : HXAL_AEN_SNIA;
    const auto callback = form_of<hxal_adapter_aen_cbfn_t>(short_form, hear_event);
    return keep(hxal_adapter_aen_unregister,
                [&](auto handle) { return hxal_adapter_aen_register(adapter, callback, this, handle, flag); });
}

template <typename Callback>
hxa_status_t Listener::listen(hxa_aen_category_t kind, const hxal_t* ioc, const hxa_aen_data_t& filter, Callback short_form)
{
    const uint32_t flag = std::is_null_pointer_v<Callback> ? 0 : HXAL_AEN_SNIA;
    const auto lport_form = form_of<hxal_lport_aen_cbfn_t>(short_form, hear_event);
    const auto itnim_form = form_of<hxal_itnim_aen_cbfn_t>(short_form, hear_event);
    // clang-format off
    switch (kind)
    {
    case HXA_AEN_CAT_PORT:
        return keep(hxal_port_aen_unregister, [&](auto to) { return hxal_port_aen_register(ioc, hear_event, this, &filter.port, to); });
    case HXA_AEN_CAT_LPORT:
        return keep(hxal_lport_aen_unregister, [&](auto to) { return hxal_lport_aen_register(ioc, lport_form, this, &filter.lport, to, flag); });
    case HXA_AEN_CAT_RPORT:
        return keep(hxal_rport_aen_unregister, [&](auto to) { return hxal_rport_aen_register(ioc, hear_event, this, &filter.rport, to); });
    case HXA_AEN_CAT_ITNIM:
        return keep(hxal_itnim_aen_unregister, [&](auto to) { return hxal_itnim_aen_register(ioc, itnim_form, this, &filter.itnim, to, flag); });
    case HXA_AEN_CAT_AUDIT:
        return keep(hxal_audit_aen_unregister, [&](auto to) { return hxal_audit_aen_register(ioc, hear_event, this, &filter.audit, to); });
    case HXA_AEN_CAT_ETHPORT:
        return keep(hxal_ethport_aen_unregister, [&](auto to) { return hxal_ethport_aen_register(ioc, hear_event, this, nullptr, to); });
    default:
        return keep(hxal_ioc_aen_unregister, [&](auto to) { return hxal_ioc_aen_register(ioc, hear_event, this, to); });
    }
    // clang-format on
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
