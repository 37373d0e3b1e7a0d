// Runs that run out of memory.
#include "tests/diagnostics/diagnostics_fixture.h"

#include <atomic>
#include <cstdlib>
#include <dlfcn.h>
#include <new>
#include <string_view>

namespace
{

// The module's allocations that still succeed, when it is to run out of memory outside the main thread.
std::atomic<int> allocations_left = -1;
const std::thread::id main_thread = std::this_thread::get_id();

bool is_to_fail(const void* caller)
{
    if (allocations_left < 0 || std::this_thread::get_id() == main_thread)
        return false;
    Dl_info from = {};
    const bool is_modules = dladdr(caller, &from) != 0 && std::string_view(from.dli_fname).ends_with("libzmlrprovider.so");
    return is_modules && (allocations_left == 0 || --allocations_left == 0);
}

struct Row
{
    const char* test_class;
    const char* name;
    const char* element_class;
};
constexpr Row tests[] = {
    {"ZEMLAR_LoopbackDiagnosticTest", "SerdesLoopbackTest", "ZEMLAR_FCPort"},
    {"ZEMLAR_EthLoopbackDiagnosticTest", "SerdesEthLoopbackTest", "ZEMLAR_EthernetPort"},
    {"ZEMLAR_MemoryDiagnosticTest", "MemoryTest", "ZEMLAR_PortController"},
};

using Memory = Diagnostics;

} // namespace

// Not inlined: the compiler would see malloc() through them and take the pairs for mismatched.
[[gnu::noinline]] void* operator new(std::size_t size)
{
    void* memory = is_to_fail(__builtin_return_address(0)) ? nullptr : std::malloc(size);
    if (!memory)
        throw std::bad_alloc();
    return memory;
}

// The address sanitizer's would not call the one above.
[[gnu::noinline]] void* operator new(std::size_t size, const std::nothrow_t&) noexcept { return std::malloc(size); }
[[gnu::noinline]] void operator delete(void* memory) noexcept { std::free(memory); }
[[gnu::noinline]] void operator delete(void* memory, std::size_t) noexcept { std::free(memory); }

const bool wants_log = false;

// Wherever in a run that is.
TEST_F(Memory, its_end_leaves_no_element_out_of_service_and_no_job_running)
{
    const std::string before = states();
    for (const Row& test : tests)
    {
        const auto element = path(test.element_class, 0);
        bool has_failed = true;
        for (int allocations = 1; has_failed; ++allocations)
        {
            allocations_left = allocations;
            const Answer answer = run(test.test_class, test.name, element);
            EXPECT_EQ(answer.code, "4096");
            wait_for_end();
            has_failed = allocations_left.exchange(-1) == 0;
            ASSERT_EQ(states(), before) << test.name << ' ' << allocations;
            ASSERT_EQ(value(enumerate("ZEMLAR_ConcreteJob").at(0), "JobState"), "7") << test.name << ' ' << allocations;
        }
    }
}
