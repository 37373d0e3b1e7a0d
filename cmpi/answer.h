// Answer: what a request answers, object by object, as its provider hands them over.
#pragma once

#include "cmpi/converter.h"
#include "runtime/instance.h"

#include <cmpift.h>

namespace zmlr
{

class Far_Ends;

struct Answer
{
    const CMPIBroker* broker;
    const CMPIContext* context;
    const CMPIResult* result;
    String name_space; // of the request's path
    Property_Filter properties = {};
    Far_Ends* far_ends = nullptr; // of associators that are fetched one by one
    CMPIrc rc = CMPI_RC_OK;       // of the first object that could not be answered
};

// The callback of an enumeration whose client data are an Answer: takes over each object and gives it to `send`, which
// answers a CMPIrc. Says stop at the first failure, which `rc` keeps, and at the end mark.
template <CMPIrc (*send)(const Answer&, Instance*), class Status> bool answer_with(Instance* instance, Status, void* client_data)
{
    const Ref<Instance> object(instance);
    auto& answer = *static_cast<Answer*>(client_data);
    if (!object || answer.rc != CMPI_RC_OK)
        return false;
    answer.rc = send(answer, object.ptr());
    return answer.rc == CMPI_RC_OK;
}

} // namespace zmlr
