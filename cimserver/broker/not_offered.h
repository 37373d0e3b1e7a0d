// What stands in the rows of a function table that no module of ours calls: no table has a null member.
#pragma once

#include "cimserver/broker/object.h"

#include <cerrno>

namespace cimserver
{

// Fits any row. The function answers nothing, and CMPI_RC_ERR_NOT_SUPPORTED to those that can be told a status; where an int
// tells how it went it is ENOTSUP.
struct Not_Offered
{
    template <class Result, class... Arguments> using Function = Result(Arguments...);
    template <class Result, class... Arguments> using Variadic_Function = Result(Arguments..., ...);

    template <class Result, class... Arguments> constexpr operator Function<Result, Arguments...>*() const
    {
        return answer<Result, Arguments...>;
    }
    template <class Result, class... Arguments> constexpr operator Variadic_Function<Result, Arguments...>*() const
    {
        return variadic_answer<Result, Arguments...>;
    }

private:
    template <class Result, class... Arguments> static Result answer(Arguments... arguments)
    {
        (tell(arguments), ...);
        return nothing<Result>();
    }
    template <class Result, class... Arguments> static Result variadic_answer(Arguments... arguments, ...)
    {
        return answer<Result, Arguments...>(arguments...);
    }

    static void tell(CMPIStatus* status)
    {
        if (status)
            *status = not_supported;
    }
    template <class T> static void tell(const T&) {}

    template <class Result> static Result nothing()
    {
        if constexpr (std::is_same_v<Result, CMPIStatus>)
            return not_supported;
        else if constexpr (std::is_same_v<Result, CMPIData>)
            return no_data();
        else if constexpr (std::is_same_v<Result, int>)
            return ENOTSUP;
        else
            return Result();
    }

    static constexpr CMPIStatus not_supported{CMPI_RC_ERR_NOT_SUPPORTED, nullptr};
};

inline constexpr Not_Offered not_offered;

} // namespace cimserver
