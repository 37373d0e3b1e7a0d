#include "runtime/assert.h"
#include "runtime/buffer.h"
#include "tests/runtime/sample_classes.h"

#include <gtest/gtest.h>

using namespace zmlr;
using namespace sample;

namespace
{

// Memory that no one made an instance of.
struct Junk
{
    alignas(Instance) unsigned char bytes[sizeof(Sample_Element)] = {};
    Instance* instance() { return reinterpret_cast<Instance*>(bytes); }
};

TEST(AssertDeathTest, reports_place_function_and_condition)
{
    Junk junk;
    EXPECT_DEATH(unref(junk.instance()),
                 "instance\\.cpp\\([0-9]+\\): unref\\(\\): assert: inst->__magic == CIMPLE_INSTANCE_MAGIC");
    EXPECT_DEATH(clone(static_cast<const Instance*>(nullptr)), "clone\\(\\): assert: inst != 0");
    EXPECT_DEATH(identical(nullptr, junk.instance()), "assert: i1 != 0");
    EXPECT_DEATH(key_eq(element("a").ptr(), junk.instance()), "assert: i2->__magic == CIMPLE_INSTANCE_MAGIC");
    EXPECT_DEATH(copy(element("a").ptr(), disk("a").ptr()), "copy\\(\\): assert: dest->meta_class == src->meta_class");
    EXPECT_DEATH(copy(element("a").ptr(), element("b").ptr(), disk("a").ptr()), "model->meta_class == dest->meta_class");
    EXPECT_DEATH(is_reference_of(element("a").ptr(), nullptr, ""), "assert: assoc_inst != 0");
    const auto held = element("a"), shared = held;
    EXPECT_DEATH(destroy(shared.ptr()), "destroy\\(\\): assert: Atomic_get\\(&inst->__refs\\) == 1");
    EXPECT_DEATH((__cimple_trace("port.cpp", 12, "here"), check(false, "x")), "TRACE: port.cpp\\(12\\): here\n.*assert: x\n\n");
}

TEST(AssertDeathTest, positions_past_the_end)
{
    String s("abc");
    EXPECT_DEATH(s.remove(2, 2), "assert: pos \\+ n <= _rep->size");
    EXPECT_DEATH(s.substr(4), "assert: pos \\+ n <= _rep->size");
    EXPECT_DEATH(s.remove(1, 0xFFFFFFFE), "assert: pos \\+ n <= _rep->size");
    EXPECT_DEATH(s.set(4, 'x'), "assert: i <= _rep->size");
    Array<uint32> array;
    EXPECT_DEATH(array.remove(0), "assert: pos \\+ n <= rep->size");
    Buffer buffer;
    EXPECT_DEATH(buffer.insert(1, "x", 1), "assert: i <= _size");
    EXPECT_DEATH(buffer.remove(0, 1), "assert: i \\+ size <= _size");
}

} // namespace
