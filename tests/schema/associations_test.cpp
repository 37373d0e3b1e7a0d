// Associations of the module through the association helpers: the one with three references, and one whose far end may be of
// several classes.
#include "schema/CIM_LogicalDevice.h"
#include "schema/ZEMLAR_ComputerSystem.h"
#include "schema/ZEMLAR_LogicalDisk.h"
#include "schema/ZEMLAR_ObjectManager.h"
#include "schema/ZEMLAR_SCSIInitiatorTargetLogicalUnitPath.h"
#include "schema/ZEMLAR_SCSIProtocolEndpoint.h"
#include "schema/ZEMLAR_StorageResourcesSystemDevice.h"

#include <gtest/gtest.h>

#include <type_traits>
#include <utility>
#include <vector>

namespace zmlr
{
namespace
{

using Objects = std::vector<const Instance*>;

const Objects unconcerned = {nullptr}; // what far_ends() gives for an association that does not concern the source

template <class T> Ref<T> named(const char* name)
{
    Ref<T> result(T::create());
    if constexpr (std::is_same_v<T, ZEMLAR_LogicalDisk>)
        result->DeviceID.set(name);
    else
        result->Name.set(name);
    return result;
}

Objects far_ends(const Instance* source, const Instance* association, const char* result_class = "", const char* role = "",
                 const char* result_role = "")
{
    const Instance* out[3] = {};
    const int count = get_associators(source, association, result_class, role, result_role, out);
    return count < 0 ? unconcerned : Objects(out, out + count);
}

struct Unit_Path : testing::Test
{
    Unit_Path()
    {
        path->Initiator = Ref(initiator).steal();
        path->Target = Ref(target).steal();
        path->LogicalUnit = reinterpret_cast<CIM_LogicalDevice*>(Ref(unit).steal());
    }

    const Ref<ZEMLAR_SCSIProtocolEndpoint> initiator = named<ZEMLAR_SCSIProtocolEndpoint>("i");
    const Ref<ZEMLAR_SCSIProtocolEndpoint> target = named<ZEMLAR_SCSIProtocolEndpoint>("t");
    const Ref<ZEMLAR_LogicalDisk> unit = named<ZEMLAR_LogicalDisk>("u");
    const Ref<ZEMLAR_SCSIInitiatorTargetLogicalUnitPath> path{ZEMLAR_SCSIInitiatorTargetLogicalUnitPath::create()};
};

TEST_F(Unit_Path, leads_from_each_end_to_the_two_others)
{
    const Instance *i = initiator.ptr(), *t = target.ptr(), *u = unit.ptr();
    const auto stranger = named<ZEMLAR_SCSIProtocolEndpoint>("x");
    const struct
    {
        const Instance* source;
        const char *result_class, *role, *result_role;
        Objects expected;
    } rows[] = {
        // clang-format off
        {i, nullptr, nullptr, nullptr,                           {t, u}},
        {t, "", "Target", "",                                    {i, u}},
        {u, "", "logicalunit", "",                               {i, t}},
        {i, "CIM_LogicalDevice", "", "",                         {u}},
        {u, "zemlar_scsiprotocolendpoint", nullptr, "TARGET",    {t}},
        {u, "ZEMLAR_FCPort", "", "",                             {}},
        {i, "", "", "Initiator",                                 {}}, // its own end is no far end
        {i, "", "Target", "",                                    unconcerned},
        {stranger.ptr(), "", "", "",                             unconcerned},
        // clang-format on
    };
    for (const auto& row : rows)
    {
        EXPECT_EQ(far_ends(row.source, path.ptr(), row.result_class, row.role, row.result_role), row.expected) << &row - rows;
        EXPECT_EQ(is_reference_of(row.source, path.ptr(), row.role), row.expected != unconcerned) << &row - rows;
    }
}

TEST_F(Unit_Path, with_odd_ends)
{
    // An object of another kind may have the same keys: only the references of an association are found by keys alone.
    const auto namesake = named<ZEMLAR_ObjectManager>("i");
    EXPECT_EQ(far_ends(namesake.ptr(), path.ptr()), unconcerned);
    EXPECT_TRUE(is_reference_of(namesake.ptr(), path.ptr(), "Initiator"));

    // One endpoint on both sides is a source twice, and the answer is the unit alone.
    unref(std::exchange(path->Target, Ref(initiator).steal()));
    EXPECT_EQ(far_ends(initiator.ptr(), path.ptr(), "", "Target"), Objects{unit.ptr()});

    unref(std::exchange(path->LogicalUnit, nullptr));
    EXPECT_EQ(far_ends(initiator.ptr(), path.ptr()), Objects{});
    EXPECT_EQ(far_ends(unit.ptr(), path.ptr()), unconcerned);
    EXPECT_FALSE(is_reference_of(unit.ptr(), path.ptr(), ""));
}

TEST(Associations, a_far_end_of_any_subclass)
{
    const Ref<ZEMLAR_StorageResourcesSystemDevice> device(ZEMLAR_StorageResourcesSystemDevice::create());
    device->GroupComponent = named<ZEMLAR_ComputerSystem>("host").steal();
    device->PartComponent = reinterpret_cast<CIM_LogicalDevice*>(named<ZEMLAR_LogicalDisk>("d").steal());
    EXPECT_EQ(far_ends(named<ZEMLAR_ComputerSystem>("host").ptr(), device.ptr(), "CIM_StorageExtent"),
              Objects{reinterpret_cast<const Instance*>(device->PartComponent)});
    EXPECT_EQ(far_ends(named<ZEMLAR_LogicalDisk>("d").ptr(), device.ptr(), "", "PartComponent"), Objects{device->GroupComponent});
}

} // namespace
} // namespace zmlr
