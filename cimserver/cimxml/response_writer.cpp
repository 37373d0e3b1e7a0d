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
Xml_Writer start_message(const Cimxml_Request& request)
{
    Xml_Writer writer("<?xml version=\"1.0\" encoding=\"utf-8\"?>\n");
    writer.start("CIM").attribute("CIMVERSION", "2.0").attribute("DTDVERSION", "2.0");
    writer.start("MESSAGE").attribute("ID", request.message_id).attribute("PROTOCOLVERSION", "1.0").start("SIMPLERSP");
    writer.start(request.intrinsic ? "IMETHODRESPONSE" : "METHODRESPONSE").attribute("NAME", request.method);
    return writer;
}

std::string end_message(Xml_Writer& writer)
{
    writer.end().end().end().end();
    return writer.take();
}

} // namespace

std::string write_success(const Cimxml_Request& request, Answer answer, const std::function<void(Xml_Writer&)>& run)
{
    Xml_Writer writer = start_message(request);
    if (answer == Answer::value)
        writer.start("IRETURNVALUE");
    run(writer);
    if (answer == Answer::value)
        writer.end();
    return end_message(writer);
}

std::string write_method_result(const Cimxml_Request& request, const Method_Result& result)
{
    Xml_Writer writer = start_message(request);
    if (can_be_sent(result.return_value))
    {
        writer.start("RETURNVALUE").attribute("PARAMTYPE", cim_type_name(result.return_value.type));
        write_any_value(writer, result.return_value);
        writer.end();
    }
    for (const Named_Value& parameter : result.out)
        write_output_parameter(writer, parameter);
    return end_message(writer);
}

std::string write_error(const Cimxml_Request& request, const Cim_Error& error)
{
    Xml_Writer writer = start_message(request);
    writer.start("ERROR").attribute("CODE", std::to_string(error.code()));
    writer.attribute("DESCRIPTION", cut(error.description())).end();
    return end_message(writer);
}

} // namespace cimserver
