#include "cimserver/cimxml/request_reader.h"

#include "cimserver/cimxml/http_message.h"
#include "cimserver/cimxml/object_reader.h"
#include "cimserver/cimxml/request_rules.h"

#include <algorithm>

namespace cimserver
{
namespace
{

// A minor version never changes the meaning of what is there.
bool speaks(const std::string* version, std::string_view major)
{
    return version && version->size() > major.size() && version->starts_with(major) &&
           version->find_first_not_of("0123456789", major.size()) == std::string::npos;
}

// Versions come first: the rules are those of the versions spoken here.
void check_versions(const Xml_Element& cim)
{
    if (cim.name != "CIM" || !cim.attribute("CIMVERSION") || !cim.attribute("DTDVERSION"))
        throw Http_Refusal(400, "request-not-valid");
    if (!speaks(cim.attribute("CIMVERSION"), "2."))
        throw Http_Refusal(501, "unsupported-cim-version");
    if (!speaks(cim.attribute("DTDVERSION"), "2."))
        throw Http_Refusal(501, "unsupported-dtd-version");
    const Xml_Element* message = cim.child("MESSAGE");
    if (message && message->attribute("PROTOCOLVERSION") && !speaks(message->attribute("PROTOCOLVERSION"), "1."))
        throw Http_Refusal(501, "unsupported-protocol-version");
}

bool is_call(const Xml_Element& element) { return element.name != "CORRELATOR"; }

Xml_Element& only_call(Xml_Element& message)
{
    Xml_Element& request = message.children.front();
    if (request.name == "MULTIREQ")
        throw Http_Refusal(501, "multiple-requests-unsupported");
    if (std::ranges::count_if(request.children, is_call) != 1)
        throw Http_Refusal(400, "request-not-valid");
    return *std::ranges::find_if(request.children, is_call);
}

// The path comes first and only once; parameters follow.
void check_call(const Xml_Element& call)
{
    const std::string_view parameter = call.name == "IMETHODCALL" ? "IPARAMVALUE" : "PARAMVALUE";
    const auto others = std::ranges::count_if(call.children, [&](const Xml_Element& child) { return child.name != parameter; });
    if (others != 1 || call.children.front().name == parameter)
        throw Http_Refusal(400, "request-not-valid");
}

} // namespace

Cimxml_Request read_request(std::string_view body)
{
    Xml_Element cim = read_xml(body);
    check_versions(cim);
    check_rules(cim);
    Xml_Element& message = cim.children.front();
    Xml_Element& call = only_call(message);
    check_call(call);

    Cimxml_Request request;
    request.message_id = *message.attribute("ID");
    request.intrinsic = call.name == "IMETHODCALL";
    request.method = *call.attribute("NAME");
    if (request.intrinsic)
        request.name_space = read_name_space(call.children.front());
    request.call = std::move(call);
    return request;
}

const Xml_Element& target_of(const Cimxml_Request& method_call) { return method_call.call.children.front(); }

} // namespace cimserver
