// One connection of the HTTP library: what the server reads from a request's head, and how it answers.
#pragma once

#include "cimserver/cimxml/http_message.h"

#include <microhttpd.h>

#include <cstddef>
#include <string>

namespace cimserver
{

// A header's value, empty when the client sent none.
std::string header_of(MHD_Connection* connection, const char* name);

// The client's numeric address.
std::string client_address(MHD_Connection* connection);

// Whether a web page may be behind a request to a server that knows its clients by their address only: it has an Origin, or a
// Host that is none of this host's loopback names (a page's own name may lead here). No Host at all is no browser.
bool may_be_a_web_page(MHD_Connection* connection);

// Whether Content-Length tells of a body beyond the limit.
bool announces_more_than(MHD_Connection* connection, std::size_t limit);

// Queues the answer with the headers of its status. Its body is not copied: unless it is empty it must live until the request
// is completed. MHD_NO when the answer cannot be queued: the connection is then to be closed.
MHD_Result reply(MHD_Connection* connection, const Http_Answer& answer);

} // namespace cimserver
