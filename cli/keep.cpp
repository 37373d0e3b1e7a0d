#include "cli/keep.h"

#include "cli/field_text.h"
#include "hxal/config/parser.h"
#include "hxal/config/writer.h"

#include <unistd.h>

namespace hxa
{

void confirm_rewriting(Session& session, const std::string& file)
{
    if (access(file.c_str(), F_OK) == 0)
        session.confirm(safe_text(file) + " is written anew, without its comments and the numbers that tune the drivers.");
}

void change(Session& session, const Keep_Options& options, const std::function<void()>& setting)
{
    if (!options.keep)
        return setting();
    confirm_rewriting(session, options.file);
    hxal_config_load(options.file.c_str());
    setting();
    require(hxal_config_sync(options.file.c_str()), safe_text(options.file));
}

} // namespace hxa
