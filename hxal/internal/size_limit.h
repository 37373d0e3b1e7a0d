// Writing files in a process whose files may be limited in size.
#pragma once

#include <csignal>

namespace hxal
{

// While this lives, a write of this thread beyond the limit (RLIMIT_FSIZE) fails with EFBIG, like one to a full disk, and no
// signal follows: SIGXFSZ would end the process, which is not the library's.
class Size_Limit_Without_Signal
{
public:
    Size_Limit_Without_Signal();
    ~Size_Limit_Without_Signal();

    Size_Limit_Without_Signal(const Size_Limit_Without_Signal&) = delete;
    Size_Limit_Without_Signal& operator=(const Size_Limit_Without_Signal&) = delete;

private:
    sigset_t _signals_before;
    bool _was_pending;
};

} // namespace hxal
