// Opening the files of the log: plain files only, whatever else has their names.
#pragma once

#include <sys/types.h>

namespace zmlr
{

// As open(2), with O_CLOEXEC; -1 for anything but a regular file. Never waits: a pipe without a partner is refused too.
int open_regular(const char* path, int flags, mode_t mode) noexcept;

} // namespace zmlr
