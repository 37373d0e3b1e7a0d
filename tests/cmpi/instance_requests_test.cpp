// The instance interface as a server calls it.
#include "cimserver/broker/objects.h"
#include "runtime/thread_context.h"
#include "tests/cmpi/served_provider.h"

#include <cmpimacs.h>
#include <gmock/gmock.h>

#include <stdexcept>
#include <thread>

using namespace test;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

namespace
{

class Instance_Requests : public Served_Provider
{
protected:
    template <class... Names> void offer(Names... names) { (script.instances.emplace_back(full_thing(names).steal()), ...); }

    CMPIrc enumerate_names(const CMPIObjectPath* object)
    {
        result.clear();
        return CMPI_Adapter::enumInstanceNames(mi, request.context(), result.face(), object).rc;
    }
    CMPIrc enumerate(const CMPIObjectPath* object, const char** properties = nullptr)
    {
        result.clear();
        return CMPI_Adapter::enumInstances(mi, request.context(), result.face(), object, properties).rc;
    }
    CMPIrc get(const CMPIObjectPath* object, const char** properties = nullptr)
    {
        result.clear();
        return CMPI_Adapter::getInstance(mi, request.context(), result.face(), object, properties).rc;
    }

    CMPIInstanceMI* mi = things();
    const CMPIObjectPath* things_path = path("TST_Thing");
    Recorded_Result result;
};

TEST_F(Instance_Requests, enumerate_names_in_the_requests_name_space)
{
    offer("a");
    script.instances[0]->__name_space = "root/other";
    EXPECT_EQ(enumerate_names(path("tst_thing")), CMPI_RC_OK);
    EXPECT_EQ(result.paths.at(0).name_space, name_space);
    EXPECT_EQ(script.model->__name_space, name_space);
    EXPECT_EQ(enumerate_names(thing_path("a")), CMPI_RC_OK);
    EXPECT_THAT(asked_for(), ElementsAre("Name"));
}

TEST_F(Instance_Requests, enumerate_whole_instances_or_what_a_list_names)
{
    offer("a", "b");
    EXPECT_EQ(enumerate(things_path), CMPI_RC_OK);
    EXPECT_THAT(asked_for(), IsEmpty());
    ASSERT_THAT(result.instances, SizeIs(2));
    EXPECT_EQ(name_in(result.instances[1].path), "b");
    EXPECT_EQ(text(result.instances[1].properties, "DatetimeValue"), "00000000013000.000007:000");

    const char* list[] = {"uint8value", "Unknown", nullptr};
    EXPECT_EQ(enumerate(things_path, list), CMPI_RC_OK);
    EXPECT_THAT(asked_for(), ElementsAre("Name", "Uint8Value")) << "the key too";
    EXPECT_THAT(names_of(result.instances.at(1).properties), ElementsAre("Name", "Uint8Value"));

    const char* empty[] = {nullptr};
    EXPECT_EQ(enumerate(things_path, empty), CMPI_RC_OK);
    EXPECT_THAT(names_of(result.instances.at(1).properties), ElementsAre("Name"));
}

TEST_F(Instance_Requests, answer_each_enumeration_status)
{
    const struct
    {
        Enum_Instances_Status status;
        CMPIrc rc;
        int names_done, instances_done;
    } rows[] = {
        {ENUM_INSTANCES_OK, CMPI_RC_OK, 1, 1},
        {ENUM_INSTANCES_FAILED, CMPI_RC_ERR_FAILED, 0, 0},
        {ENUM_INSTANCES_ACCESS_DENIED, CMPI_RC_ERR_ACCESS_DENIED, 0, 0},
        {static_cast<Enum_Instances_Status>(-1), CMPI_RC_OK, 0, 1},
    };
    for (const auto& row : rows)
    {
        script.enum_instances = row.status;
        EXPECT_EQ(enumerate_names(things_path), row.rc);
        EXPECT_EQ(result.done, row.names_done) << row.status;
        EXPECT_EQ(enumerate(things_path), row.rc);
        EXPECT_EQ(result.done, row.instances_done) << row.status;
    }
}

TEST_F(Instance_Requests, get_what_the_provider_finds_or_enumerates)
{
    offer("a", "b", "c", "b");
    static_cast<TST_Thing*>(script.instances[3].ptr())->Uint8Value.set(1);
    for (const bool deaf : {true, false})
    {
        script.deaf = deaf; // goes on when the search is over
        script.delivered = 0;
        EXPECT_EQ(get(thing_path("b")), CMPI_RC_OK);
        EXPECT_EQ(script.delivered, deaf ? 4 : 2);
        EXPECT_EQ(content<std::uint64_t>(result.instances.at(0).properties, "Uint8Value"), 0xFFU) << "the first one";
    }
    EXPECT_THAT(asked_for(), SizeIs(21));
    ASSERT_THAT(result.instances, SizeIs(1));
    EXPECT_EQ(text(result.instances[0].properties, "Name"), "b");

    const char* list[] = {"StringValues", nullptr};
    EXPECT_EQ(get(thing_path("b"), list), CMPI_RC_OK);
    EXPECT_THAT(asked_for(), ElementsAre("Name", "StringValues"));
    EXPECT_THAT(names_of(result.instances.at(0).properties), ElementsAre("Name", "StringValues"));

    EXPECT_EQ(get(thing_path("d")), CMPI_RC_ERR_NOT_FOUND);
    EXPECT_THAT(result.instances, IsEmpty());
    script.enum_instances = ENUM_INSTANCES_FAILED;
    EXPECT_EQ(get(thing_path("b")), CMPI_RC_ERR_NOT_FOUND);
}

// Every status that a provider may answer is sent through a client elsewhere; here, what is none of its operation's.
TEST_F(Instance_Requests, a_retrieval_without_an_instance_is_no_success)
{
    for (const int status : {0, -1})
    {
        script.get_instance = static_cast<Get_Instance_Status>(status);
        EXPECT_EQ(get(thing_path("a")), CMPI_RC_ERR_FAILED);
        EXPECT_EQ(result.done, 0);
    }
    EXPECT_EQ(script.enumerations, 0);
}

TEST_F(Instance_Requests, change_what_a_list_names)
{
    auto& object = cimserver::make<cimserver::Instance_Object>(classes.find("TST_Thing")->layout, cimserver::Object_Path{});
    object.set("Name", string("new"));
    object.set("Uint8Value", {CMPI_uint8, std::uint64_t{7}});
    const char* list[] = {"Uint8Value", nullptr};
    for (const int status : {int{MODIFY_INSTANCE_OK}, -1})
    {
        script.create_instance = static_cast<Create_Instance_Status>(status);
        script.modify_instance = static_cast<Modify_Instance_Status>(status);
        const CMPIObjectPath* to = thing_path("new");
        EXPECT_EQ(CMPI_Adapter::createInstance(mi, request.context(), result.face(), to, object.face()).rc, CMPI_RC_OK);
        EXPECT_EQ(CMPI_Adapter::modifyInstance(mi, request.context(), result.face(), to, object.face(), list).rc, CMPI_RC_OK);
        EXPECT_THAT(asked_for(), ElementsAre("Name", "Uint8Value"));
        EXPECT_EQ(result.done, 2) << "statuses of no kind answer nothing";
    }
    EXPECT_EQ(CMPI_Adapter::createInstance(mi, request.context(), result.face(), things_path, nullptr).rc, CMPI_RC_ERR_FAILED);
}

TEST_F(Instance_Requests, fail_for_a_class_that_the_provider_does_not_serve)
{
    for (const CMPIObjectPath* object : {path("TST_Unknown"), path("TST_Pair"), path(""), static_cast<CMPIObjectPath*>(nullptr)})
    {
        EXPECT_EQ(enumerate_names(object), CMPI_RC_ERR_FAILED);
        EXPECT_EQ(enumerate(object), CMPI_RC_ERR_FAILED);
        EXPECT_EQ(get(object), CMPI_RC_ERR_FAILED);
    }
    EXPECT_EQ(script.enumerations, 0);
}

// Real servers pass on what a client gives, keys that the class does not have, too few, and those of other classes.
TEST_F(Instance_Requests, live_with_whatever_keys_there_are)
{
    const struct
    {
        std::vector<cimserver::Named_Value> keys;
        CMPIrc found;
    } rows[] = {
        {{{"Name", string("a")}, {"Colour", string("red")}}, CMPI_RC_OK},
        {{{"Name", string("a")}, {"Caption", string("no key")}}, CMPI_RC_OK},
        {{{"NAME", string("a")}, {"Name", string("a")}}, CMPI_RC_OK},
        {{}, CMPI_RC_ERR_NOT_FOUND},
        {{{"Colour", string("red")}}, CMPI_RC_ERR_NOT_FOUND},
        {{{"Name", {CMPI_uint64, std::uint64_t{7}}}}, CMPI_RC_ERR_NOT_FOUND},
        {{{"Name", {CMPI_string, {}}}}, CMPI_RC_ERR_NOT_FOUND},
        {{{"Name", reference("TST_Nobody", "a")}}, CMPI_RC_ERR_NOT_FOUND},
        {{{"Antecedent", reference("TST_Thing", "a")}, {"Dependent", reference("TST_Thing", "b")}}, CMPI_RC_ERR_NOT_FOUND},
    };
    offer("a", "b");
    const CMPIContext* context = request.context();
    for (const auto& row : rows)
    {
        const cimserver::Object_Path keys = {{}, name_space, "TST_Thing", row.keys};
        const CMPIObjectPath* object = cimserver::make<cimserver::Path_Object>(keys).face();
        const CMPIInstance* changed = CMNewInstance(broker.face(), things_path, nullptr);
        EXPECT_EQ(get(object), row.found) << &row - rows;
        EXPECT_EQ(enumerate_names(object), CMPI_RC_OK) << &row - rows;
        EXPECT_EQ(CMPI_Adapter::modifyInstance(mi, context, result.face(), object, changed, nullptr).rc,
                  CMPI_RC_ERR_NOT_SUPPORTED);
        EXPECT_EQ(CMPI_Adapter::deleteInstance(mi, context, result.face(), object).rc, CMPI_RC_ERR_NOT_SUPPORTED);
    }
}

TEST_F(Instance_Requests, take_a_superclass_for_the_served_class)
{
    mi = interface<CMPIInstanceMI>('I', disk_data, disk_registration);
    EXPECT_EQ(enumerate(thing_path("a", "TST_Thing")), CMPI_RC_OK);
    EXPECT_EQ(script.model->meta_class, &TST_Disk::static_meta_class);
}

TEST_F(Instance_Requests, are_over_after_an_exception)
{
    script.on_enum = [] { throw std::runtime_error("driver"); };
    EXPECT_THAT(logged([&] { EXPECT_EQ(enumerate(things_path), CMPI_RC_ERR_FAILED); }, "ERR"),
                ElementsAre("CMPI_Adapter: enumInstances(): unexpected exception: driver"));
    EXPECT_EQ(result.done, 0);
    EXPECT_EQ(Thread_Context::top(), nullptr);

    script.on_enum = nullptr;
    std::thread other(
        [&]
        {
            cimserver::Request own;
            EXPECT_EQ(CMPI_Adapter::enumInstanceNames(mi, own.context(), result.face(), things_path).rc, CMPI_RC_OK);
        });
    other.join();
}

TEST_F(Instance_Requests, that_cannot_be_answered_in_full_are_no_success)
{
    static int paths_left = 0;
    CMPIBrokerEncFT poor_table = *broker.face()->eft;
    poor_table.newObjectPath = [](const CMPIBroker* b, const char* ns, const char* class_name, CMPIStatus* rc)
    { return paths_left-- > 0 ? cimserver::encapsulation_table.newObjectPath(b, ns, class_name, rc) : nullptr; };
    CMPIBroker poor = *broker.face();
    poor.eft = &poor_table;
    thing_data.adapter->broker = &poor;

    offer("a", "b", "c");
    for (const bool deaf : {false, true})
    {
        script.deaf = deaf;
        paths_left = 1;
        EXPECT_EQ(enumerate_names(things_path), CMPI_RC_ERR_FAILED);
        EXPECT_THAT(result.paths, SizeIs(1));
        EXPECT_EQ(result.done, 0);
        paths_left = 0;
        EXPECT_EQ(enumerate(things_path), CMPI_RC_ERR_FAILED);
        EXPECT_EQ(result.done, 0);
    }
}

TEST_F(Instance_Requests, may_come_back_from_within_a_request)
{
    offer("a");
    script.on_enum = [&]
    {
        script.on_enum = nullptr;
        EXPECT_EQ(enumerate_names(things_path), CMPI_RC_OK);
        EXPECT_THAT(result.paths, SizeIs(1));
    };
    EXPECT_EQ(enumerate(things_path), CMPI_RC_OK);
    EXPECT_THAT(result.instances, SizeIs(1));
}

TEST_F(Instance_Requests, do_not_serve_queries)
{
    EXPECT_EQ(CMPI_Adapter::execQuery(mi, request.context(), nullptr, things_path, "", "WQL").rc, CMPI_RC_ERR_NOT_SUPPORTED);
}

} // namespace
