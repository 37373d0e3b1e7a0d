// Answer: what a request answers, object by object, as its provider hands them over.
#pragma once

#include "cmpi/converter.h"
#include "runtime/instance.h"

#include <cmpift.h>

#include <utility>

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

// Gives an object to the server.
using Send = CMPIrc (*)(const Answer&, Ref<Instance>);

// The callback of an enumeration whose client data are an Answer: takes over each object and sends it. Says stop at the first
// failure, which `rc` keeps, and at the end mark.
template <Send send, class Status> bool answer_with(Instance* instance, Status, void* client_data)
{
    Ref<Instance> object(instance);
    auto& answer = *static_cast<Answer*>(client_data);
    if (!object || answer.rc != CMPI_RC_OK)
        return false;
    answer.rc = send(answer, std::move(object));
    return answer.rc == CMPI_RC_OK;
}

} // namespace zmlr
