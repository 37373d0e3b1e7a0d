// Settings that outlive the drivers: what a driver has accepted goes into its configuration file too.
#pragma once

#include "cli/commands.h"

#include <functional>

namespace hxa
{

// Asks before the file is written anew, because that loses what the library's model does not hold: comments and tuning numbers.
void confirm_rewriting(Session& session, const std::string& file);

// Does what changes a setting. When it is to be kept: asks first, reads the file before, writes it afterwards.
void change(Session& session, const Keep_Options& options, const std::function<void()>& setting);

} // namespace hxa
