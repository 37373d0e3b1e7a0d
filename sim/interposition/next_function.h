// The function of the same name that an interposed one hides: libc's, or another interposer's that was loaded behind us.
#pragma once

#include <dlfcn.h>

#include <atomic>

namespace hxasim
{

template <typename Function> class Next_Function
{
public:
    constexpr explicit Next_Function(const char* name) : _name(name) {}

    // Null while it is being looked up (the loader itself may open files) and when there is none: make the system call then.
    Function* get() noexcept
    {
        if (auto* known = _function.load(std::memory_order_acquire))
            return known;
        if (_looking_up)
            return nullptr;
        _looking_up = true;
        auto* found = reinterpret_cast<Function*>(dlsym(RTLD_NEXT, _name));
        _looking_up = false;
        _function.store(found, std::memory_order_release);
        return found;
    }

private:
    // The simple model needs no allocation, which a lazily made thread-local of a loaded library would.
    [[gnu::tls_model("initial-exec")]] static inline thread_local bool _looking_up = false;

    const char* _name;
    std::atomic<Function*> _function = nullptr;
};

} // namespace hxasim
