// What every manager, helper and provider needs to know: class names, the driver gate, files.
//
// The functions of ProviderUtil are stateless: they may be called from any thread, except while the access library scans. Those
// that tell of the host, of address texts and of look-ups are in host_text.h, address_text.h and adapter_lookup.h.
#pragma once

#include "inventory/class_id.h"
#include "runtime/string.h"

namespace zmlr::ProviderUtil
{

// The class's name, "INVALID CLASS" above MAXCLASSID.
String getClassName(classId_t id);

// The gate: whether classes that need the adapters may be served at all.
bool getDriverStatus();

bool IsFileExist(const char* path);

} // namespace zmlr::ProviderUtil
