// Operations from the request's text to the answer's text.
#include "cimserver/cimxml/service.h"

#include "fake_operations.h"
#include "request_text.h"

#include <gtest/gtest.h>

using namespace cimserver;
using namespace test;

namespace
{

class service : public testing::Test
{
protected:
    Fake_Operations operations;
    Service under_test{operations};

    std::string ask(const std::string& body) { return under_test.answer({"MethodCall", body}).body; }

    // What stands inside IRETURNVALUE.
    std::string result_of(const std::string& operation, const std::string& parameters)
    {
        const std::string answer = ask(intrinsic(operation, parameters));
        const std::string open = "<IRETURNVALUE>";
        const std::size_t first = answer.find(open) + open.size();
        return answer.substr(first, answer.find("</IRETURNVALUE>") - first);
    }

    // The CODE of an answer's ERROR, 0 without one.
    int error_of(const std::string& body)
    {
        const std::string answer = ask(body);
        const std::size_t code = answer.find("<ERROR CODE=\"");
        return code == std::string::npos ? 0 : std::stoi(answer.substr(code + 13));
    }
};

const std::string key_1 = "<KEYBINDING NAME=\"Name\"><KEYVALUE VALUETYPE=\"string\">1</KEYVALUE></KEYBINDING>";

std::string port_name(const std::string& keys)
{
    return parameter("InstanceName", "<INSTANCENAME CLASSNAME=\"TST_Port\">" + keys + "</INSTANCENAME>");
}

std::string call_reset(const std::string& target)
{
    return message("<SIMPLEREQ><METHODCALL NAME=\"Reset\">" + target + "</METHODCALL></SIMPLEREQ>");
}

} // namespace

TEST_F(service, answers_with_the_whole_message)
{
    operations.instances.pop_back();
    const std::string frame =
        "<?xml version=\"1.0\" encoding=\"utf-8\"?>\n<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\">"
        "<MESSAGE ID=\"42\" PROTOCOLVERSION=\"1.0\"><SIMPLERSP><IMETHODRESPONSE NAME=\"enumerateInstanceNames\">";
    const std::string end = "</IMETHODRESPONSE></SIMPLERSP></MESSAGE></CIM>";
    EXPECT_EQ(ask(intrinsic("enumerateInstanceNames", class_name("TST_Port"))),
              frame +
                  "<IRETURNVALUE><INSTANCENAME CLASSNAME=\"TST_Port\"><KEYBINDING NAME=\"Name\"><KEYVALUE VALUETYPE=\"string\" "
                  "TYPE=\"string\">1</KEYVALUE></KEYBINDING></INSTANCENAME></IRETURNVALUE>" +
                  end);
    EXPECT_EQ(ask(intrinsic("enumerateInstanceNames")),
              frame + "<ERROR CODE=\"4\" DESCRIPTION=\"missing parameter: ClassName\"></ERROR>" + end);
    operations.instances.clear();
    EXPECT_EQ(ask(intrinsic("enumerateInstanceNames", class_name("TST_Port"))), frame + "<IRETURNVALUE></IRETURNVALUE>" + end);
}

TEST_F(service, enumerates_instances_as_asked)
{
    operations.instances.pop_back();
    EXPECT_EQ(
        result_of("EnumerateInstances",
                  class_name("TST_Port") + flag("DeepInheritance", "FALSE") + flag("IncludeClassOrigin", "True") +
                      flag("LocalOnly", "TRUE") + flag("IncludeQualifiers", "TRUE") +
                      parameter("PropertyList", "<VALUE.ARRAY><VALUE>Name</VALUE><VALUE>Status</VALUE></VALUE.ARRAY>")),
        "<VALUE.NAMEDINSTANCE><INSTANCENAME CLASSNAME=\"TST_Port\"><KEYBINDING NAME=\"Name\"><KEYVALUE VALUETYPE=\"string\" "
        "TYPE=\"string\">1</KEYVALUE></KEYBINDING></INSTANCENAME><INSTANCE CLASSNAME=\"TST_Port\"><PROPERTY NAME=\"Name\" "
        "TYPE=\"string\" CLASSORIGIN=\"TST_Element\"><VALUE>1</VALUE></PROPERTY><PROPERTY NAME=\"Status\" TYPE=\"string\" "
        "CLASSORIGIN=\"TST_Element\"></PROPERTY></INSTANCE></VALUE.NAMEDINSTANCE>");
    EXPECT_EQ(operations.last_class, "TST_Port");
    EXPECT_FALSE(operations.last_deep);
    EXPECT_EQ(operations.last_properties, (std::vector<std::string>{"Name", "Status"}));

    result_of("EnumerateInstances", class_name("TST_Port") + parameter("PropertyList", "<VALUE.ARRAY/>"));
    EXPECT_TRUE(operations.last_deep);
    EXPECT_EQ(operations.last_properties, std::vector<std::string>());
    result_of("EnumerateInstances", class_name("TST_Port"));
    EXPECT_EQ(operations.last_properties, std::nullopt);
}

