// Provider_Handle and the procedures behind it. What servers see of the answers found by enumeration, filters and statuses, is
// shown where they ask; here, what reaches a callback.
#include "tests/cmpi/served_provider.h"

#include <gmock/gmock.h>

#include <stdexcept>

using namespace test;
using testing::ElementsAre;
using testing::IsEmpty;

namespace
{

std::string name_of(const Instance* instance)
{
    if (const auto* named = cast<Test_Thing>(instance))
        return named->Name.value.c_str();
    const auto* association = cast<Test_Link>(instance);
    return association ? name_of(association->Antecedent) + "-" + name_of(association->Dependent) : "end";
}

// What a callback received: things by name, links as "antecedent-dependent", end marks as "end".
struct Received
{
    std::vector<std::string> names;
    std::size_t wanted = 100; // says stop after so many
    bool throws = false;
};

template <class Status> bool receive(Instance* instance, Status, void* client_data)
{
    const Ref<Instance> object(instance);
    auto& received = *static_cast<Received*>(client_data);
    received.names.push_back(name_of(instance));
    if (received.throws && instance)
        throw std::runtime_error("callback");
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

    template <class... Names> void offer(Names... names) { (script.instances.emplace_back(thing(names).steal()), ...); }
    void offer_links()
    {
        for (const auto& [a, b] : {std::pair("a", "b"), {"c", "b"}, {"a", "d"}})
            script.instances.emplace_back(make_link(a, b).steal());
    }
    Enum_Associator_Names_Status associators(Provider_Handle& handle, Received& received)
    {
        return handle.enum_associator_names(source.ptr(), "", "", "", receive, &received);
    }
    Enum_References_Status references(Provider_Handle& handle, Received& received)
    {
        const Ref<Test_Link> model(create<Test_Link>(false));
        return handle.enum_references(source.ptr(), model.ptr(), "", receive, &received);
    }

    Ref<Test_Thing> source = thing("a");
};

TEST_F(Provider_Handles, find_the_first_enumerated_instance_with_equal_keys)
{
    Provider_Handle things(&thing_registration);
    offer("x", "a", "y", "a");
    static_cast<Test_Thing*>(script.instances[1].ptr())->Uint8.set(1);
    for (const bool deaf : {false, true})
    {
        script.deaf = deaf;
        script.delivered = 0;
        Ref<Instance> found;
        ASSERT_EQ(things.get_instance(source.ptr(), found), GET_INSTANCE_OK);
        EXPECT_EQ(cast<Test_Thing>(found.ptr())->Uint8.value, 1);
        EXPECT_EQ(script.delivered, deaf ? 4 : 2);
    }
    Ref<Instance> found;
    script.enum_instances = ENUM_INSTANCES_FAILED;
    EXPECT_EQ(things.get_instance(source.ptr(), found), GET_INSTANCE_NOT_FOUND);
    EXPECT_FALSE(found);
}

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

TEST_F(Provider_Handles, of_ordinary_classes_fail_without_a_word_to_the_provider)
{
    Provider_Handle things(&thing_registration);
    Received received;
    EXPECT_EQ(associators(things, received), ENUM_ASSOCIATOR_NAMES_FAILED);
    EXPECT_EQ(references(things, received), ENUM_REFERENCES_FAILED);
    EXPECT_THAT(received.names, IsEmpty());
    EXPECT_EQ(script.enumerations, 0);
}

TEST_F(Provider_Handles, lose_nothing_when_a_callback_throws)
{
    Provider_Handle links(&link_registration);
    offer_links();
    Received received{.names = {}, .throws = true};
    EXPECT_THROW(associators(links, received), std::runtime_error);
    EXPECT_THROW(references(links, received), std::runtime_error);
    EXPECT_THROW(links.enum_instances(source.ptr(), receive, &received), std::runtime_error);
}

TEST_F(Provider_Handles, answer_minus_one_for_what_the_class_does_not_have)
{
    const std::pair<const Registration&, std::vector<int>> missing[] = {
        {thing_registration, {11, 12, 14, 15, 16}}, {link_registration, {11, 12, 17, -1}}, {alert_registration, {5, 6, 9, 14}}};
    for (const auto& [registration, operations] : missing)
        for (const int operation : operations)
            EXPECT_EQ(registration.provider_proc(&registration, operation, nullptr, nullptr, nullptr, nullptr, nullptr, nullptr,
                                                 nullptr, nullptr),
                      -1)
                << operation;
}

} // namespace
