// The CIM-XML service: takes one HTTP request, asks the operations, gives the HTTP answer (DSP0200).
//
// Served is what operations.h offers; every other operation, pulled enumerations among them, answers CIM_ERR_NOT_SUPPORTED.
// The body is trusted, not the headers: only a CIMOperation other than MethodCall is refused.
#pragma once

#include "cimserver/cimxml/http_message.h"
#include "cimserver/operations.h"

namespace cimserver
{

class Service
{
public:
    explicit Service(Operations& operations) : _operations(operations) {}

    // Safe to call from several threads at once. A failed operation is a CIM error in an answer with status 200; a request
    // from which no operation can be told gets another status. Throws only when memory runs out.
    Http_Answer answer(const Http_Request& request);

private:
    Operations& _operations;
};

} // namespace cimserver