TEST_F(service, gets_an_instance_by_named_and_unnamed_key)
{
    const std::string port =
        "<INSTANCE CLASSNAME=\"TST_Port\"><PROPERTY NAME=\"Name\" TYPE=\"string\"><VALUE>1</VALUE></PROPERTY>"
        "<PROPERTY NAME=\"Status\" TYPE=\"string\"></PROPERTY></INSTANCE>";
    for (const std::string& keys : {key_1, std::string("<KEYVALUE>1</KEYVALUE>")})
    {
        EXPECT_EQ(result_of("GetInstance", port_name(keys)), port);
        EXPECT_EQ(operations.last_path.name_space, "root/test");
        EXPECT_EQ(operations.last_path.keys.at(0).name, "Name");
        EXPECT_EQ(std::get<std::string>(operations.last_path.keys.at(0).value.content), "1");
    }
    const std::string link =
        parameter("InstanceName", "<INSTANCENAME CLASSNAME=\"TST_Link\"><KEYVALUE>1</KEYVALUE></INSTANCENAME>");
    EXPECT_EQ(error_of(intrinsic("GetInstance", link)), CIM_ERR_INVALID_PARAMETER);
}

TEST_F(service, answers_class_operations)
{
    EXPECT_EQ(result_of("EnumerateClassNames", flag("DeepInheritance", "TRUE")),
              "<CLASSNAME NAME=\"TST_Element\"></CLASSNAME><CLASSNAME NAME=\"TST_Link\"></CLASSNAME>");
    EXPECT_EQ(operations.last_class, "");
    EXPECT_TRUE(operations.last_deep);
    EXPECT_EQ(
        result_of("GetClass", class_name("tst_link") + flag("IncludeQualifiers", "FALSE")),
        "<CLASS NAME=\"TST_Link\"><PROPERTY.REFERENCE NAME=\"Antecedent\" REFERENCECLASS=\"TST_Element\">"
        "</PROPERTY.REFERENCE><PROPERTY.REFERENCE NAME=\"Dependent\" REFERENCECLASS=\"TST_Port\"></PROPERTY.REFERENCE></CLASS>");
    result_of("EnumerateClasses", class_name("TST_Element"));
    EXPECT_EQ(operations.last_class, "TST_Element");
    EXPECT_FALSE(operations.last_deep);
}

TEST_F(service, answers_failures_with_their_code)
{
    for (const char* operation : {"OpenEnumerateInstances", "PullInstancesWithPath", "CreateClass", "GetQualifier", ""})
        EXPECT_EQ(error_of(intrinsic(operation, parameter("Any", "<INSTANCE CLASSNAME=\"A\"/>"))), CIM_ERR_NOT_SUPPORTED)
            << operation;
    EXPECT_EQ(error_of(intrinsic("GetClass", class_name("Nope"))), CIM_ERR_NOT_FOUND);
    EXPECT_EQ(error_of(intrinsic("GetInstance", port_name(key_1) + flag("IncludeClassOrigin", "maybe"))),
              CIM_ERR_INVALID_PARAMETER);
    EXPECT_EQ(error_of(intrinsic("GetInstance", parameter("InstanceName", "<CLASSNAME NAME=\"A\"/>"))),
              CIM_ERR_INVALID_PARAMETER);
    EXPECT_EQ(error_of(intrinsic("EnumerateInstanceNames", class_name("A") + flag("DeepInheritance", "TRUE"))),
              CIM_ERR_INVALID_PARAMETER);

    const std::string target = "<INSTANCENAME CLASSNAME=\"TST_Port\">" + key_1 + "</INSTANCENAME>";
    EXPECT_EQ(error_of(call_reset("<LOCALINSTANCEPATH>" + name_space() + target + "</LOCALINSTANCEPATH>")),
              CIM_ERR_METHOD_NOT_FOUND);
    EXPECT_EQ(operations.last_path.keys.size(), 1U);
    EXPECT_NE(ask(call_reset("<LOCALCLASSPATH>" + name_space() + "<CLASSNAME NAME=\"A\"/></LOCALCLASSPATH>"))
                  .find("<METHODRESPONSE NAME=\"Reset\"><ERROR CODE=\"17\" DESCRIPTION=\"unknown method: "
                        "Reset\"></ERROR></METHODRESPONSE>"),
              std::string::npos);
}

TEST_F(service, refuses_what_is_no_operation)
{
    const auto refusal = [&](const std::string& header, const std::string& body)
    {
        const Http_Answer answer = under_test.answer({header, body});
        return std::to_string(answer.status) + " " + answer.cim_error + answer.body;
    };
    const std::string good = intrinsic("EnumerateClassNames");
    EXPECT_EQ(refusal("MethodRequest", good), "400 unsupported-operation");
    EXPECT_EQ(refusal("MethodCall", "<a>"), "400 request-not-well-formed");
    EXPECT_EQ(under_test.answer({"", good}).status, 200U);
    EXPECT_EQ(under_test.answer({"methodcall", good}).status, 200U);
}
