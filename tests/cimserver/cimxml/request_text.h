// The text of CIM-XML requests, built around what a test cares about.
#pragma once

#include <string>

namespace test
{

inline std::string message(const std::string& content)
{
    return "<?xml version=\"1.0\" encoding=\"utf-8\" ?>\n"
           "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><MESSAGE ID=\"42\" PROTOCOLVERSION=\"1.0\">" +
           content + "</MESSAGE></CIM>";
}

inline std::string name_space(const std::string& name = "root/test")
{
    const std::size_t slash = name.find('/');
    return "<LOCALNAMESPACEPATH><NAMESPACE NAME=\"" + name.substr(0, slash) + "\"/><NAMESPACE NAME=\"" + name.substr(slash + 1) +
           "\"/></LOCALNAMESPACEPATH>";
}

inline std::string intrinsic(const std::string& operation, const std::string& parameters = "")
{
    return message("<SIMPLEREQ><IMETHODCALL NAME=\"" + operation + "\">" + name_space() + parameters +
                   "</IMETHODCALL></SIMPLEREQ>");
}

inline std::string parameter(const std::string& name, const std::string& value)
{
    return "<IPARAMVALUE NAME=\"" + name + "\">" + value + "</IPARAMVALUE>";
}

inline std::string flag(const std::string& name, const std::string& value)
{
    return parameter(name, "<VALUE>" + value + "</VALUE>");
}

inline std::string class_name(const std::string& name) { return parameter("ClassName", "<CLASSNAME NAME=\"" + name + "\"/>"); }

} // namespace test
