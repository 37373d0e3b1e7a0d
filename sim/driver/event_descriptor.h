// The descriptor of an open node: an eventfd, which is readable as long as its count is not 0.
#pragma once

namespace hxasim
{

// With the flags of open(): an unreadable one, or a negated errno.
int make_event_descriptor(int flags);

// Never block, whoever else reads the descriptor.
void make_readable(int descriptor);
void make_unreadable(int descriptor);

} // namespace hxasim
