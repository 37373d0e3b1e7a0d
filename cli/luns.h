// The units behind a remote port: REPORT LUNS, then what each one says of itself (SPC-3, SBC-2).
#pragma once

#include "cli/host.h"
#include "cli/session.h"

namespace hxa
{

// A tree for each unit, in the order of REPORT LUNS, each LUN once. A list that cannot be read is told by Session::accept() and
// is empty; of a unit that refuses a command the members are missing that it would tell. Requests: one or two for the list, then
// two a unit, and for a disk one or two more.
List luns_of(Session& session, const Port& port, wwn_t remote_port);

} // namespace hxa
