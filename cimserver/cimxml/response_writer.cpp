#include "cimserver/cimxml/response_writer.h"

#include "cimserver/cimxml/object_writer.h"
#include "cimserver/model/value_text.h"

namespace cimserver
{
namespace
{

// Enough for any description of our own; what a client sent may be a megabyte.
constexpr std::size_t max_description = 1000;

// A cut never leaves half a character behind.
std::string_view cut(std::string_view text)
{
    if (text.size() <= max_description)
        return text;
    std::size_t size = max_description;
    while (size > 0 && (static_cast<unsigned char>(text[size]) & 0xC0) == 0x80)
        --size;
    return text.substr(0, size);
}

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

std::string write_success(const Cimxml_Request& request, Answer answer, const std::function<void(Xml_Writer&)>& run)
{
    if (answer == Answer::nothing)
        return write_message(request, run);
    return write_message(request,
                         [&](Xml_Writer& writer)
                         {
                             writer.start("IRETURNVALUE");
                             run(writer);
                             writer.end();
                         });
}

std::string write_method_result(const Cimxml_Request& request, const Method_Result& result)
{
    return write_message(request,
                         [&](Xml_Writer& writer)
                         {
                             if (can_be_sent(result.return_value))
                             {
                                 writer.start("RETURNVALUE").attribute("PARAMTYPE", cim_type_name(result.return_value.type));
                                 write_any_value(writer, result.return_value);
                                 writer.end();
                             }
                             for (const Named_Value& parameter : result.out)
                                 write_output_parameter(writer, parameter);
                         });
}

std::string write_error(const Cimxml_Request& request, const Cim_Error& error)
{
    return write_message(request,
                         [&](Xml_Writer& writer)
                         {
                             writer.start("ERROR").attribute("CODE", std::to_string(error.code()));
                             writer.attribute("DESCRIPTION", cut(error.description())).end();
                         });
}

} // namespace cimserver
