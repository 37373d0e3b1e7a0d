// The generated skeletons: their default answers and the way from a parameter record to a typed method.
#include "cmpi/registration.h"
#include "cmpi/status.h"
#include "providers/skeletons.h"
#include "schema/CIM_DiagnosticService.h"
#include "schema/CIM_LogicalDevice.h"
#include "schema/ZEMLAR_ConcreteJob.h"

#include <gtest/gtest.h>

// The classes whose provider the module makes of a source or a row: here their skeletons serve.
#define ZMLR_CREATE_SKELETON(class_name)
#define ZMLR_CREATE_ENUMERATED(class_name) ZMLR_CREATE_WRITTEN(class_name)
#define ZMLR_CREATE_WRITTEN(class_name)                                                                                          \
    class_name##_Provider_Skeleton* create_##class_name##_Provider() { return new class_name##_Provider_Skeleton; }
#define ZMLR_PROVIDER(class_name, interfaces, state) ZMLR_CREATE_##state(class_name)

namespace zmlr
{

#include "providers/providers.def"

namespace
{

class Alarm : public ZEMLAR_AlarmDevice_Provider_Skeleton
{
public:
    Invoke_Method_Status SetAlarmState(const ZEMLAR_AlarmDevice* self, const Property<uint16>& State,
                                       Property<uint32>& return_value) override
    {
        device_id = self->DeviceID.value;
        return_value.set(State.value + 100u);
        return INVOKE_METHOD_OK;
    }

    String device_id;
};

class Memory_Test : public ZEMLAR_MemoryDiagnosticTest_Provider_Skeleton
{
public:
    Invoke_Method_Status RunDiagnostic(const ZEMLAR_MemoryDiagnosticTest*, const CIM_ManagedElement* ManagedElement,
                                       const CIM_DiagnosticSetting*, const CIM_JobSettingData*, CIM_ConcreteJob*& Job,
                                       Property<uint32>& return_value) override
    {
        Job = reinterpret_cast<CIM_ConcreteJob*>(ZEMLAR_ConcreteJob::create());
        return_value.set(ManagedElement ? 0 : 5);
        return INVOKE_METHOD_FAILED;
    }
};

template <class Record> Ref<Record> parameters_of()
{
    return Ref<Record>(static_cast<Record*>(create(&Record::static_meta_class)));
}

TEST(Skeletons, a_record_reaches_the_typed_method_and_comes_back_filled)
{
    Alarm provider;
    Ref<ZEMLAR_AlarmDevice> self(ZEMLAR_AlarmDevice::create());
    self->DeviceID.set("1000000533000001");
    auto parameters = parameters_of<ZEMLAR_AlarmDevice_SetAlarmState_method>();
    parameters->State.set(3);

    EXPECT_EQ(Alarm::invoke(provider, self.ptr(), parameters.ptr()), INVOKE_METHOD_OK);
    EXPECT_EQ(provider.device_id, "1000000533000001");
    EXPECT_EQ(parameters->return_value.value, 103u);
}

TEST(Skeletons, references_go_out_through_the_record_and_methods_of_others_stay_out)
{
    Memory_Test provider;
    auto run = parameters_of<CIM_DiagnosticService_RunDiagnostic_method>();
    EXPECT_EQ(Memory_Test::invoke(provider, nullptr, run.ptr()), static_cast<int>(INVOKE_METHOD_FAILED));
    EXPECT_NE(run->Job, nullptr); // the record owns it
    EXPECT_EQ(run->return_value.value, 5u);

    Alarm alarm;
    auto inherited = parameters_of<CIM_LogicalDevice_Reset_method>();
    EXPECT_EQ(Alarm::invoke(alarm, nullptr, inherited.ptr()), static_cast<int>(INVOKE_METHOD_UNSUPPORTED));
    EXPECT_EQ(Alarm::invoke(alarm, nullptr, run.ptr()), -1);
}

TEST(Skeletons, procedures_answer_by_the_kind_of_their_class)
{
    const auto call = [](Provider_Proc proc, Operation operation, void* arg0, void* arg1 = nullptr, void* arg2 = nullptr)
    { return proc(nullptr, operation, arg0, arg1, arg2, nullptr, nullptr, nullptr, nullptr, nullptr); };
    const Provider_Proc association = __cimple_ZEMLAR_ControlledBy_Provider_proc;
    const Provider_Proc indication = __cimple_ZEMLAR_AlertIndication_Provider_proc;
    void *controlled_by = nullptr, *alert = nullptr;
    call(association, OPERATION_CREATE_PROVIDER, &controlled_by);
    call(indication, OPERATION_CREATE_PROVIDER, &alert);

    const Meta_Class* meta_class = nullptr;
    EXPECT_EQ(call(association, OPERATION_GET_META_CLASS, &meta_class), GET_META_CLASS_OK);
    EXPECT_STREQ(meta_class->name, "ZEMLAR_ControlledBy");

    Instance* found = nullptr;
    EXPECT_EQ(call(association, OPERATION_GET_INSTANCE, controlled_by, nullptr, &found),
              static_cast<int>(GET_INSTANCE_UNSUPPORTED));
    EXPECT_EQ(call(association, OPERATION_DISABLE_INDICATIONS, controlled_by), -1);
    EXPECT_EQ(call(indication, OPERATION_DISABLE_INDICATIONS, alert), DISABLE_INDICATIONS_OK);
    EXPECT_EQ(call(indication, OPERATION_ENUM_INSTANCES, alert), -1);

    call(association, OPERATION_DESTROY_PROVIDER, controlled_by);
    call(indication, OPERATION_DESTROY_PROVIDER, alert);
}

} // namespace
} // namespace zmlr
