#include "cmpi/cimom.h"
#include "elements.h"
#include "providers/TST_Box_Provider_Skeleton.h"

namespace zmlr
{

namespace
{

template <class... Arguments> uint32 non_nulls(const Arguments&... arguments)
{
    return static_cast<uint32>((0 + ... + (arguments.null ? 0 : 1)));
}

class TST_Box_Provider final : public TST_Box_Provider_Skeleton
{
public:
    Enum_Instances_Status enum_instances(const Class*, Enum_Instances_Handler<Class>& handler) override
    {
        const std::lock_guard lock(boxes().mutex);
        for (const auto& [name, box] : boxes().by_name)
            handler.handle(clone(box.ptr()));
        return ENUM_INSTANCES_OK;
    }

    Create_Instance_Status create_instance(Class* instance) override
    {
        if (instance->Name.null)
            return CREATE_INSTANCE_INVALID_PARAMETER;
        const std::lock_guard lock(boxes().mutex);
        const bool made = boxes().by_name.try_emplace(instance->Name.value.c_str(), clone(instance)).second;
        return made ? CREATE_INSTANCE_OK : CREATE_INSTANCE_DUPLICATE;
    }

    Modify_Instance_Status modify_instance(const Class* model, const Class* instance) override
    {
        const std::lock_guard lock(boxes().mutex);
        const auto found = boxes().by_name.find(instance->Name.value.c_str());
        if (found == boxes().by_name.end())
            return MODIFY_INSTANCE_NOT_FOUND;
        copy(found->second.ptr(), instance, model);
        return MODIFY_INSTANCE_OK;
    }

    Delete_Instance_Status delete_instance(const Class* instance) override
    {
        const std::lock_guard lock(boxes().mutex);
        return boxes().by_name.erase(instance->Name.value.c_str()) == 1 ? DELETE_INSTANCE_OK : DELETE_INSTANCE_NOT_FOUND;
    }

    Invoke_Method_Status EchoScalars(const Class*, Property<boolean>& BooleanValue, Property<uint8>& Uint8Value,
                                     Property<sint8>& Sint8Value, Property<uint16>& Uint16Value, Property<sint16>& Sint16Value,
                                     Property<uint32>& Uint32Value, Property<sint32>& Sint32Value, Property<uint64>& Uint64Value,
                                     Property<sint64>& Sint64Value, Property<real32>& Real32Value, Property<real64>& Real64Value,
                                     Property<char16>& Char16Value, Property<String>& Caption, Property<Datetime>& DatetimeValue,
                                     Property<uint32>& return_value) override
    {
        return_value.set(non_nulls(BooleanValue, Uint8Value, Sint8Value, Uint16Value, Sint16Value, Uint32Value, Sint32Value,
                                   Uint64Value, Sint64Value, Real32Value, Real64Value, Char16Value, Caption, DatetimeValue));
        return INVOKE_METHOD_OK;
    }

    Invoke_Method_Status EchoArrays(const Class*, Property<Array<boolean>>& BooleanValues, Property<Array<uint8>>& Uint8Values,
                                    Property<Array<sint64>>& Sint64Values, Property<Array<real64>>& Real64Values,
                                    Property<Array<char16>>& Char16Values, Property<Array<String>>& StringValues,
                                    Property<Array<Datetime>>& DatetimeValues, Property<uint32>& return_value) override
    {
        return_value.set(
            non_nulls(BooleanValues, Uint8Values, Sint64Values, Real64Values, Char16Values, StringValues, DatetimeValues));
        return INVOKE_METHOD_OK;
    }

    Invoke_Method_Status EchoObjects(const Class*, TST_Element*& Element, Property<Array<Instance*>>& Elements,
                                     Property<String>& Item, Property<uint32>& return_value) override
    {
        return_value.set((Element ? 1U : 0U) + non_nulls(Elements, Item));
        return INVOKE_METHOD_OK;
    }

    Invoke_Method_Status Join(const Class*, const Property<Array<String>>& Parts, const Property<String>& Separator,
                              Property<String>& return_value) override
    {
        String joined;
        for (uint32 i = 0; i < Parts.value.size(); ++i)
            joined.append((i == 0 ? String() : Separator.value) + Parts.value[i]);
        if (!Parts.null)
            return_value.set(joined);
        return INVOKE_METHOD_OK;
    }

    Invoke_Method_Status Fail(const Class*, const Property<uint32>& Status, Property<uint32>&) override
    {
        return static_cast<Invoke_Method_Status>(Status.value);
    }

    Invoke_Method_Status CountItems(const Class*, Property<uint32>& return_value) override
    {
        const Ref<TST_Item> model(create<TST_Item>(false));
        Instance_Enumerator items;
        uint32 count = 0;
        for (cimom::enum_instances("root/zemlar", model.ptr(), items); items; ++items)
            ++count;
        return_value.set(count);
        return INVOKE_METHOD_OK;
    }

    Invoke_Method_Status Ring(const Class*, const Property<uint32>& Times, const Property<String>& Text,
                              Property<uint32>& return_value) override
    {
        uint32 raised = 0;
        while (raised < Times.value && raise_alert(raised + 1, Text.value))
            ++raised;
        return_value.set(raised);
        return INVOKE_METHOD_OK;
    }
};

} // namespace

TST_Box_Provider_Skeleton* create_TST_Box_Provider() { return new TST_Box_Provider; }

} // namespace zmlr
