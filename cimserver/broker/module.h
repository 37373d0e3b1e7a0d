// Module: a CMPI provider module loaded into the server.
//
// The module is loaded as real servers do it (all symbols bound at once and visible to others), its classes are read through
// cimple_module, and its interfaces are made on their first use by the factory functions. The destructor closes the module
// and unloads it.
#pragma once

#include "cimserver/broker/broker.h"
#include "cimserver/broker/provider_turn.h"
#include "cimserver/model/repository.h"

#include <cmpift.h>

#include <atomic>
#include <condition_variable>
#include <cstddef>
#include <functional>
#include <memory>
#include <mutex>
#include <string>
#include <unordered_map>
#include <vector>

namespace cimserver
{

class Module
{
public:
    // How long a request waits for a provider that others keep busy, unless told otherwise.
    static constexpr std::chrono::seconds usual_patience{30};

    // Throws std::runtime_error that tells the file and why it cannot be loaded, or why it is no module.
    explicit Module(const std::string& file, std::chrono::milliseconds patience = usual_patience);
    ~Module();
    Module(const Module&) = delete;
    Module& operator=(const Module&) = delete;

    // Refuses new requests, waits for those that run, and cleans the interfaces up (terminating) in the reverse order of
    // their making. Once closed, closing again does nothing. Not to be called from within a request.
    void close();

    const Repository& repository() const { return _repository; }
    Broker& broker() { return _broker; }

    // The interfaces of a served class; null when the module does not offer that kind for it. Safe from any thread; an
    // up-call of the factory may come back here. Throws Cim_Error when the factory fails.
    CMPIInstanceMI* instance_mi(const Class_Entry& entry);
    CMPIAssociationMI* association_mi(const Class_Entry& entry);
    CMPIMethodMI* method_mi(const Class_Entry& entry);
    CMPIIndicationMI* indication_mi(const Class_Entry& entry);

    // Who may be with the provider of a served class.
    Provider_Turns& turns(const Class_Entry& entry) { return _providers.at(&entry)->turns; }

    // Keeps the module loaded while a request runs. Throws Cim_Error once the module is being closed.
    class Use
    {
    public:
        explicit Use(Module& module);
        ~Use();
        Use(const Use&) = delete;
        Use& operator=(const Use&) = delete;

    private:
        Module& _module;
    };

private:
    using Library = std::unique_ptr<void, int (*)(void*)>;

    // The interfaces of one provider. They share the provider's state in the module, so one at a time is made. The mutex is
    // recursive because a factory may call back into the server.
    struct Provider
    {
        explicit Provider(std::chrono::milliseconds patience) : turns(patience) {}

        std::recursive_mutex mutex;
        std::atomic<CMPIInstanceMI*> instance_mi = nullptr;
        std::atomic<CMPIAssociationMI*> association_mi = nullptr;
        std::atomic<CMPIMethodMI*> method_mi = nullptr;
        std::atomic<CMPIIndicationMI*> indication_mi = nullptr;
        bool being_made = false;
        Provider_Turns turns;
    };

    static Library open(const std::string& file);
    static const zmlr::Registration* registrations(const Library& library, const std::string& file);

    template <class MI> MI* interface(const Class_Entry& entry, std::atomic<MI*> Provider::*slot, const char* suffix);
    template <class MI> MI* make_interface(const std::string& provider_name, const char* suffix);

    Library _library; // unloaded last
    const Repository _repository;
    Broker _broker;
    std::unordered_map<const Class_Entry*, std::unique_ptr<Provider>> _providers;
    std::mutex _cleanup_mutex;
    std::vector<std::function<CMPIStatus(const CMPIContext*)>> _cleanups; // one per interface, in the order of their making
    std::mutex _use_mutex;
    std::condition_variable _unused;
    std::size_t _uses = 0;
    bool _closing = false;
    bool _stays = false; // the module asked to remain in memory
};

} // namespace cimserver
