// What the profile classes tell when other CIM servers than the project's own run the module, and on a host without drivers.
#include "profiles/server_manager.h"
#include "providers/enumerations.h"
#include "providers/row_of.h"
#include "schema/CIM_ObjectManager.h"
#include "tests/inventory/inventory_fixture.h"
#include "tests/runtime/silent_context.h"

#include <array>

using namespace zmlr;
using testing::ElementsAre;
using testing::IsEmpty;

namespace
{

using Texts = std::array<const char*, 3>; // Name, ElementName and Description of an object manager; some may be null

// A server whose module works for it on this thread. It passes every question on to the module before it answers.
class Foreign_Server : public Silent_Context
{
public:
    Foreign_Server(bool answers, std::vector<Texts> managers) : _answers(answers), _managers(std::move(managers)) { push(this); }
    ~Foreign_Server() override { pop(); }

    int instance_enumerator_create(const char* name_space, const Instance* model, Instance_Enumerator_Rep*& rep) override
    {
        const Ref<Instance> keys(key_clone(model));
        asked.push_back(std::string(name_space) + ' ' + describe(keys.ptr()));
        EXPECT_THAT(ServerManager::getServerManager().getInstances(CLASSID_ObjectManager), IsEmpty());
        rep = reinterpret_cast<Instance_Enumerator_Rep*>(this);
        return _answers ? 0 : -1;
    }
    bool instance_enumerator_more(const Instance_Enumerator_Rep*) override { return !_managers.empty(); }
    Ref<Instance> instance_enumerator_get(const Instance_Enumerator_Rep*) override
    {
        Ref<CIM_ObjectManager> manager(CIM_ObjectManager::create());
        Property<String>* const properties[] = {&manager->Name, &manager->ElementName, &manager->Description};
        for (std::size_t i = 0; i < 3; i++)
            if (const char* text = _managers.front()[i])
                properties[i]->set(text);
        return Ref<Instance>(manager.steal());
    }

    std::vector<std::string> asked;

private:
    const bool _answers;
    const std::vector<Texts> _managers;
};

using Profiles = Inventory_Test;

} // namespace

TEST_F(Profiles, name_the_object_manager_as_its_server_does)
{
    const std::string stand_in = R"("CIM Server")";
    const struct
    {
        bool answers;
        std::vector<Texts> managers;
        std::vector<std::string> expected; // Name, Caption, Description
    } servers[] = {
        {false, {Texts{"n", "e", "d"}}, {stand_in, stand_in, stand_in}},
        {true, {}, {stand_in, stand_in, stand_in}},
        {true, {Texts{"n", "e", "d"}, Texts{"other", "other", "other"}}, {R"("n")", R"("e")", R"("d")"}},
        {true, {Texts{"n", nullptr, nullptr}}, {R"("n")", "", ""}},
        {true, {Texts{"", "", "d"}}, {stand_in, R"("")", R"("d")"}},
        {true, {Texts{nullptr, "e", "d"}}, {stand_in, R"("e")", R"("d")"}},
    };
    const std::string question = "root/PG_InterOp CIM_ObjectManager\n";
    const Ref<ZEMLAR_ObjectManager> other(ZEMLAR_ObjectManager::create());
    for (Property<String>* key : {&other->SystemCreationClassName, &other->SystemName, &other->CreationClassName, &other->Name})
        key->set("other");
    for (const auto& row : servers)
    {
        Foreign_Server server(row.answers, row.managers);
        // A client that asks for another object manager costs no second question.
        const auto managers = instances_of(row_of(ZEMLAR_ObjectManager::static_meta_class, enumerations), other.ptr(), "Test");
        ASSERT_EQ(managers.size(), 1U);
        EXPECT_THAT(server.asked, ElementsAre(question));
        EXPECT_THAT((std::vector{value_of(managers[0], "Name"), value_of(managers[0], "Caption"),
                                 value_of(managers[0], "Description"), value_of(managers[0], "ElementName")}),
                    ElementsAre(row.expected[0], row.expected[1], row.expected[2], stand_in));
        const auto spaces = instances_of(row_of(ZEMLAR_Namespace::static_meta_class, enumerations), nullptr, "Test");
        EXPECT_THAT(values_of(spaces, "ObjectManagerName"), ElementsAre(row.expected[0]));
        EXPECT_THAT(server.asked, ElementsAre(question, question));
    }
}
