#include "profiles/own_object_manager.h"

#include "cmpi/cimom.h"
#include "schema/CIM_ObjectManager.h"

namespace zmlr
{

namespace
{

constexpr const char* name_space = "root/PG_InterOp";

thread_local bool is_asking = false;

// The model's keys are null: it asks for any instance.
Ref<Instance> first_of_the_server()
{
    const Ref<CIM_ObjectManager> model(CIM_ObjectManager::create());
    Instance_Enumerator found;
    if (cimom::enum_instances(name_space, model.ptr(), found) != 0 || !found)
        return Ref<Instance>();
    return found();
}

class Asking
{
public:
    Asking() { is_asking = true; }
    ~Asking() { is_asking = false; }
    Asking(const Asking&) = delete;
    Asking& operator=(const Asking&) = delete;
};

} // namespace

std::optional<Own_Object_Manager> own_object_manager()
{
    if (is_asking)
        return std::nullopt;
    const Asking asking;
    Own_Object_Manager texts;
    const Ref<Instance> found = first_of_the_server();
    if (const auto* manager = cast<CIM_ObjectManager>(found.ptr()))
    {
        if (!manager->Name.null && !manager->Name.value.empty())
            texts.name = manager->Name.value;
        texts.element_name = manager->ElementName;
        texts.description = manager->Description;
    }
    return texts;
}

} // namespace zmlr
