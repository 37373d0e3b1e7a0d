// What reaches a callback of a Provider_Handle. What servers see of it is shown where they ask.
#include "tests/cmpi/served_provider.h"

#include <gmock/gmock.h>

using namespace test;
using testing::ElementsAre;
using testing::IsEmpty;

namespace
{

std::string name_of(const Instance* instance)
{
    if (const auto* named = cast<TST_Thing>(instance))
        return named->Name.value.c_str();
    const auto* association = cast<TST_Pair>(instance);
    return association ? name_of(association->Antecedent) + "-" + name_of(association->Dependent) : "end";
}

// What a callback received: things by name, links as "antecedent-dependent", end marks as "end".
struct Received
{
    std::vector<std::string> names;
    std::size_t wanted = 100; // says stop after so many
};

template <class Status> bool receive(Instance* instance, Status, void* client_data)
{
    const Ref<Instance> object(instance);
    auto& received = *static_cast<Received*>(client_data);
    received.names.push_back(name_of(instance));
    return received.names.size() < received.wanted;
}

// A handle lives within its test: no provider may be left at its end.
class Provider_Handles : public Served_Provider
{
protected:
    void TearDown() override
    {
        source.reset();
        Served_Provider::TearDown();
    }

    void offer_links()
    {
        for (const auto& [a, b] : {std::pair("a", "b"), {"c", "b"}, {"a", "d"}})
            script.instances.emplace_back(linked(a, b).steal());
    }
    Enum_Associator_Names_Status associators(Provider_Handle& handle, Received& received)
    {
        return handle.enum_associator_names(source.ptr(), "", "", "", receive, &received);
    }
    Enum_References_Status references(Provider_Handle& handle, Received& received)
    {
        const Ref<TST_Pair> model(create<TST_Pair>(false));
        return handle.enum_references(source.ptr(), model.ptr(), "", receive, &received);
    }

    Ref<TST_Thing> source = thing("a");
};

TEST_F(Provider_Handles, mark_the_end_once)
{
    Provider_Handle links(&link_registration);
    offer_links();
    const struct
    {
        std::size_t wanted;
        std::vector<std::string> names, links;
    } cases[] = {{100, {"b", "d", "end"}, {"a-b", "a-d", "end"}}, {1, {"b", "end"}, {"a-b", "end"}}};
    for (const bool deaf : {false, true})
        for (const auto& c : cases)
        {
            script.deaf = deaf;
            Received names{.names = {}, .wanted = c.wanted}, references_found{.names = {}, .wanted = c.wanted};
            EXPECT_EQ(associators(links, names), ENUM_ASSOCIATOR_NAMES_OK);
            EXPECT_EQ(names.names, c.names);
            EXPECT_THAT(asked_for(), IsEmpty()) << "the keys are references";
            EXPECT_EQ(references(links, references_found), ENUM_REFERENCES_OK);
            EXPECT_EQ(references_found.names, c.links);
        }

    Received received;
    script.enum_instances = ENUM_INSTANCES_FAILED;
    EXPECT_EQ(links.enum_instances(source.ptr(), receive, &received), ENUM_INSTANCES_FAILED);
    EXPECT_THAT(received.names, ElementsAre("a-b", "c-b", "a-d", "end"));

    received = {};
    script.enumerations = 0;
    script.enum_associator_names = ENUM_ASSOCIATOR_NAMES_FAILED;
    script.enum_references = ENUM_REFERENCES_ACCESS_DENIED;
    EXPECT_EQ(associators(links, received), ENUM_ASSOCIATOR_NAMES_FAILED);
    EXPECT_EQ(references(links, received), ENUM_REFERENCES_ACCESS_DENIED);
    EXPECT_THAT(received.names, ElementsAre("end", "end")) << "the provider answered itself";
    EXPECT_EQ(script.enumerations, 0);
}

} // namespace
