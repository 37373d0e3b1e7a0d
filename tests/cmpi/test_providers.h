// Providers that do what a test tells them and remember what they were asked.
#pragma once

#include "cmpi/provider_handle.h"
#include "cmpi/static_data.h"
#include "tests/cmpi/things.h"

#include <functional>
#include <memory>
#include <mutex>
#include <vector>

namespace test
{

// One for all providers of the tests, which take turns with it.
struct Script
{
    // What to answer.
    std::vector<Ref<Instance>> instances; // what enumerations deliver, as clones
    Enum_Instances_Status enum_instances = ENUM_INSTANCES_OK;
    Get_Instance_Status get_instance = GET_INSTANCE_UNSUPPORTED;
    Create_Instance_Status create_instance = CREATE_INSTANCE_UNSUPPORTED;
    Modify_Instance_Status modify_instance = MODIFY_INSTANCE_UNSUPPORTED;
    Delete_Instance_Status delete_instance = DELETE_INSTANCE_UNSUPPORTED;
    Enum_Associator_Names_Status enum_associator_names = ENUM_ASSOCIATOR_NAMES_UNSUPPORTED;
    Enum_References_Status enum_references = ENUM_REFERENCES_UNSUPPORTED;
    Enum_Associators_Status enum_associators = ENUM_ASSOCIATORS_UNSUPPORTED;
    std::vector<Ref<Instance>> associators; // what enum_associators and enum_associator_names deliver, as clones
    Invoke_Method_Status invoke_method = INVOKE_METHOD_OK;
    Enable_Indications_Status enable_indications = ENABLE_INDICATIONS_OK;
    Disable_Indications_Status disable_indications = DISABLE_INDICATIONS_OK;
    std::function<void(Instance*)> on_invoke; // gets the parameters
    std::function<void()> on_enable;
    std::function<void()> on_disable;
    bool deaf = false;             // goes on when told to stop
    std::function<void()> on_load; // called by load()
    std::function<void()> on_enum; // called by enum_instances before it delivers
    std::function<void()> on_unload;

    // What happened.
    int providers = 0; // alive
    int loads = 0;
    int unloads = 0;
    int enumerations = 0;
    int delivered = 0;
    Ref<Instance> model; // of the last request
    Ref<Instance> instance;
    int enables = 0;
    int disables = 0;
    std::unique_ptr<Indication_Handler<TST_Alert>> handler; // while indications are enabled

    static Script& get();
    static Script& fresh(); // emptied
    static std::recursive_mutex& turn();
};

// The records of the providers; TST_Alert's is the head of their list.
extern const Registration thing_registration;
extern const Registration disk_registration;
extern const Registration link_registration;
extern const Registration alert_registration;

} // namespace test
