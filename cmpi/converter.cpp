#include "cmpi/converter.h"

#include "cmpi/cmpi_containers.h"
#include "runtime/log.h"

#include <array>
#include <cstddef>
#include <memory_resource>
#include <utility>
#include <vector>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "Converter";

// The keys of an instance that nobody else holds end when they are in the path.
CMPIrc fill_path(const CMPIBroker* broker, const Ref<Instance>& instance, const char* name_space, CMPI_Ptr<CMPIObjectPath>& path,
                 Kept_Keys* keys)
{
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    CMPI_Ptr<CMPIObjectPath> made(CMNewObjectPath(broker, name_space, instance->meta_class->name, &status));
    if (!made || !okay(status))
        return CMPI_RC_ERR_FAILED;
    CMPIObjectPath_Container container(instance->meta_class->meta_repository, broker, name_space, made.get(), keys);
    if (container.convert_and_end(instance, Flag_Key) != 0)
        return CMPI_RC_ERR_FAILED;
    path = std::move(made);
    return CMPI_RC_OK;
}

// An instance without values under a path.
CMPIrc begin_instance(const CMPIBroker* broker, const Meta_Class* meta_class, const CMPIObjectPath* path,
                      const Property_Filter& filter, CMPI_Ptr<CMPIInstance>& begun)
{
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    begun.reset(CMNewInstance(broker, path, &status));
    if (!begun || !okay(status))
        return CMPI_RC_ERR_FAILED;
    return filter ? filter.install(begun.get(), meta_class) : CMPI_RC_OK;
}

CMPIrc finish_instance(const CMPIBroker* broker, const Ref<Instance>& instance, const char* name_space, Kept_Keys* keys,
                       CMPI_Ptr<CMPIInstance> begun, CMPI_Ptr<CMPIInstance>& cmpi_instance)
{
    CMPIInstance_Container container(instance->meta_class->meta_repository, broker, name_space, begun.get(), keys);
    if (container.convert_and_end(instance, 0) != 0)
        return CMPI_RC_ERR_FAILED;
    cmpi_instance = std::move(begun);
    return CMPI_RC_OK;
}

} // namespace

CMPIrc Property_Filter::install(CMPIInstance* instance, const Meta_Class* meta_class) const
{
    if (_class != meta_class)
    {
        _class = nullptr; // until the keys are complete
        _keys.clear();
        for (uint32 i = 0; i < meta_class->num_meta_features; ++i)
        {
            if (is_key(meta_class->meta_features[i]))
                _keys.push_back(meta_class->meta_features[i]->name);
        }
        _keys.push_back(nullptr);
        _class = meta_class;
    }
    return CMSetPropertyFilter(instance, _names, _keys.data()).rc;
}

CMPIrc make_cmpi_object_path(const CMPIBroker* broker, const Instance* instance, const char* name_space,
                             CMPI_Ptr<CMPIObjectPath>& path)
{
    return fill_path(broker, share(instance), name_space, path, nullptr);
}

CMPIrc make_cmpi_object(const CMPIBroker* broker, Ref<Instance> instance, const char* name_space, const Property_Filter& filter,
                        CMPI_Ptr<CMPIInstance>& cmpi_instance)
{
    alignas(Kept_Key) std::array<std::byte, 8 * sizeof(Kept_Key)> room; // more keys than most classes have
    std::pmr::monotonic_buffer_resource resource(room.data(), room.size());
    Kept_Keys kept(&resource);
    kept.reserve(instance->meta_class->num_keys);

    CMPI_Ptr<CMPIObjectPath> path;
    CMPIrc rc = fill_path(broker, instance, name_space, path, &kept);
    CMPI_Ptr<CMPIInstance> begun;
    if (rc == CMPI_RC_OK)
        rc = begin_instance(broker, instance->meta_class, path.get(), filter, begun);
    path.reset(); // the instance has its own
    if (rc == CMPI_RC_OK)
        rc = finish_instance(broker, instance, name_space, &kept, std::move(begun), cmpi_instance);
    return rc;
}

CMPIrc make_cmpi_instance(const CMPIBroker* broker, Ref<Instance> instance, const char* name_space, const CMPIObjectPath* path,
                          const Property_Filter& filter, CMPI_Ptr<CMPIInstance>& cmpi_instance)
{
    if (!path)
    {
        ZMLR_LOG(LL_WARN, "No ObjectPath built before call to make_CMPI_instance");
        return make_cmpi_object(broker, std::move(instance), name_space, filter, cmpi_instance);
    }
    CMPI_Ptr<CMPIInstance> begun;
    const CMPIrc rc = begin_instance(broker, instance->meta_class, path, filter, begun);
    return rc == CMPI_RC_OK ? finish_instance(broker, instance, name_space, nullptr, std::move(begun), cmpi_instance) : rc;
}

namespace
{

// Fills an instance (a new one of meta_class when it is empty) from a container and places it in the name space.
CMPIrc take(Container& container, const Meta_Class* meta_class, uint32 mask, const String& name_space, Ref<Instance>& instance)
{
    if (container.convert(meta_class, mask, instance) != 0)
        return CMPI_RC_ERR_FAILED;
    __set_name_space_recursive(instance.ptr(), name_space, false);
    return CMPI_RC_OK;
}

} // namespace

CMPIrc make_cimple_instance(const CMPIBroker* broker, const Meta_Class* meta_class, const CMPIObjectPath* path,
                            const CMPIInstance* cmpi_instance, Ref<Instance>& instance)
{
    instance.reset();
    if (!cmpi_instance)
        return CMPI_RC_ERR_FAILED;
    const String name_space = name_space_of(path);
    CMPIInstance_Container container(meta_class->meta_repository, broker, name_space.c_str(), cmpi_instance);
    return take(container, meta_class, 0, name_space, instance);
}

CMPIrc make_cimple_reference(const CMPIBroker* broker, const Meta_Class* meta_class, const CMPIObjectPath* path,
                             Ref<Instance>& instance)
{
    instance.reset();
    const String name_space = name_space_of(path);
    CMPIObjectPath_Container container(meta_class->meta_repository, broker, name_space.c_str(), path);
    return take(container, meta_class, Flag_Key, name_space, instance);
}

CMPIrc make_cimple_method(const CMPIBroker* broker, const Meta_Class* meta_class, const Meta_Method* meta_method,
                          const CMPIObjectPath* path, const CMPIArgs* in, Ref<Instance>& method)
{
    method.reset(create(meta_method));
    const String name_space = name_space_of(path);
    CMPIArgs_Container container(meta_class->meta_repository, broker, name_space.c_str(), in);
    return take(container, nullptr, Flag_In, name_space, method);
}

// Nothing is looked up on the way out: there is no repository.
CMPIrc make_cmpi_method(const CMPIBroker* broker, const char* name_space, const Instance* method, CMPIArgs* out,
                        CMPI_Data& return_value)
{
    CMPIArgs_Container container(nullptr, broker, name_space, out);
    if (container.convert(method, Flag_Out) != 0)
        return CMPI_RC_ERR_FAILED;
    return_value = std::move(container.return_value());
    return CMPI_RC_OK;
}

} // namespace zmlr
