#include "cimserver/broker/module.h"

#include "cimserver/broker/request.h"
#include "cimserver/broker/return_code.h"
#include "cimserver/model/values.h"

#include <dlfcn.h>
#include <stdexcept>

namespace cimserver
{
namespace
{

template <class Function> Function* symbol(void* library, const std::string& name)
{
    return reinterpret_cast<Function*>(dlsym(library, name.c_str()));
}

std::string last_loader_error()
{
    const char* text = dlerror();
    return text ? text : "unknown error";
}

bool wants_to_stay(CMPIrc rc) { return rc == CMPI_RC_DO_NOT_UNLOAD || rc == CMPI_RC_NEVER_UNLOAD; }

} // namespace

Module::Library Module::open(const std::string& file)
{
    Library library(dlopen(file.c_str(), RTLD_NOW | RTLD_GLOBAL), dlclose);
    if (!library)
        throw std::runtime_error("cannot load the module: " + last_loader_error());
    return library;
}

const zmlr::Registration* Module::registrations(const Library& library, const std::string& file)
{
    const auto list = symbol<const zmlr::Registration*()>(library.get(), "cimple_module");
    if (!list)
        throw std::runtime_error(file + " is no provider module: it has no function cimple_module");
    const zmlr::Registration* head = list();
    if (!head)
        throw std::runtime_error(file + " serves no class: its registration list is empty");
    return head;
}

Module::Module(const std::string& file, std::chrono::milliseconds patience)
    : _library(open(file))
    , _repository(registrations(_library, file))
    , _broker(_repository)
{
    for (const Class_Entry* entry : _repository.served())
        _providers.emplace(entry, std::make_unique<Provider>(patience));
}

Module::~Module()
{
    close();
    if (_stays)
        (void)_library.release();
}

void Module::close()
{
    {
        std::unique_lock<std::mutex> lock(_use_mutex);
        _closing = true;
        _unused.wait(lock, [this] { return _uses == 0; });
    }

    Request request;
    while (!_cleanups.empty())
    {
        _stays = wants_to_stay(_cleanups.back()(request.context()).rc) || _stays;
        _cleanups.pop_back();
    }
}

Module::Use::Use(Module& module) : _module(module)
{
    const std::lock_guard<std::mutex> lock(_module._use_mutex);
    if (_module._closing)
        throw Cim_Error(CIM_ERR_FAILED, "the server is stopping");
    ++_module._uses;
}

// Notifies under the lock: once it is released, the module may be gone.
Module::Use::~Use()
{
    const std::lock_guard<std::mutex> lock(_module._use_mutex);
    if (--_module._uses == 0)
        _module._unused.notify_all();
}

CMPIInstanceMI* Module::instance_mi(const Class_Entry& entry)
{
    return interface(entry, &Provider::instance_mi, "_Create_InstanceMI");
}

CMPIAssociationMI* Module::association_mi(const Class_Entry& entry)
{
    return interface(entry, &Provider::association_mi, "_Create_AssociationMI");
}

CMPIMethodMI* Module::method_mi(const Class_Entry& entry) { return interface(entry, &Provider::method_mi, "_Create_MethodMI"); }

CMPIIndicationMI* Module::indication_mi(const Class_Entry& entry)
{
    return interface(entry, &Provider::indication_mi, "_Create_IndicationMI");
}

template <class MI> MI* Module::interface(const Class_Entry& entry, std::atomic<MI*> Provider::*slot, const char* suffix)
{
    Provider& provider = *_providers.at(&entry);
    if (MI* made = provider.*slot)
        return made;

    const std::lock_guard<std::recursive_mutex> lock(provider.mutex);
    if (MI* made = provider.*slot)
        return made;
    if (provider.being_made)
        throw Cim_Error(CIM_ERR_FAILED, std::string(entry.registration->provider_name) + " is still being loaded");

    provider.being_made = true;
    const std::unique_ptr<bool, void (*)(bool*)> making(&provider.being_made, [](bool* flag) { *flag = false; });
    MI* made = make_interface<MI>(entry.registration->provider_name, suffix);
    provider.*slot = made;
    return made;
}

template <class MI> MI* Module::make_interface(const std::string& provider_name, const char* suffix)
{
    using Factory = MI*(const CMPIBroker*, const CMPIContext*, CMPIStatus*);
    const auto factory = symbol<Factory>(_library.get(), provider_name + suffix);
    if (!factory)
        return nullptr;

    Request request;
    CMPIStatus status{CMPI_RC_OK, nullptr};
    MI* made = factory(_broker.face(), request.context(), &status);
    if (!made || status.rc != CMPI_RC_OK)
        throw Cim_Error(CIM_ERR_FAILED, outcome_text(provider_name, "loading it", status.rc));

    const std::lock_guard<std::mutex> lock(_cleanup_mutex);
    _cleanups.emplace_back([made](const CMPIContext* context) { return made->ft->cleanup(made, context, 1); });
    return made;
}

} // namespace cimserver
