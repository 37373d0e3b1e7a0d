#include "cmpi/gate.h"

namespace zmlr
{

bool Gate::enter()
{
    const std::lock_guard guard(_mutex);
    if (_shut)
        return false;
    ++_inside;
    return true;
}

// Notifies under the lock: once it is released, the gate may be gone.
void Gate::leave()
{
    const std::lock_guard guard(_mutex);
    if (--_inside == 0)
        _empty.notify_all();
}

void Gate::shut()
{
    const std::lock_guard guard(_mutex);
    _shut = true;
}

bool Gate::is_shut()
{
    const std::lock_guard guard(_mutex);
    return _shut;
}

void Gate::wait()
{
    std::unique_lock lock(_mutex);
    _empty.wait(lock, [this] { return _inside == 0; });
}

} // namespace zmlr
