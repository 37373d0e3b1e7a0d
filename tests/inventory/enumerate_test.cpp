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

using Enumerate = Inventory_Test;
using Instances = std::vector<const Instance*>;

const Ref<Instance> ports[] = {Ref<Instance>(ZEMLAR_FCPort::create()), Ref<Instance>(ZEMLAR_FCPort::create())};

// What a manager may hand out at its worst.
Instance_Array mixed_bag(classId_t, const Inventory_Request&)
{
    Instance_Array instances;
    instances.adopt(ports[0]);
    instances.adopt(Ref<Instance>());
    instances.adopt(Ref<Instance>(ZEMLAR_ComputerSystem::create()));
    instances.adopt(ports[1]);
    instances.adopt(Ref<Instance>(ZEMLAR_FCPort::create()));
    return instances;
}

Instance_Array nothing(classId_t, const Inventory_Request&) { return Instance_Array(); }

// What a handler takes that has enough after two instances.
Instances taken_from(Get_Instances manager)
{
    const Enumeration row = {
        &ZEMLAR_FCPort::static_meta_class, manager, CLASSID_FCPort, {{LL_ERR, "No FC Ports Found!"}, {LL_WARN, "A remark"}}};
    Instances taken;
    const auto take = [](Instance* instance, Enum_Instances_Status, void* data)
    {
        static_cast<Instances*>(data)->push_back(instance);
        unref(instance);
        return static_cast<Instances*>(data)->size() < 2;
    };
    Enum_Instances_Handler<ZEMLAR_FCPort> handler(take, &taken);
    Instance_Array instances = instances_of(row, nullptr, "Test_Provider");
    deliver(instances, handler);
    return taken;
}

} // namespace

TEST_F(Enumerate, hands_over_the_instances_of_the_class_in_order_or_says_that_there_are_none)
{
    EXPECT_THAT(taken_from(mixed_bag), ElementsAre(ports[0].ptr(), ports[1].ptr())) << "themselves, not copies";
    EXPECT_THAT(log(), ElementsAre("DBG Test_Provider: Returning instances"));
    EXPECT_THAT(taken_from(nothing), IsEmpty());
    EXPECT_THAT(log(), ElementsAre("ERR Test_Provider: No FC Ports Found!", "WARN Test_Provider: A remark"));
}
