// The alerts that wait to be delivered, oldest first.
#pragma once

#include "runtime/instance.h"
#include "schema/ZEMLAR_AlertIndication.h"

#include <array>
#include <cstddef>
#include <mutex>

namespace zmlr
{

// For any thread. Takes no memory of its own, and nothing is destroyed with it: at the end of a process that did not disable its
// indications, threads still come here. What is to be released is cleared before.
class Pending_Alerts
{
public:
    static constexpr std::size_t most = 10'000;

    // Appends an alert. When there are too many, the oldest gives way. The log tells once that this happens; and once more when
    // it happens again after half of them have been taken.
    void append(Ref<ZEMLAR_AlertIndication> alert);

    Ref<ZEMLAR_AlertIndication> take(); // the oldest; null when there is none
    void clear();

private:
    Ref<ZEMLAR_AlertIndication> pop();

    std::mutex _mutex;
    std::array<ZEMLAR_AlertIndication*, most> _ring = {}; // owns the _size from _first on
    std::size_t _first = 0;
    std::size_t _size = 0;
    bool _overflow_told = false;
};

} // namespace zmlr
