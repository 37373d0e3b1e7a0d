// The method interface of an adapter.
#include "cmpi/converter.h"
#include "cmpi/request.h"
#include "cmpi/status_to_rc.h"

namespace zmlr
{

namespace
{

bool is_class_path(const CMPIObjectPath* path)
{
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    return CMGetKeyCount(path, &status) == 0 && okay(status);
}

CMPIrc invoke(CMPI_Adapter& adapter, const CMPIResult* result, const CMPIObjectPath* path, const char* name, const CMPIArgs* in,
              CMPIArgs* out)
{
    const Meta_Class* meta_class = adapter.requested_class(path);
    if (!meta_class)
        return CMPI_RC_ERR_FAILED;
    const Meta_Method* method = name ? find_method(meta_class, name) : nullptr;
    if (!method)
        return CMPI_RC_ERR_METHOD_NOT_FOUND;
    if ((method->flags & Flag_Static) && !is_class_path(path))
        return CMPI_RC_ERR_FAILED; // a static method is called on the class

    Ref<Instance> target;
    CMPIrc rc = make_cimple_reference(adapter.broker, meta_class, path, target);
    if (rc != CMPI_RC_OK)
        return rc;
    Ref<Instance> parameters;
    rc = make_cimple_method(adapter.broker, meta_class, method, path, in, parameters);
    if (rc != CMPI_RC_OK)
        return rc;

    rc = to_rc(adapter.invoke_method(target.ptr(), parameters.ptr()));
    if (rc != CMPI_RC_OK)
        return rc;

    CMPI_Data return_value;
    rc = make_cmpi_method(adapter.broker, name_space_of(path).c_str(), parameters.ptr(), out, return_value);
    if (rc != CMPI_RC_OK)
        return rc;
    if (const CMPIValue* value = return_value.value())
        CMReturnData(result, value, return_value.type());
    CMReturnDone(result);
    return CMPI_RC_OK;
}

} // namespace

CMPIStatus CMPI_Adapter::methodCleanup(CMPIMethodMI* mi, const CMPIContext* context, CMPIBoolean terminating) noexcept
{
    return serve_cleanup("methodCleanup", mi, context, terminating);
}

CMPIStatus CMPI_Adapter::invokeMethod(CMPIMethodMI* mi, const CMPIContext* context, const CMPIResult* result,
                                      const CMPIObjectPath* path, const char* method, const CMPIArgs* in, CMPIArgs* out) noexcept
{
    const auto work = [&](CMPI_Adapter& adapter) { return invoke(adapter, result, path, method, in, out); };
    return serve("invokeMethod", mi, context, work);
}

} // namespace zmlr
