#include "cimserver/broker/message.h"

#include "cimserver/broker/objects.h"

#include <algorithm>
#include <vector>

namespace cimserver
{
namespace
{

constexpr CMPICount max_places = 10;

std::string next_argument(std::va_list* arguments)
{
    switch (va_arg(*arguments, int))
    {
    case CMPI_boolean:
        return va_arg(*arguments, int) != 0 ? "true" : "false";
    case CMPI_uint8:
    case CMPI_uint16:
    case CMPI_uint32:
        return std::to_string(va_arg(*arguments, unsigned));
    case CMPI_sint8:
    case CMPI_sint16:
    case CMPI_sint32:
        return std::to_string(va_arg(*arguments, int));
    case CMPI_uint64:
        return std::to_string(va_arg(*arguments, std::uint64_t));
    case CMPI_sint64:
        return std::to_string(va_arg(*arguments, std::int64_t));
    case CMPI_real32:
    case CMPI_real64:
        return std::to_string(va_arg(*arguments, double));
    case CMPI_chars:
        return required(va_arg(*arguments, const char*));
    case CMPI_string:
        return object<String_Object>(va_arg(*arguments, const CMPIString*)).text;
    default:
        throw Failure{CMPI_RC_ERR_INVALID_DATA_TYPE};
    }
}

} // namespace

std::string format_message(const std::string& text, CMPICount count, std::va_list* arguments)
{
    std::vector<std::string> values;
    for (CMPICount i = 0; i < std::min(count, max_places); ++i)
        values.push_back(next_argument(arguments));

    std::string result;
    for (std::size_t i = 0; i < text.size(); ++i)
    {
        const std::size_t place =
            text[i] == '$' && i + 1 < text.size() ? static_cast<std::size_t>(text[i + 1] - '0') : max_places;
        if (place < values.size())
        {
            result += values[place];
            ++i;
        }
        else
            result += text[i];
    }
    return result;
}

} // namespace cimserver
