// What belongs to one request of a client: made by the provider that takes the request, handed to all that serve it.
#pragma once

#include "inventory/host_text.h"
#include "inventory/wanted.h"

namespace zmlr
{

struct Inventory_Request
{
    Host_Text host;
    Wanted wanted;
};

} // namespace zmlr
