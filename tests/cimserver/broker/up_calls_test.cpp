// What providers call back into the server, and the queries of filters.
#include "cimserver/broker/broker.h"
#include "cimserver/broker/request.h"
#include "cimserver/operations.h"
#include "test_schema.h"

#include <cmpimacs.h>
#include <gmock/gmock.h>

namespace cimserver
{
namespace
{

using testing::ElementsAre;

// Writes down what it is asked; answers two objects, or fails.
class Recorder : public Operations, public Indication_Sink
{
public:
    using Text = const std::string&;
    using List = const Property_List&;
    using Filter = const Association_Filter&;
    using Names = std::vector<Object_Path>;
    using Instances = std::vector<Instance>;

    const zmlr::Meta_Class* get_class(Text, Text) override { return nullptr; }
    std::vector<const zmlr::Meta_Class*> enumerate_classes(Text, Text, bool) override { return {}; }
    Names enumerate_instance_names(Text ns, Text name) override { return answer<Names>("names " + ns + ":" + name); }
    Instances enumerate_instances(Text ns, Text name, bool, List list) override
    {
        return answer<Instances>("instances " + ns + ":" + name + text_of(list));
    }
    Instance get_instance(const Object_Path&, List) override { return {}; }
    Instances exec_query(Text ns, Text query, Text language) override
    {
        return answer<Instances>(language + " " + ns + " " + query);
    }
    Instances associators(const Object_Path& path, Filter f, List list) override
    {
        return answer<Instances>("associators " + path.class_name + text_of(f) + text_of(list));
    }
    Names associator_names(const Object_Path& path, Filter f) override
    {
        return answer<Names>("associator names " + path.class_name + text_of(f));
    }
    Instances references(const Object_Path& path, Filter f, List list) override
    {
        return answer<Instances>("references " + path.class_name + text_of(f) + text_of(list));
    }
    Names reference_names(const Object_Path& path, Filter f) override
    {
        return answer<Names>("reference names " + path.class_name + text_of(f));
    }
    void deliver(Text ns, const Instance& indication) override
    {
        answer<Instances>("deliver " + ns + " " + indication.path.class_name);
    }

