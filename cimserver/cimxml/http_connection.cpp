#include "cimserver/cimxml/http_connection.h"

#include "cimserver/cimxml/listener.h"
#include "cimserver/model/names.h"
#include "text/integers.h"

#include <netdb.h>
#include <sys/socket.h>

namespace cimserver
{
namespace
{

void add_headers(MHD_Response* response, const Http_Answer& answer)
{
    if (answer.status == MHD_HTTP_OK)
    {
        MHD_add_response_header(response, "Content-Type", "application/xml; charset=\"utf-8\"");
        MHD_add_response_header(response, "CIMOperation", "MethodResponse");
    }
    if (!answer.cim_error.empty())
        MHD_add_response_header(response, "CIMError", answer.cim_error.c_str());
    if (answer.status == MHD_HTTP_UNAUTHORIZED)
        MHD_add_response_header(response, "WWW-Authenticate", "Basic realm=\"zmlr-cimserver\", charset=\"UTF-8\"");
    if (answer.status == MHD_HTTP_METHOD_NOT_ALLOWED)
        MHD_add_response_header(response, "Allow", "POST");
    if (answer.status == MHD_HTTP_SERVICE_UNAVAILABLE)
        MHD_add_response_header(response, "Retry-After", "1");
}

} // namespace

std::string header_of(MHD_Connection* connection, const char* name)
{
    const char* value = MHD_lookup_connection_value(connection, MHD_HEADER_KIND, name);
    return value ? value : "";
}

std::string client_address(MHD_Connection* connection)
{
    const sockaddr* address = MHD_get_connection_info(connection, MHD_CONNECTION_INFO_CLIENT_ADDRESS)->client_addr;
    const socklen_t size = address->sa_family == AF_INET ? sizeof(sockaddr_in) : sizeof(sockaddr_in6);
    char text[NI_MAXHOST] = "?";
    getnameinfo(address, size, text, sizeof text, nullptr, 0, NI_NUMERICHOST);
    return text;
}

bool may_be_a_web_page(MHD_Connection* connection)
{
    if (MHD_lookup_connection_value(connection, MHD_HEADER_KIND, MHD_HTTP_HEADER_ORIGIN))
        return true;
    std::string host = header_of(connection, MHD_HTTP_HEADER_HOST);
    const std::size_t port = host.rfind(':');
    if (port != std::string::npos && host.find_first_not_of("0123456789", port + 1) == std::string::npos)
        host.erase(port);
    if (host.starts_with('[') && host.ends_with(']'))
        host = host.substr(1, host.size() - 2);
    return !host.empty() && !equal_names(host, "localhost") && !is_loopback(host);
}

bool announces_more_than(MHD_Connection* connection, std::size_t limit)
{
    const std::string length = header_of(connection, MHD_HTTP_HEADER_CONTENT_LENGTH);
    const auto bytes = text::read_digits(length, 10); // none for a number beyond 64 bits
    return !length.empty() && (!bytes || *bytes > limit);
}

MHD_Result reply(MHD_Connection* connection, const Http_Answer& answer)
{
    MHD_Response* response =
        MHD_create_response_from_buffer(answer.body.size(), const_cast<char*>(answer.body.data()), MHD_RESPMEM_PERSISTENT);
    if (!response)
        return MHD_NO;
    add_headers(response, answer);
    const MHD_Result result = MHD_queue_response(connection, answer.status, response);
    MHD_destroy_response(response);
    return result;
}

} // namespace cimserver
