// The typed records against the generic accessors: both must see the same fields.
#include "runtime/instance.h"
#include "schema/CIM_DiagnosticService.h"
#include "schema/ZEMLAR_ConcreteJob.h"
#include "schema/ZEMLAR_FCPort.h"
#include "schema/ZEMLAR_FCPortStatistics.h"
#include "schema/ZEMLAR_FCPortSystemDevice.h"
#include "schema/ZEMLAR_LogicalDisk.h"
#include "schema/ZEMLAR_ObjectManager.h"
#include "schema/ZEMLAR_PhysicalPackage.h"
#include "schema/ZEMLAR_SCSIProtocolEndpoint.h"

#include <gtest/gtest.h>

namespace zmlr
{
namespace
{

template <class T> T& generic(Instance* instance, const char* property)
{
    const Meta_Property* found = find_property(instance->meta_class, property);
    EXPECT_NE(found, nullptr) << property;
    return *static_cast<T*>(address_of(instance, found->offset));
}

uint8& generic_null(Instance* instance, const char* property)
{
    return null_of(instance, find_property(instance->meta_class, property));
}

TEST(Records, typed_and_generic_code_see_the_same_fields)
{
    Ref<ZEMLAR_FCPort> port(ZEMLAR_FCPort::create());
    port->Caption.set("first");                       // declared by the root
    port->PortType.set(10);                           // overridden half-way
    port->OperationalStatus.set(Array<uint16>{2, 8}); // an array
    port->ActiveFC4Types.set(Array<uint16>{8});       // the last field

    EXPECT_EQ(generic<String>(port.ptr(), "caption"), "first");
    EXPECT_EQ(generic<uint16>(port.ptr(), "PortType"), 10);
    EXPECT_EQ(generic<Array<uint16>>(port.ptr(), "OperationalStatus"), (Array<uint16>{2, 8}));
    EXPECT_EQ(generic<Array<uint16>>(port.ptr(), "ActiveFC4Types"), (Array<uint16>{8}));
    for (const char* set : {"Caption", "PortType", "OperationalStatus", "ActiveFC4Types"})
        EXPECT_EQ(generic_null(port.ptr(), set), 0) << set;
    for (const char* unset : {"InstanceID", "UsageRestriction", "OtherPortType", "StatusDescriptions", "ActiveCOS"})
        EXPECT_EQ(generic_null(port.ptr(), unset), 1) << unset;

    generic_null(port.ptr(), "Speed") = 0;
    generic<uint64>(port.ptr(), "Speed") = 8'000'000'000;
    EXPECT_EQ(port->Speed.null, 0);
    EXPECT_EQ(port->Speed.value, 8'000'000'000u);
}

TEST(Records, references_are_typed_and_owned)
{
    Ref<ZEMLAR_FCPortSystemDevice> device(ZEMLAR_FCPortSystemDevice::create());
    ASSERT_EQ(device->PartComponent, nullptr);
    device->PartComponent = ZEMLAR_FCPort::create();
    const Meta_Reference* part = find_reference(&ZEMLAR_FCPortSystemDevice::static_meta_class, "PartComponent");
    EXPECT_EQ(reference_of(device.ptr(), part), device->PartComponent);
}

TEST(Records, defaults)
{
    Ref<ZEMLAR_FCPort> port(ZEMLAR_FCPort::create());
    EXPECT_EQ(port->EnabledState.value, 5);
    EXPECT_EQ(port->RequestedState.value, 12);
    EXPECT_EQ(port->EnabledDefault.value, 2);
    EXPECT_EQ(port->EnabledState.null, 0);
    EXPECT_EQ(port->HealthState.null, 1);

    Ref<ZEMLAR_ConcreteJob> job(ZEMLAR_ConcreteJob::create());
    EXPECT_EQ(job->JobRunTimes.value, 1u);
    EXPECT_EQ(job->TimeBeforeRemoval.value.ascii(), "00000000000500.000000:000");

    Ref<ZEMLAR_LogicalDisk> disk(ZEMLAR_LogicalDisk::create());
    EXPECT_EQ(disk->Primordial.null, 0); // a default of false
    EXPECT_FALSE(disk->Primordial.value);
    EXPECT_EQ(disk->NameFormat.value, 12); // an override that adds a default

    Ref<ZEMLAR_ObjectManager> manager(ZEMLAR_ObjectManager::create());
    EXPECT_TRUE(manager->GatherStatisticalData.value);

    Ref<ZEMLAR_FCPortStatistics> statistics(ZEMLAR_FCPortStatistics::create());
    EXPECT_EQ(statistics->SampleInterval.value.ascii(), "00000000000000.000000:000");
    EXPECT_TRUE(statistics->SampleInterval.value.is_interval());

    // An override stands for itself: without a default of its own the property starts null.
    Ref<ZEMLAR_SCSIProtocolEndpoint> endpoint(ZEMLAR_SCSIProtocolEndpoint::create());
    EXPECT_EQ(endpoint->EnabledState.null, 1);

    Ref<ZEMLAR_FCPort> bare(ZEMLAR_FCPort::create(false));
    EXPECT_EQ(bare->EnabledState.value, 0);
    EXPECT_EQ(bare->EnabledState.null, 0);
}

// Reals and the module's own property, which no other class has.
TEST(Records, values_of_the_card)
{
    Ref<ZEMLAR_PhysicalPackage> package(ZEMLAR_PhysicalPackage::create());
    package->Height.set(0.5F);
    package->FRUNumber.set("FRU1");
    EXPECT_EQ(generic<real32>(package.ptr(), "Height"), 0.5F);
    EXPECT_EQ(generic<String>(package.ptr(), "FRUNumber"), "FRU1");
    EXPECT_EQ(package->RemovalConditions.value, 2);
}

TEST(Records, parameter_records)
{
    using Record = CIM_DiagnosticService_RunDiagnostic_method;
    Ref<Record> record(static_cast<Record*>(create(&Record::static_meta_class)));
    EXPECT_STREQ(record_of(record.ptr())->name, "RunDiagnostic");
    EXPECT_EQ(record->Job, nullptr);
    record->return_value.set(4);
    const Meta_Feature* last = find_parameter(&Record::static_meta_class, "return_value");
    EXPECT_EQ(*static_cast<uint32*>(address_of(record.ptr(), as_property(last)->offset)), 4u);
}

} // namespace
} // namespace zmlr
