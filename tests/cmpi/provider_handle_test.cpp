// Provider_Handle and the procedures behind it: answers passed on, and those found by enumeration.
#include "tests/cmpi/test_providers.h"

#include <gmock/gmock.h>

#include <stdexcept>
#include <string>

using namespace test;
using testing::ElementsAre;
using testing::IsEmpty;

namespace
{

// What a callback received: the objects by name (a link as "antecedent-dependent"), "end" for each end mark.
struct Received
{
    std::vector<std::string> names;
    std::size_t wanted = 100; // says stop after so many
    bool throws = false;
};

std::string name_of(const Instance* instance)
{
    if (!instance)
        return "end";
    if (const auto* named = cast<Test_Thing>(instance))
        return named->Name.value.c_str();
    const auto* association = cast<Test_Link>(instance);
    return name_of(association->Antecedent) + "-" + name_of(association->Dependent);
}

template <class Status> bool receive(Instance* instance, Status status, void* client_data)
{
    const Ref<Instance> object(instance);
    auto& received = *static_cast<Received*>(client_data);
    if (instance)
    {
        EXPECT_EQ(status, 0U);
    }
    received.names.push_back(name_of(instance));
    if (received.throws && instance)
        throw std::runtime_error("callback");
    return received.names.size() < received.wanted;
}

class Provider_Handle_Test : public testing::Test
{
protected:
    void TearDown() override
    {
        source.reset();
        Script::fresh();
        EXPECT_EQ(live_instances(), 0U);
    }

    template <class... Names> void offer(Names... names) { (script.instances.emplace_back(thing(names).steal()), ...); }
    void offer_links()
    {
        for (const auto& [a, b] : {std::pair("a", "b"), {"c", "b"}, {"a", "d"}})
            script.instances.emplace_back(make_link(a, b).steal());
    }

    Enum_Associator_Names_Status names(Received& received)
    {
        return links.enum_associator_names(source.ptr(), "", "", "", receive, &received);
    }

    Enum_References_Status references(Received& received)
    {
        const Ref<Test_Link> model(create<Test_Link>(false));
        return links.enum_references(source.ptr(), model.ptr(), "", receive, &received);
    }

