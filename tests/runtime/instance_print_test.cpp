#include "runtime/instance_print.h"

#include "tests/runtime/printed.h"
#include "tests/runtime/sample_classes.h"

#include <gtest/gtest.h>

using namespace zmlr;
using namespace sample;

namespace
{

TEST(Instance_Print, a_block_per_object)
{
    const auto association = linked(element("a\"b"), {});
    association->__name_space = "root/zemlar";
    association->Antecedent->Labels.value.clear();
    association->Others.value.append(disk("d").steal());
    association->Others.value.append(nullptr);
    association->Others.null = 0;
    nullify_non_keys(association->Others.value[0]);
    EXPECT_EQ(printed([&](std::FILE* stream) { fprint(stream, association.ptr()); }),
              R"(Sample_Link
{
    string __name_space = "root/zemlar";
    Sample_Element Antecedent =
    {
        string Name = "a\"b";
        boolean Online = NULL;
        uint8 Slot = NULL;
        uint32 Size = 1;
        sint64 Delta = NULL;
        real64 Load = NULL;
        char16 Letter = 'x';
        datetime Since = "00000001000000.000000:000";
        string Caption = "new element";
        string Labels[] = { };
        uint16 Codes[] = { 2, 3, 5 };
        datetime Intervals[] = { "00000000000000.000000:000" };
        real64 Samples[] = NULL;
    }
    Sample_Disk Dependent = NULL;
    Sample_Element Others[] =
    {
        Sample_Disk Others =
        {
            string Name = "d";
            boolean Online = NULL;
            uint8 Slot = NULL;
            uint32 Size = NULL;
            sint64 Delta = NULL;
            real64 Load = NULL;
            char16 Letter = NULL;
            datetime Since = NULL;
            string Caption = NULL;
            string Labels[] = NULL;
            uint16 Codes[] = NULL;
            datetime Intervals[] = NULL;
            real64 Samples[] = NULL;
            uint64 Blocks = NULL;
        }
        NULL
    };
    string Note = NULL;
}
)");

    testing::internal::CaptureStdout();
    print(Ref<Sample_Setting>(create<Sample_Setting>(false)).ptr());
    EXPECT_EQ(testing::internal::GetCapturedStdout(), "Sample_Setting\n{\n    uint32 Level = 0;\n}\n");
}

} // namespace
