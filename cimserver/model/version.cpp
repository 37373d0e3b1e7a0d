#include "cimserver/model/version.h"

namespace cimserver
{

const char* version() { return ZMLR_VERSION; }

} // namespace cimserver