    Script& script = Script::fresh();
    Provider_Handle things{&thing_registration};
    Provider_Handle links{&link_registration};
    Ref<Test_Thing> source = thing("a");
};

using Get_Instance = Provider_Handle_Test;
using Associations = Provider_Handle_Test;
using Procedure = Provider_Handle_Test;

TEST_F(Get_Instance, is_otherwise_the_first_enumerated_instance_with_equal_keys)
{
    offer("x", "a", "y", "a");
    auto& first = *static_cast<Test_Thing*>(script.instances[1].ptr());
    first.Uint8.set(1);
    for (const bool deaf : {false, true})
    {
        script.deaf = deaf;
        script.delivered = 0;
        Ref<Instance> found;
        ASSERT_EQ(things.get_instance(source.ptr(), found), GET_INSTANCE_OK);
        EXPECT_EQ(cast<Test_Thing>(found.ptr())->Uint8.value, 1);
        EXPECT_EQ(script.delivered, deaf ? 4 : 2);
    }
}

TEST_F(Get_Instance, is_not_found_without_a_match_or_when_the_enumeration_fails)
{
    Ref<Instance> found;
    offer("x", "y");
    EXPECT_EQ(things.get_instance(source.ptr(), found), GET_INSTANCE_NOT_FOUND);
    offer("a");
    script.enum_instances = ENUM_INSTANCES_FAILED;
    EXPECT_EQ(things.get_instance(source.ptr(), found), GET_INSTANCE_NOT_FOUND);
    EXPECT_FALSE(found);
}

// What the filters do is shown where servers set them.
TEST_F(Associations, come_from_the_enumeration_with_one_end_mark)
{
    offer_links();
    Received received;
    EXPECT_EQ(names(received), ENUM_ASSOCIATOR_NAMES_OK);
    EXPECT_THAT(received.names, ElementsAre("b", "d", "end"));
    EXPECT_EQ(null_of(script.model.ptr(), find_property(&Test_Link::static_meta_class, "Note")), 1);
    received = {};
    EXPECT_EQ(references(received), ENUM_REFERENCES_OK);
    EXPECT_THAT(received.names, ElementsAre("a-b", "a-d", "end"));
}

TEST_F(Associations, stop_when_told_and_still_mark_the_end)
{
    offer_links();
    for (const bool deaf : {false, true})
    {
        script.deaf = deaf;
        Received received{.names = {}, .wanted = 1};
        EXPECT_EQ(names(received), ENUM_ASSOCIATOR_NAMES_OK);
        EXPECT_THAT(received.names, ElementsAre("b", "end"));

        received = {.names = {}, .wanted = 1};
        EXPECT_EQ(references(received), ENUM_REFERENCES_OK);
        EXPECT_THAT(received.names, ElementsAre("a-b", "end"));
    }
}

TEST_F(Associations, that_the_provider_answers_are_not_enumerated_and_end_once_too)
{
    offer_links();
    Received received;
    script.enum_associator_names = ENUM_ASSOCIATOR_NAMES_FAILED;
    script.enum_references = ENUM_REFERENCES_ACCESS_DENIED;
    EXPECT_EQ(names(received), ENUM_ASSOCIATOR_NAMES_FAILED);
    EXPECT_EQ(references(received), ENUM_REFERENCES_ACCESS_DENIED);
    EXPECT_THAT(received.names, ElementsAre("end", "end"));
    EXPECT_EQ(script.enumerations, 0);
}

TEST_F(Associations, of_an_ordinary_class_fail_without_a_word_to_the_provider)
{
    Received received;
    EXPECT_EQ(things.enum_associator_names(source.ptr(), "", "", "", receive, &received), ENUM_ASSOCIATOR_NAMES_FAILED);
    EXPECT_EQ(things.enum_references(source.ptr(), source.ptr(), "", receive, &received), ENUM_REFERENCES_FAILED);
    EXPECT_THAT(received.names, IsEmpty());
    EXPECT_EQ(script.enumerations, 0);
}

TEST_F(Associations, lose_nothing_when_a_callback_throws)
{
    offer_links();
    Received received{.names = {}, .throws = true};
    EXPECT_THROW(names(received), std::runtime_error);
    EXPECT_THROW(references(received), std::runtime_error);
    EXPECT_THROW(links.enum_instances(source.ptr(), receive, &received), std::runtime_error);
}

TEST_F(Procedure, answers_minus_one_for_what_the_class_does_not_have)
{
    const auto answer = [](const Registration& registration, int operation)
    {
        return registration.provider_proc(&registration, operation, nullptr, nullptr, nullptr, nullptr, nullptr, nullptr, nullptr,
                                          nullptr);
    };

    for (const int operation : {OPERATION_ENABLE_INDICATIONS, OPERATION_DISABLE_INDICATIONS, OPERATION_ENUM_ASSOCIATOR_NAMES,
                                OPERATION_ENUM_REFERENCES, OPERATION_ENUM_ASSOCIATORS})
        EXPECT_EQ(answer(thing_registration, operation), -1) << operation;
    for (const int operation : {static_cast<int>(OPERATION_ENABLE_INDICATIONS), 17, -1, 1000})
        EXPECT_EQ(answer(link_registration, operation), -1) << operation;
    EXPECT_EQ(static_cast<int>(things.invoke_method(source.ptr(), source.ptr())), -1);
    EXPECT_EQ(static_cast<int>(things.disable_indications()), -1);
}

TEST_F(Procedure, marks_the_end_of_an_enumeration_once)
{
    offer("x", "y");
    for (const auto status : {ENUM_INSTANCES_OK, ENUM_INSTANCES_FAILED})
    {
        Received received;
        script.enum_instances = status;
        EXPECT_EQ(things.enum_instances(source.ptr(), receive, &received), status);
        EXPECT_THAT(received.names, ElementsAre("x", "y", "end"));
    }
}

} // namespace
