// Every odd request gets its exact refusal, and the accepted forms are read as they are meant.
#include "cimserver/cimxml/http_message.h"
#include "cimserver/cimxml/object_reader.h"
#include "cimserver/cimxml/request_reader.h"
#include "tests/support/rows.h"

#include <gtest/gtest.h>

using namespace cimserver;

namespace
{

std::string message(const std::string& content)
{
    return "<?xml version=\"1.0\" encoding=\"utf-8\" ?>\n"
           "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><MESSAGE ID=\"42\" PROTOCOLVERSION=\"1.0\">" +
           content + "</MESSAGE></CIM>";
}

const std::string name_space = "<LOCALNAMESPACEPATH><NAMESPACE NAME=\"root\"/><NAMESPACE NAME=\"test\"/></LOCALNAMESPACEPATH>";

std::string intrinsic(const std::string& operation, const std::string& parameters = "")
{
    return message("<SIMPLEREQ><IMETHODCALL NAME=\"" + operation + "\">" + name_space + parameters +
                   "</IMETHODCALL></SIMPLEREQ>");
}

std::string parameter(const std::string& name, const std::string& value)
{
    return "<IPARAMVALUE NAME=\"" + name + "\">" + value + "</IPARAMVALUE>";
}

std::string class_name(const std::string& name) { return parameter("ClassName", "<CLASSNAME NAME=\"" + name + "\"/>"); }

// "200", or the status and the CIMError value of the refusal.
std::string outcome_of(const std::string& body)
{
    try
    {
        read_request(body);
        return "200";
    }
    catch (const Http_Refusal& refusal)
    {
        return std::to_string(refusal.status()) + " " + refusal.cim_error();
    }
}

std::string replaced(std::string text, const std::string& what, const std::string& by)
{
    return text.replace(text.find(what), what.size(), by);
}

std::string repeated(const std::string& text, std::size_t times)
{
    std::string result;
    for (std::size_t i = 0; i < times; ++i)
        result += text;
    return result;
}

const std::string good = intrinsic("GetClass", class_name("TST_Port"));
const std::string not_well_formed = "400 request-not-well-formed";
const std::string not_valid = "400 request-not-valid";

struct Case
{
    const char* what;
    std::string body;
    std::string outcome;
};

const Case cases[] = {
    {"a plain request", good, "200"},
    {"no XML declaration", good.substr(good.find('\n')), "200"},
    {"a byte order mark", "\xEF\xBB\xBF" + good, "200"},
    {"many signs that would be attributes in a tag",
     replaced(intrinsic("X", parameter("Y", "<VALUE><![CDATA[" + repeated("a='' ", 300) + "]]></VALUE>")), "<MESSAGE",
              "<?x " + repeated("a='' ", 300) + "?><!-- " + repeated("a='' ", 300) + "--><MESSAGE"),
     "200"},
    {"nothing", "", not_well_formed},
    {"no XML", "GET / HTTP/1.1", not_well_formed},
    {"half a request", good.substr(0, good.size() / 2), not_well_formed},
    {"something behind the end", good + "<x/>", not_well_formed},
    {"a zero byte", replaced(good, "TST_Port", std::string("TST\0Port", 8)), not_well_formed},
    {"invalid UTF-8", replaced(good, "TST_Port", "TST_\xC3\x28"), not_well_formed},
    {"another encoding", replaced(replaced(good, "utf-8", "iso-8859-1"), "TST_Port", "TST_\xE9"), not_well_formed},
    {"UTF-16", std::string("<\0C\0I\0M\0/\0>\0", 12), not_well_formed},
    {"UTF-16 with its mark", std::string("\xFF\xFE<\0C\0/\0>\0", 10), not_well_formed},
    {"EBCDIC", "\x4C\x6F\xA7\x94\x93\x40", not_well_formed},
    {"an unclosed element, very deep", repeated("<a>", 200000), not_valid},
    {"other XML", "<html/>", not_valid},
    {"no message", "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"></CIM>", not_valid},
    {"a response", message("<SIMPLERSP></SIMPLERSP>"), not_valid},
    {"an export request", message("<SIMPLEEXPREQ></SIMPLEEXPREQ>"), not_valid},
    {"no call", message("<SIMPLEREQ></SIMPLEREQ>"), not_valid},
    {"two calls",
     replaced(good, "</SIMPLEREQ>",
              good.substr(good.find("<IMETHODCALL"), good.find("</SIMPLEREQ>") - good.find("<IMETHODCALL")) + "</SIMPLEREQ>"),
     not_valid},
    {"no name space", replaced(good, name_space, ""), not_valid},
    {"an empty name space", replaced(good, name_space, "<LOCALNAMESPACEPATH/>"), not_valid},
    {"two name spaces", replaced(good, name_space, name_space + name_space), not_valid},
    {"the name space last", intrinsic("GetClass").replace(intrinsic("GetClass").find(name_space), 0, class_name("A")), not_valid},
    {"an element in a value", intrinsic("X", parameter("Y", "<VALUE><b/></VALUE>")), not_valid},
    {"two values", intrinsic("X", parameter("Y", "<VALUE>1</VALUE><VALUE>2</VALUE>")), not_valid},
    {"more keys than any class has",
     intrinsic("X", parameter("Y", "<INSTANCENAME CLASSNAME=\"A\">" +
                                       repeated("<KEYBINDING NAME=\"K\"><KEYVALUE/></KEYBINDING>", 65) + "</INSTANCENAME>")),
     not_valid},
    {"very many attributes", replaced(good, " ID=", repeated(" a=''", 300) + " ID="), not_valid},
    {"very many behind what only looks like the start of a comment",
     intrinsic("X", parameter("Y", "<VALUE><![CDATA[<!--]]></VALUE>") + "<Z" + repeated(" a=''", 300) + "/>"), not_valid},
    {"very many elements", intrinsic("X", parameter("Y", "<VALUE.ARRAY>" + repeated("<VALUE/>", 50000) + "</VALUE.ARRAY>")),
     not_valid},
    {"a batch", message("<MULTIREQ></MULTIREQ>"), "501 multiple-requests-unsupported"},
};

} // namespace

TEST(request_reader, gives_each_odd_request_its_refusal)
{
    for (const Case& row : cases)
        EXPECT_EQ(outcome_of(row.body), row.outcome) << row.what;
    for (const auto& row : rows_of("cimxml/odd_requests.txt"))
    {
        std::string body = good;
        for (std::size_t i = 3; i < row.size(); i += 2)
            body = replaced(body, row[i - 1], row[i]);
        EXPECT_EQ(outcome_of(body), row[0]) << row.at(1);
    }
}

TEST(request_reader, reads_names_with_references)
{
    const Cimxml_Request request = read_request(intrinsic("Get&#x43;lass&amp;\xC3\xA9"));
    EXPECT_EQ(request.message_id, "42");
    EXPECT_TRUE(request.intrinsic);
    EXPECT_EQ(request.method, "GetClass&\xC3\xA9");
    EXPECT_EQ(request.name_space, "root/test");
}

namespace
{

Xml_Element instance_name(const std::string& keys)
{
    return read_xml("<INSTANCENAME CLASSNAME=\"A\">" + keys + "</INSTANCENAME>");
}

std::string key(const std::string& type, const std::string& text)
{
    return "<KEYBINDING NAME=\"K\"><KEYVALUE VALUETYPE=\"" + type + "\">" + text + "</KEYVALUE></KEYBINDING>";
}

Value key_value(const std::string& keys) { return read_path(instance_name(keys), "n").keys.at(0).value; }

} // namespace

TEST(object_reader, reads_keys_of_every_kind)
{
    EXPECT_EQ(key_value(key("string", " a ")).get<Text>(), " a ");
    EXPECT_EQ(key_value(key("boolean", " TRUE ")).get<bool>(), true);
    EXPECT_EQ(key_value(key("boolean", "false")).get<bool>(), false);
    for (const char* number : {"0", "-12", "0x1F", "1.5e3", "18446744073709551616"})
        EXPECT_EQ(key_value(key("numeric", std::string(" ") + number)).get<Text>(), number);

    const Object_Path unnamed = read_path(instance_name("<KEYVALUE>x</KEYVALUE>"), "n");
    EXPECT_EQ(unnamed.keys.at(0).name, "");

    const Value reference =
        key_value("<KEYBINDING NAME=\"K\"><VALUE.REFERENCE><INSTANCEPATH><NAMESPACEPATH><HOST>h</HOST>" + name_space +
                  "</NAMESPACEPATH><INSTANCENAME CLASSNAME=\"B\"/></INSTANCEPATH>"
                  "</VALUE.REFERENCE></KEYBINDING>");
    const auto& target = reference.get<Object_Path>();
    EXPECT_EQ(target.host.string() + " " + target.name_space + " " + target.class_name.string(), "h root/test B");
}

TEST(object_reader, refuses_keys_that_cannot_be_read)
{
    for (const std::string& keys :
         {key("boolean", "yes"), key("boolean", ""), key("numeric", ""), key("numeric", "12a"), key("numeric", "--1"),
          key("numeric", "0x"), key("integer", "1"), key("string", "a") + key("string", "b"),
          key("string", "a") + "<KEYVALUE>b</KEYVALUE>", std::string("<KEYVALUE>a</KEYVALUE><KEYVALUE>b</KEYVALUE>"),
          std::string("<KEYBINDING NAME=\"\"><KEYVALUE>a</KEYVALUE></KEYBINDING>"),
          "<KEYBINDING NAME=\"K\"><VALUE.REFERENCE><LOCALINSTANCEPATH>" + name_space + name_space +
              "</LOCALINSTANCEPATH></VALUE.REFERENCE></KEYBINDING>",
          "<KEYBINDING NAME=\"K\"><VALUE.REFERENCE><INSTANCEPATH><NAMESPACEPATH>" + name_space + name_space +
              "</NAMESPACEPATH><INSTANCENAME CLASSNAME=\"B\"/></INSTANCEPATH></VALUE.REFERENCE></KEYBINDING>"})
        EXPECT_THROW(read_path(instance_name(keys), "n"), Cim_Error) << keys;
}
