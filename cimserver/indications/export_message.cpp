#include "cimserver/indications/export_message.h"

#include "cimserver/cimxml/http_message.h"
#include "cimserver/cimxml/object_writer.h"
#include "cimserver/cimxml/xml_tree.h"

#include <algorithm>
#include <atomic>

namespace cimserver
{
namespace
{

bool holds_error(const Xml_Element& element)
{
    return element.name == "ERROR" || std::any_of(element.children.begin(), element.children.end(), holds_error);
}

} // namespace

std::string export_message(const Instance& indication)
{
    static std::atomic<unsigned long> last_id = 0;
    Xml_Writer writer("<?xml version=\"1.0\" encoding=\"utf-8\"?>\n");
    writer.start("CIM").attribute("CIMVERSION", "2.0").attribute("DTDVERSION", "2.0");
    writer.start("MESSAGE").attribute("ID", std::to_string(++last_id)).attribute("PROTOCOLVERSION", "1.0");
    writer.start("SIMPLEEXPREQ").start("EXPMETHODCALL").attribute("NAME", "ExportIndication");
    writer.start("EXPPARAMVALUE").attribute("NAME", "NewIndication");
    write_instance(writer, indication);
    writer.end().end().end().end().end();
    return writer.take();
}

bool tells_error(const std::string& answer)
{
    try
    {
        return holds_error(read_xml(answer));
    }
    catch (const Http_Refusal&)
    {
        return false;
    }
}

} // namespace cimserver
