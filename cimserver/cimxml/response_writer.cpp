#include "cimserver/cimxml/response_writer.h"

namespace cimserver
{

namespace
{

// The elements around every answer: CIM, MESSAGE, SIMPLERSP and the response that bears the request's name.
std::string write_message(const Cimxml_Request& request, const std::function<void(Xml_Writer&)>& content)
{
    Xml_Writer writer("<?xml version=\"1.0\" encoding=\"utf-8\"?>\n");
    writer.start("CIM").attribute("CIMVERSION", "2.0").attribute("DTDVERSION", "2.0");
    writer.start("MESSAGE").attribute("ID", request.message_id).attribute("PROTOCOLVERSION", "1.0").start("SIMPLERSP");
    writer.start(request.intrinsic ? "IMETHODRESPONSE" : "METHODRESPONSE").attribute("NAME", request.method);
    content(writer);
    writer.end().end().end().end();
    return writer.take();
}

} // namespace

std::string write_success(const Cimxml_Request& request, const std::function<void(Xml_Writer&)>& content)
{
    return write_message(request,
                         [&](Xml_Writer& writer)
                         {
                             writer.start("IRETURNVALUE");
                             content(writer);
                             writer.end();
                         });
}

std::string write_error(const Cimxml_Request& request, const Cim_Error& error)
{
    return write_message(request,
                         [&](Xml_Writer& writer)
                         {
                             writer.start("ERROR").attribute("CODE", std::to_string(error.code()));
                             writer.attribute("DESCRIPTION", error.description()).end();
                         });
}

} // namespace cimserver
