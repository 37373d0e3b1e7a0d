// The CIM-XML service: takes one HTTP request, asks the operations, gives the HTTP answer (DSP0200).
//
// Served is what operations.h offers; every other operation, pulled enumerations among them, answers CIM_ERR_NOT_SUPPORTED.
// The body is trusted, not the headers, but for CIMOperation: MethodCall, which no web page can send unasked.
#pragma once

#include "cimserver/cimxml/http_message.h"
#include "cimserver/model/operations.h"

namespace cimserver
{

class Service
{
public:
    explicit Service(Name_Spaces& name_spaces) : _name_spaces(name_spaces) {}

    // Safe to call from several threads at once. A failed operation is a CIM error in an answer with status 200; a request
    // from which no operation can be told gets another status. What has to ask a provider is left as the rest of the work.
    // Throws only when memory runs out, and so does that.
    Http_Work handle(const Http_Request& request);

private:
    Name_Spaces& _name_spaces;
};

} // namespace cimserver
