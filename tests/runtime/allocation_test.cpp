#include "runtime/model_path.h"
#include "runtime/value.h"
#include "tests/runtime/sample_classes.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <functional>
#include <new>

// Memory that can run out: every allocation of this program goes through here.
namespace
{

long allocations_left = -1; // until one fails; negative: none fails
long live_allocations = 0;
unsigned char last_freed = 0; // first byte of the memory that was freed last

} // namespace

void* operator new(std::size_t size)
{
    void* memory = allocations_left == 0 ? nullptr : std::malloc(size);
    if (!memory)
        throw std::bad_alloc();
    if (allocations_left > 0)
        --allocations_left;
    ++live_allocations;
    return memory;
}

void operator delete(void* memory) noexcept
{
    if (!memory)
        return;
    --live_allocations;
    last_freed = *static_cast<const unsigned char*>(memory);
    std::free(memory);
}

void operator delete(void* memory, std::size_t) noexcept { operator delete(memory); }

using namespace zmlr;
using namespace sample;

namespace
{

// Lets each allocation of the work fail in turn, until it succeeds: nothing may leak or break on the way. The number of
// allocations it takes.
long fail_each_allocation_of(const std::function<void()>& work)
{
    for (long n = 0;; ++n)
    {
        const long before = live_allocations;
        bool failed = false;
        allocations_left = n;
        try
        {
            work();
        }
        catch (const std::bad_alloc&)
        {
            failed = true;
        }
        allocations_left = -1;
        EXPECT_EQ(live_allocations, before) << "when allocation " << n << " fails";
        if (!failed)
            return n;
    }
}

TEST(Memory, runs_out_without_a_leak)
{
    const auto source = linked(element("a"), disk("d")), other = linked(element("x"), disk("y"));
    const auto record = reset_of(element("r"), {element("o").steal()});
    const Meta_Feature* others = find_reference(&Sample_Element_Reset_method::static_meta_class, "Others");

    fail_each_allocation_of(
        [&]
        {
            const Ref<Sample_Link> made(clone(source.ptr())), dest(clone(other.ptr())), bare(create<Sample_Link>());
            const Ref<Instance> keys(key_clone(source.ptr())), parameters(clone(static_cast<const Instance*>(record.ptr())));
            copy(dest.ptr(), source.ptr());
            __create_refs(bare.ptr());
            __set_name_space_recursive(bare.ptr(), "root/zemlar", true);

            Value value;
            value.set(record.ptr(), others);
            const Value copied = value;
            copied.get(parameters.ptr(), others);

            String path;
            EXPECT_EQ(instance_to_model_path(source.ptr(), path), 0);
            EXPECT_TRUE(Ref<Instance>(model_path_to_instance(source->meta_class, path.c_str())));

            Instance_Array instances;
            for (int i = 0; i < 20; ++i)
                instances.adopt(Ref<Instance>(clone(static_cast<const Instance*>(source.ptr()))));
        });
}

TEST(Memory, what_failed_keeps_what_it_had)
{
    String text("abc");
    const String shared = text;
    Array<String> array = {"a", "b", "c", "d", "e", "f", "g", "h"};
    Datetime time(5, 60);
    const Datetime shared_time = time;
    allocations_left = 0;
    EXPECT_THROW(text.append('d'), std::bad_alloc);
    EXPECT_THROW(text.set(0, 'x'), std::bad_alloc);
    EXPECT_THROW(array.append(array[0]), std::bad_alloc);
    EXPECT_THROW(time.usec(7), std::bad_alloc);
    allocations_left = -1;
    EXPECT_EQ(text, "abc");
    EXPECT_EQ(array.size(), 8U);
    EXPECT_EQ(array[7], "h");
    EXPECT_TRUE(time == Datetime(5, 60));
    EXPECT_THROW(array.reserve(0x80000001), std::bad_alloc);
}

TEST(Memory, an_empty_record_takes_one_allocation_and_is_marked_when_freed)
{
    EXPECT_EQ(fail_each_allocation_of([] { const Ref<Sample_Disk> made(create<Sample_Disk>(false)); }), 1);
    EXPECT_EQ(last_freed, 0xDD);
}

} // namespace
