#include "runtime/log.h"
#include "runtime/value.h"
#include "tests/runtime/home.h"
#include "tests/runtime/sample_classes.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

using namespace zmlr;
using namespace sample;
using ::testing::ElementsAre;
using ::testing::MatchesRegex;

namespace
{

void store_what_does_not_fit()
{
    const auto to = linked(element("a"), disk("d"));
    Value wrong;
    wrong.set_value(element("no disk").steal());
    wrong.get(to.ptr(), find_reference(to->meta_class, "Dependent"));
    wrong.get(to.ptr(), find_property(to->meta_class, "Note"));
    wrong.get(nullptr, find_property(to->meta_class, "Note"));
}

TEST(Log_Warnings, name_class_and_feature)
{
    const Home home;
    home.options("LOG_LEVEL=WARN\n");
    ASSERT_TRUE(home.run(
        []
        {
            store_what_does_not_fit();
            if (log_enable(true) != -1 || log_enable(false) != 0 || log_enable(false) != -1)
                std::abort();
            store_what_does_not_fit();
            log(LL_WARN, "Other", 1, "still written");
        }));
    const char* const mark = ".* WARN: Value\\([0-9]+\\): ";
    EXPECT_THAT(
        home.lines(),
        ElementsAre(MatchesRegex(std::string(mark) + "failed to assign instance of Sample_Element to Sample_Link.Dependent"),
                    MatchesRegex(std::string(mark) + "type mismatch: Sample_Link.Note"),
                    MatchesRegex(std::string(mark) + "null instance argument"), MatchesRegex(".*still written")));
}

} // namespace
