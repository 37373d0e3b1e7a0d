// What every provider that is a row does, on a row of the tests' own.
#include "providers/delivery.h"
#include "providers/enumeration.h"
#include "schema/ZEMLAR_ComputerSystem.h"
#include "schema/ZEMLAR_FCPort.h"
#include "tests/inventory/inventory_fixture.h"

using namespace zmlr;
using testing::ElementsAre;
using testing::IsEmpty;

namespace
{

Ref<Instance> port(const char* device_id)
{
    ZEMLAR_FCPort* made = ZEMLAR_FCPort::create();
    made->DeviceID.set(device_id);
    return Ref<Instance>(made);
}

const Ref<Instance> shared = port("3");

// What a manager may hand out at its worst.
Instance_Array mixed_bag(classId_t, const Inventory_Request&)
{
    Instance_Array instances;
    instances.adopt(port("1"));
    instances.adopt(Ref<Instance>());
    instances.adopt(Ref<Instance>(ZEMLAR_ComputerSystem::create()));
    instances.adopt(port("2"));
    instances.adopt(shared);
    return instances;
}

Instance_Array nothing(classId_t, const Inventory_Request&) { return Instance_Array(); }

// Takes what a provider hands over, and has enough after a number of instances.
class Enumerate : public Inventory_Test
{
protected:
    std::vector<std::string> run(Get_Instances source, int enough = 100)
    {
        const Enumeration row = {
            &ZEMLAR_FCPort::static_meta_class, source, CLASSID_FCPort, {{LL_ERR, "No FC Ports Found!"}, {LL_WARN, "A remark"}}};
        taken.clear();
        wanted = enough;
        Enum_Instances_Handler<ZEMLAR_FCPort> handler(take, this);
        Instance_Array instances = instances_of(row, "Test_Provider");
        deliver(instances, handler);
        return taken;
    }

private:
    static bool take(Instance* instance, Enum_Instances_Status, void* test)
    {
        auto& self = *static_cast<Enumerate*>(test);
        self.taken.push_back(value_of(instance, "DeviceID"));
        if (self.taken.back() == "\"3\"")
        {
            EXPECT_EQ(instance, shared.ptr()) << "it is handed over, not copied";
        }
        unref(instance);
        return --self.wanted > 0;
    }

    std::vector<std::string> taken;
    int wanted = 0;
};

} // namespace

TEST_F(Enumerate, hands_over_the_instances_of_the_class_in_order)
{
    EXPECT_THAT(run(mixed_bag), ElementsAre("\"1\"", "\"2\"", "\"3\""));
    EXPECT_THAT(log(), ElementsAre("DBG Test_Provider: Returning instances"));
    EXPECT_THAT(run(mixed_bag, 2), ElementsAre("\"1\"", "\"2\"")) << "the handler has enough";
}

TEST_F(Enumerate, says_that_there_is_nothing)
{
    EXPECT_THAT(run(nothing), IsEmpty());
    EXPECT_THAT(log(), ElementsAre("ERR Test_Provider: No FC Ports Found!", "WARN Test_Provider: A remark"));
}