    std::vector<std::string> calls;
    bool fails = false;

private:
    static std::string text_of(Filter f)
    {
        return " " + f.association_class + "/" + f.result_class + "/" + f.role + "/" + f.result_role;
    }
    static std::string text_of(List list)
    {
        std::string text;
        for (Text name : list.value_or(std::vector<std::string>()))
            text += " " + name;
        return text;
    }
    template <class Answer> Answer answer(Text call)
    {
        calls.push_back(call);
        if (fails)
            throw Cim_Error(CIM_ERR_ACCESS_DENIED, "no");
        return Answer(2);
    }
};

class Up_Calls : public testing::Test
{
protected:
    Repository repository{test_registrations()};
    Broker owner{repository};
    const CMPIBroker* broker = owner.face();
    Request request;
    const CMPIContext* context = request.context();
    const CMPIObjectPath* path = CMNewObjectPath(broker, "root/zemlar", "TST_Disk", nullptr);
    Recorder server;
};

TEST_F(Up_Calls, reach_the_servers_operations_with_their_arguments)
{
    static const char* list[] = {"Id", nullptr};
    using Enumeration = std::function<CMPIEnumeration*(CMPIStatus*)>;
    const std::pair<const char*, Enumeration> calls[] = {
        {"names root/zemlar:TST_Disk", [&](CMPIStatus* rc) { return CBEnumInstanceNames(broker, context, path, rc); }},
        {"instances root/zemlar:TST_Disk Id", [&](CMPIStatus* rc) { return CBEnumInstances(broker, context, path, list, rc); }},
        {"WQL root/zemlar select 1", [&](CMPIStatus* rc) { return CBExecQuery(broker, context, path, "select 1", "WQL", rc); }},
        {"associators TST_Disk a/b/c/d Id",
         [&](CMPIStatus* rc) { return CBAssociators(broker, context, path, "a", "b", "c", "d", list, rc); }},
        {"associator names TST_Disk ///d",
         [&](CMPIStatus* rc) { return CBAssociatorNames(broker, context, path, nullptr, "", nullptr, "d", rc); }},
        {"references TST_Disk a//c/ Id", [&](CMPIStatus* rc) { return CBReferences(broker, context, path, "a", "c", list, rc); }},
        {"reference names TST_Disk a//c/", [&](CMPIStatus* rc) { return CBReferenceNames(broker, context, path, "a", "c", rc); }},
    };
    for (const auto& [text, call] : calls)
    {
        CMPIStatus status{};
        EXPECT_EQ(call(&status), nullptr) << text;
        EXPECT_EQ(status.rc, CMPI_RC_ERR_NOT_SUPPORTED) << "nobody answers yet";
        owner.set_operations(&server);
        server.calls.clear();
        CMPIEnumeration* found = call(&status);
        ASSERT_EQ(status.rc, CMPI_RC_OK) << text;
        EXPECT_THAT(server.calls, ElementsAre(text));
        EXPECT_EQ(CMGetArrayCount(CMToArray(found, nullptr), nullptr), 2U);
        server.fails = true;
        EXPECT_EQ(call(&status), nullptr);
        EXPECT_EQ(status.rc, CMPI_RC_ERR_ACCESS_DENIED) << text;
        server.fails = false;
        owner.set_operations(nullptr);
    }
}

TEST_F(Up_Calls, hand_indications_to_whom_the_server_names)
{
    const CMPIInstance* alert = CMNewInstance(broker, path, nullptr);
    EXPECT_EQ(CBDeliverIndication(broker, context, "root/zemlar", alert).rc, CMPI_RC_ERR_NOT_SUPPORTED);
    owner.set_indication_sink(&server);
    EXPECT_EQ(CBDeliverIndication(broker, context, "root/zemlar", alert).rc, CMPI_RC_OK);
    EXPECT_THAT(server.calls, ElementsAre("deliver root/zemlar TST_Disk"));
    EXPECT_EQ(CBDeliverIndication(broker, nullptr, "root/zemlar", alert).rc, CMPI_RC_ERR_INVALID_HANDLE);
    EXPECT_EQ(CBDeliverIndication(broker, context, nullptr, alert).rc, CMPI_RC_ERR_INVALID_PARAMETER);
    EXPECT_EQ(CBDeliverIndication(broker, context, "root/zemlar", nullptr).rc, CMPI_RC_ERR_INVALID_HANDLE);
}

TEST_F(Up_Calls, take_queries_that_select_something)
{
    const std::pair<const char*, std::vector<std::string>> good[] = {
        {"SELECT * FROM TST_Disk", {}},
        {" select\tId , Name\nfrom TST_Disk where Id = 'from'", {"Id", "Name"}},
        {"SELECT d.Id FROM TST_Disk d", {"d.Id"}},
    };
    for (const auto& [query, names] : good)
    {
        CMPIStatus status{};
        CMPIArray* projection = nullptr;
        const CMPISelectExp* select = CMNewSelectExp(broker, query, "WQL", &projection, &status);
        ASSERT_EQ(status.rc, CMPI_RC_OK) << query;
        EXPECT_STREQ(CMGetCharsPtr(CMGetSelExpString(select, nullptr), nullptr), query);
        std::vector<std::string> found;
        for (CMPICount i = 0; projection && i < CMGetArrayCount(projection, nullptr); ++i)
            found.emplace_back(CMGetCharsPtr(CMGetArrayElementAt(projection, i, nullptr).value.string, nullptr));
        EXPECT_EQ(found, names) << query;
    }
    const std::string endless = "SELECT " + std::string(1'000'000, 'x') + " FROM y";
    for (const char* query : {"", "SELECT", "SELECT * FROM", "SELECT Id, FROM TST_Disk", "DELETE * FROM x", endless.c_str()})
    {
        CMPIStatus status{};
        EXPECT_EQ(CMNewSelectExp(broker, query, "WQL", nullptr, &status), nullptr);
        EXPECT_EQ(status.rc, CMPI_RC_ERR_INVALID_QUERY) << std::string(query).substr(0, 40);
    }
}

} // namespace
} // namespace cimserver
