#include "cimserver/broker/provider_turn.h"

#include "cimserver/model/values.h"

#include <algorithm>

namespace cimserver
{

Provider_Turn::Provider_Turn(Provider_Turns& turns, const char* class_name) : _turns(turns)
{
    std::unique_lock lock(_turns._mutex);
    _nested = std::ranges::find(_turns._inside, std::this_thread::get_id()) != _turns._inside.end();
    if (_nested)
        return;
    while (_turns._inside.size() >= Provider_Turns::at_once)
        if (_turns._left.wait_until(lock, _turns._last_change + _turns._patience) == std::cv_status::timeout &&
            std::chrono::steady_clock::now() >= _turns._last_change + _turns._patience)
            throw Cim_Error(CIM_ERR_FAILED, std::string(class_name) +
                                                " does not answer: earlier requests have kept it busy for " +
                                                std::to_string(_turns._patience / std::chrono::seconds(1)) + " s");
    _turns._inside.push_back(std::this_thread::get_id());
    _turns._last_change = std::chrono::steady_clock::now();
}

Provider_Turn::~Provider_Turn()
{
    if (_nested)
        return;
    const std::lock_guard lock(_turns._mutex);
    _turns._inside.erase(std::ranges::find(_turns._inside, std::this_thread::get_id()));
    _turns._last_change = std::chrono::steady_clock::now();
    _turns._left.notify_one();
}

} // namespace cimserver
