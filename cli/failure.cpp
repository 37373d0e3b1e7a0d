#include "cli/failure.h"

namespace hxa
{

std::string status_text(hxa_status_t status)
{
    std::string text = hxal_status_to_string(status);
    text.erase(text.find_last_not_of(' ') + 1);
    return text + " (" + std::to_string(status) + ")";
}

void require(hxa_status_t status, const std::string& what)
{
    if (status != HXA_STATUS_OK)
        throw Failure(Exit::refused, what + ": " + status_text(status));
}

} // namespace hxa
