#include "cmpi/shell.h"

#include "runtime/log.h"

#include <exception>

namespace zmlr
{

namespace
{
constexpr const char* log_source = "CMPI_Adapter";
}

void log_exception(const char* name) noexcept
{
    try
    {
        throw;
    }
    catch (const std::exception& e)
    {
        ZMLR_LOG(LL_ERR, "%s(): unexpected exception: %s", name, e.what());
    }
    catch (...)
    {
        ZMLR_LOG(LL_ERR, "%s(): unexpected exception", name);
    }
}

} // namespace zmlr
