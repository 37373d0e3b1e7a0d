// The queries of indication filters: any text is read or refused, and one that is read lets an indication through or not.
#include "cimserver/model/event_query.h"

#include <cstdint>

using namespace cimserver;

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    static const Instance alert{{"", "root/test", "A", {}},
                                {{"T", {CMPI_string, std::string("x")}},
                                 {"N", {CMPI_sint64, std::int64_t{-5}}},
                                 {"B", {CMPI_boolean, true}},
                                 {"Z", {CMPI_string, {}}}}};
    static const Property_Layout layout(alert);
    try
    {
        const Event_Query query(std::string(reinterpret_cast<const char*>(data), size));
        query.check(layout);
        query.wants(alert);
        query.selected(alert);
    }
    catch (const Cim_Error& error)
    {
        if (error.code() != CIM_ERR_INVALID_QUERY)
            __builtin_trap();
    }
    return 0;
}
