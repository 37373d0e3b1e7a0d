// The association interface as a server calls it. What each filter finds, the end-to-end tests tell.
#include "cimserver/broker/objects.h"
#include "tests/cmpi/served_provider.h"

#include <cmpimacs.h>
#include <gmock/gmock.h>

using namespace test;
using testing::Each;
using testing::ElementsAre;
using testing::SizeIs;

namespace
{

int far_ends_fetched = 0; // instances that a provider asked the server for
std::string listed;       // in the property list of the last one

// The server finds a thing of every name but "gone".
CMPIInstance* find_thing(const CMPIBroker* broker, const CMPIContext*, const CMPIObjectPath* path, const char** properties,
                         CMPIStatus* status)
{
    ++far_ends_fetched;
    listed = properties && *properties ? *properties : "";
    const auto& name = cimserver::object<cimserver::Path_Object>(path).path.keys.at(0).value;
    const bool gone = name.get<cimserver::Text>() == "gone";
    *status = {gone ? CMPI_RC_ERR_NOT_FOUND : CMPI_RC_OK, nullptr};
    return gone ? nullptr : CMNewInstance(broker, path, nullptr);
}

class Association_Requests : public Served_Provider
{
protected:
    Association_Requests()
    {
        server_calls.getInstance = find_thing;
        server.bft = &server_calls;
        server.eft = &objects;
        link_data.adapter->broker = &server;
    }

    void offer_links()
    {
        for (const auto& [antecedent, dependent] : {std::pair("a", "b"), {"c", "b"}, {"a", "d"}})
            script.instances.emplace_back(linked(antecedent, dependent).steal());
    }

    CMPIrc associators(const CMPIObjectPath* source, const char** properties = nullptr)
    {
        result.clear();
        const CMPIResult* to = result.face();
        return CMPI_Adapter::associators(mi, request.context(), to, source, association_class, "", "", nullptr, properties).rc;
    }
    CMPIrc associator_names(const CMPIObjectPath* source)
    {
        result.clear();
        const CMPIResult* to = result.face();
        return CMPI_Adapter::associatorNames(mi, request.context(), to, source, association_class, "", "", nullptr).rc;
    }
    CMPIrc references(const CMPIObjectPath* source, const char** properties = nullptr)
    {
        result.clear();
        return CMPI_Adapter::references(mi, request.context(), result.face(), source, association_class, "", properties).rc;
    }
    CMPIrc reference_names(const CMPIObjectPath* source)
    {
        result.clear();
        return CMPI_Adapter::referenceNames(mi, request.context(), result.face(), source, association_class, nullptr).rc;
    }
    // The answers of all four, in that order.
    std::vector<CMPIrc> answers(const CMPIObjectPath* source)
    {
        return {associators(source), associator_names(source), references(source), reference_names(source)};
    }

    // What the last request answered: names of things, links as "antecedent-dependent".
    std::vector<std::string> found() const
    {
        std::vector<std::string> names;
        for (const auto& path : result.paths)
            names.push_back(name_of(path));
        for (const auto& instance : result.instances)
            names.push_back(name_of(instance.path));
        return names;
    }
    static std::string name_of(const cimserver::Object_Path& path)
    {
        if (path.class_name != "TST_Pair")
            return name_in(path);
        return name_in(path_in(path.keys, "Antecedent")) + "-" + name_in(path_in(path.keys, "Dependent"));
    }

