// Associations of the module through the association helpers: the one with three references, and one whose far end may be of
// several classes.
#include "schema/CIM_LogicalDevice.h"
#include "schema/ZEMLAR_ComputerSystem.h"
#include "schema/ZEMLAR_LogicalDisk.h"
#include "schema/ZEMLAR_SCSIInitiatorTargetLogicalUnitPath.h"
#include "schema/ZEMLAR_SCSIProtocolEndpoint.h"
#include "schema/ZEMLAR_StorageResourcesSystemDevice.h"

#include <gtest/gtest.h>

#include <vector>

namespace zmlr
{
namespace
{

Ref<ZEMLAR_SCSIProtocolEndpoint> endpoint(const char* name)
{
    Ref<ZEMLAR_SCSIProtocolEndpoint> result(ZEMLAR_SCSIProtocolEndpoint::create());
    result->Name.set(name);
    return result;
}

Ref<ZEMLAR_LogicalDisk> disk(const char* id)
{
    Ref<ZEMLAR_LogicalDisk> result(ZEMLAR_LogicalDisk::create());
    result->DeviceID.set(id);
    return result;
}

struct Unit_Path : testing::Test
{
    Unit_Path()
    {
        path->Initiator = Ref(initiator).steal();
        path->Target = Ref(target).steal();
        path->LogicalUnit = reinterpret_cast<CIM_LogicalDevice*>(Ref(unit).steal());
    }

    std::vector<const Instance*> far_ends(const Instance* source, const char* result_class = nullptr, const char* role = nullptr,
                                          const char* result_role = nullptr, int expected = 0)
    {
        const Instance* out[3] = {};
        const int count = get_associators(source, path.ptr(), result_class, role, result_role, out);
        EXPECT_EQ(count, expected);
        return {out, out + std::max(count, 0)};
    }

    const Ref<ZEMLAR_SCSIProtocolEndpoint> initiator = endpoint("i"), target = endpoint("t");
    const Ref<ZEMLAR_LogicalDisk> unit = disk("u");
    const Ref<ZEMLAR_SCSIInitiatorTargetLogicalUnitPath> path{ZEMLAR_SCSIInitiatorTargetLogicalUnitPath::create()};
};

using Objects = std::vector<const Instance*>;

TEST_F(Unit_Path, leads_from_each_end_to_the_two_others)
{
    EXPECT_EQ(far_ends(initiator.ptr(), nullptr, nullptr, nullptr, 2), (Objects{target.ptr(), unit.ptr()}));
    EXPECT_EQ(far_ends(target.ptr(), "", "Target", "", 2), (Objects{initiator.ptr(), unit.ptr()}));
    EXPECT_EQ(far_ends(unit.ptr(), nullptr, "logicalunit", nullptr, 2), (Objects{initiator.ptr(), target.ptr()}));
    EXPECT_EQ(far_ends(initiator.ptr(), "CIM_LogicalDevice", nullptr, nullptr, 1), (Objects{unit.ptr()}));
    EXPECT_EQ(far_ends(unit.ptr(), "ZEMLAR_SCSIProtocolEndpoint", nullptr, "TARGET", 1), (Objects{target.ptr()}));
    EXPECT_EQ(far_ends(unit.ptr(), "ZEMLAR_FCPort", nullptr, nullptr, 0), Objects());
}

TEST_F(Unit_Path, does_not_concern_strangers_and_other_roles)
{
    far_ends(initiator.ptr(), nullptr, "Target", nullptr, -1);
    far_ends(endpoint("x").ptr(), nullptr, nullptr, nullptr, -1);
    far_ends(Ref<ZEMLAR_ComputerSystem>(ZEMLAR_ComputerSystem::create()).ptr(), nullptr, nullptr, nullptr, -1);
    EXPECT_TRUE(is_reference_of(unit.ptr(), path.ptr(), "LogicalUnit"));
    EXPECT_FALSE(is_reference_of(unit.ptr(), path.ptr(), "Target"));
    EXPECT_TRUE(is_reference_of(target.ptr(), path.ptr(), ""));
    EXPECT_FALSE(is_reference_of(disk("x").ptr(), path.ptr(), nullptr));
}

// One endpoint on both sides is a source twice, and the answer is the unit alone.
TEST_F(Unit_Path, from_an_endpoint_to_itself_reaches_the_unit)
{
    unref(std::exchange(path->Target, endpoint("i").steal()));
    EXPECT_EQ(far_ends(initiator.ptr(), nullptr, nullptr, nullptr, 1), (Objects{unit.ptr()}));
    EXPECT_EQ(far_ends(initiator.ptr(), nullptr, "Target", nullptr, 1), (Objects{unit.ptr()}));
}

TEST_F(Unit_Path, an_unset_end_is_passed_over)
{
    unref(std::exchange(path->LogicalUnit, nullptr));
    EXPECT_EQ(far_ends(initiator.ptr(), nullptr, nullptr, nullptr, 1), (Objects{target.ptr()}));
    far_ends(unit.ptr(), nullptr, nullptr, nullptr, -1);
}

TEST(Associations, a_far_end_of_any_subclass)
{
    const Ref<ZEMLAR_StorageResourcesSystemDevice> device(ZEMLAR_StorageResourcesSystemDevice::create());
    device->GroupComponent = ZEMLAR_ComputerSystem::create(false);
    device->PartComponent = reinterpret_cast<CIM_LogicalDevice*>(disk("d").steal());
    const Ref<ZEMLAR_ComputerSystem> host(ZEMLAR_ComputerSystem::create(false));
    const Instance* out[2] = {};
    EXPECT_EQ(get_associators(host.ptr(), device.ptr(), "CIM_StorageExtent", nullptr, nullptr, out), 1);
    EXPECT_EQ(out[0], reinterpret_cast<const Instance*>(device->PartComponent));
    EXPECT_EQ(get_associators(disk("d").ptr(), device.ptr(), nullptr, "PartComponent", nullptr, out), 1);
    EXPECT_EQ(out[0], device->GroupComponent);
}

} // namespace
} // namespace zmlr