    CMPIBroker server = *broker.face();
    CMPIBrokerFT server_calls = *broker.face()->bft;
    CMPIBrokerEncFT objects = *broker.face()->eft;
    CMPIAssociationMI* mi = associations();
    const CMPIObjectPath* a = thing_path("a");
    const char* association_class = "tst_pair"; // as a client names it
    Recorded_Result result;
};

TEST_F(Association_Requests, reach_the_provider_by_no_class_and_by_superclasses)
{
    offer_links();
    const struct
    {
        const char* association_class;
        CMPIrc rc;
        int enumerations; // of four requests
    } cases[] = {
        {nullptr, CMPI_RC_OK, 4},
        {"", CMPI_RC_OK, 4},
        {"TST_PAIR", CMPI_RC_OK, 4},
        {"TST_Relation", CMPI_RC_OK, 4},                   // the superclass
        {"TST_StrongPair", CMPI_RC_OK, 0},                 // a subclass: its provider's business
        {"TST_Thing", CMPI_RC_OK, 0},                      // unrelated
        {"TST_Unknown", CMPI_RC_ERR_INVALID_PARAMETER, 0}, // nobody's
    };
    for (const auto& c : cases)
    {
        script.enumerations = 0;
        association_class = c.association_class;
        EXPECT_THAT(answers(a), Each(c.rc));
        EXPECT_EQ(script.enumerations, c.enumerations) << (c.association_class ? c.association_class : "(none)");
        EXPECT_THAT(result.paths, SizeIs(c.enumerations ? 2 : 0));
    }
}

TEST_F(Association_Requests, of_a_source_that_nobody_knows_find_nothing_or_fail)
{
    for (const CMPIObjectPath* source : {path("TST_Unknown"), static_cast<CMPIObjectPath*>(nullptr)})
        EXPECT_THAT(answers(source),
                    ElementsAre(CMPI_RC_OK, CMPI_RC_ERR_INVALID_CLASS, CMPI_RC_ERR_INVALID_CLASS, CMPI_RC_ERR_INVALID_CLASS));
    EXPECT_EQ(script.enumerations, 0);
}

TEST_F(Association_Requests, have_the_status_of_the_enumeration_or_of_a_provider_that_answers_itself)
{
    // clang-format off
    const std::pair<Enum_Instances_Status, CMPIrc> rows[] = {
        {ENUM_INSTANCES_FAILED, CMPI_RC_ERR_FAILED}, {ENUM_INSTANCES_ACCESS_DENIED, CMPI_RC_ERR_ACCESS_DENIED},
        {static_cast<Enum_Instances_Status>(-1), CMPI_RC_OK}};
    const std::pair<Enum_Associator_Names_Status, CMPIrc> name_rows[] = {
        {ENUM_ASSOCIATOR_NAMES_OK, CMPI_RC_OK}, {ENUM_ASSOCIATOR_NAMES_FAILED, CMPI_RC_ERR_FAILED},
        {ENUM_ASSOCIATOR_NAMES_ACCESS_DENIED, CMPI_RC_ERR_ACCESS_DENIED}};
    const std::pair<Enum_Associators_Status, CMPIrc> associator_rows[] = {
        {ENUM_ASSOCIATORS_OK, CMPI_RC_OK}, {ENUM_ASSOCIATORS_FAILED, CMPI_RC_ERR_FAILED},
        {ENUM_ASSOCIATORS_ACCESS_DENIED, CMPI_RC_ERR_ACCESS_DENIED}, {static_cast<Enum_Associators_Status>(-1), CMPI_RC_OK}};
    const std::pair<Enum_References_Status, CMPIrc> reference_rows[] = {
        {ENUM_REFERENCES_OK, CMPI_RC_OK}, {ENUM_REFERENCES_FAILED, CMPI_RC_ERR_FAILED},
        {ENUM_REFERENCES_ACCESS_DENIED, CMPI_RC_ERR_ACCESS_DENIED}};
    // clang-format on
    offer_links();
    for (const auto& [status, rc] : rows)
        EXPECT_THAT((script.enum_instances = status, answers(a)), Each(rc)) << status;
    script.enumerations = 0;
    for (const auto& [status, rc] : name_rows)
    {
        script.enum_associator_names = status;
        EXPECT_EQ(associator_names(a), rc) << status;
        EXPECT_EQ(associators(a), rc) << "by way of the names";
    }
    for (const auto& [status, rc] : associator_rows)
        EXPECT_EQ((script.enum_associators = status, associators(a)), rc) << status;
    for (const auto& [status, rc] : reference_rows)
    {
        script.enum_references = status;
        EXPECT_EQ(references(a), rc) << status;
        EXPECT_EQ(reference_names(a), rc) << status;
    }
    EXPECT_EQ(script.enumerations, 0);
}

TEST_F(Association_Requests, answer_what_the_provider_hands_over_in_its_own_name_space)
{
    script.enum_associators = ENUM_ASSOCIATORS_OK;
    script.enum_associator_names = ENUM_ASSOCIATOR_NAMES_OK;
    for (const char* name : {"x", "y"})
        script.associators.emplace_back(full_thing(name).steal());
    script.associators[1]->__name_space = "root/other";

    const char* list[] = {"Uint8Value", nullptr};
    const char* no_path = "Converter: No ObjectPath built before call to make_CMPI_instance";
    EXPECT_THAT(logged([&] { EXPECT_EQ(associators(a, list), CMPI_RC_OK); }), ElementsAre(no_path, no_path));
    EXPECT_THAT(found(), ElementsAre("x", "y"));
    EXPECT_EQ(result.instances[0].path.name_space, name_space);
    EXPECT_EQ(result.instances[1].path.name_space, "root/other");
    EXPECT_THAT(result.instances[1].properties, SizeIs(2)) << "the key and what the list names";

    EXPECT_EQ(associator_names(a), CMPI_RC_OK);
    EXPECT_THAT(found(), ElementsAre("x", "y"));
    EXPECT_EQ(result.paths[1].name_space, "root/other");
}

TEST_F(Association_Requests, fetch_associated_instances_from_the_server)
{
    offer_links();
    const char* list[] = {"Uint8Value", nullptr};
    EXPECT_EQ(associators(a, list), CMPI_RC_OK);
    EXPECT_THAT(found(), ElementsAre("b", "d"));
    EXPECT_EQ(listed, "Uint8Value");

    offer_links(); // the same once more; then an instance that two links share, and one of its name in another name space
    for (const char* of : {"root/other", ""})
    {
        const Ref<TST_Thing> shared = thing("e");
        shared->__name_space = of;
        for (int i = 0; i < 2; i++)
        {
            Ref<TST_Pair> link = linked("a", "e");
            set_reference(link->Dependent, shared.ptr());
            script.instances.emplace_back(link.steal());
        }
    }
    far_ends_fetched = 0;
    EXPECT_EQ(associators(a), CMPI_RC_OK);
    EXPECT_THAT(found(), ElementsAre("b", "d", "e", "e"));
    EXPECT_EQ(far_ends_fetched, 4) << "each far end once";

    script.instances.emplace(script.instances.begin() + 1, linked("a", "gone").steal());
    EXPECT_EQ(associators(a), CMPI_RC_ERR_FAILED) << "the server gives nothing";
    EXPECT_THAT(found(), ElementsAre("b"));
}

TEST_F(Association_Requests, leave_keys_to_the_path_when_a_list_is_given)
{
    offer_links();
    auto& pair = *static_cast<TST_Pair*>(script.instances[0].ptr());
    pair.Note.set("note");
    pair.Dependent->__name_space = "root/other";
    const char* list[] = {"Note", "Antecedent", nullptr};
    for (const char** properties : {static_cast<const char**>(nullptr), list})
    {
        EXPECT_EQ(references(a, properties), CMPI_RC_OK);
        EXPECT_THAT(found(), ElementsAre("a-b", "a-d"));
        EXPECT_EQ(text(result.instances.at(0).properties, "Note"), "note");
        EXPECT_EQ(path_in(result.instances[0].path.keys, "Dependent").name_space, "root/other") << "a reference keeps its own";
        EXPECT_EQ(text(result.instances.at(1).properties, "Note"), "(null)");
    }
    const char* nothing[] = {nullptr};
    EXPECT_EQ(references(a, nothing), CMPI_RC_OK);
    EXPECT_THAT(found(), ElementsAre("a-b", "a-d"));
    EXPECT_THAT(result.instances.at(0).properties, SizeIs(2)) << "the two ends";
}

// What reaches the callback of a handle: the far ends until it has had enough, then the end, whatever the provider goes on with.
TEST_F(Association_Requests, end_with_one_mark)
{
    using Names = std::vector<std::string>;
    const auto receive = [](Instance* instance, auto, void* data)
    {
        const Ref<Instance> far_end(instance);
        auto& received = *static_cast<Names*>(data);
        received.emplace_back(instance ? static_cast<TST_Thing*>(instance)->Name.value.c_str() : "end");
        return received.size() % 2 != 0; // enough after two
    };
    offer_links();
    script.instances.emplace_back(linked("a", "e").steal());
    Names received;
    {
        Provider_Handle handle(&link_registration);
        const Ref<TST_Thing> source = thing("a");
        for (const bool deaf : {false, true})
        {
            script.deaf = deaf;
            handle.enum_associator_names(source.ptr(), "", "", "", receive, &received);
            received.emplace_back(); // an even number
        }
        script.enum_associator_names = ENUM_ASSOCIATOR_NAMES_FAILED; // the provider answers itself
        handle.enum_associator_names(source.ptr(), "", "", "", receive, &received);
    }
    EXPECT_THAT(received, ElementsAre("b", "d", "end", "", "b", "d", "end", "", "end"));
}

TEST_F(Association_Requests, stop_at_what_cannot_be_converted)
{
    static int paths_left = 0;
    objects.newObjectPath = [](const CMPIBroker* b, const char* ns, const char* class_name, CMPIStatus* rc)
    { return paths_left-- > 0 ? cimserver::encapsulation_table.newObjectPath(b, ns, class_name, rc) : nullptr; };
    offer_links();
    for (const bool deaf : {false, true})
    {
        script.deaf = deaf;
        EXPECT_THAT(answers(a), Each(CMPI_RC_ERR_FAILED));
        script.associators.emplace_back(thing("x").steal());
        script.enum_associators = ENUM_ASSOCIATORS_OK;
        EXPECT_EQ(associators(a), CMPI_RC_ERR_FAILED);
        paths_left = 1;
        EXPECT_EQ(associator_names(a), CMPI_RC_ERR_FAILED);
        EXPECT_THAT(result.paths, SizeIs(1));
    }
}

} // namespace
