// From a class to its row in one of the tables of providers.
#pragma once

#include "runtime/meta.h"

#include <cstddef>

namespace zmlr
{

// The row whose `meta_class` is the class, found by the compiler in one of the tables; without one the call does not compile.
template <class Row, std::size_t... N> constexpr const Row& row_of(const Meta_Class& meta_class, const Row (&... tables)[N])
{
    const Row* found = nullptr;
    const auto look = [&](const auto& rows)
    {
        for (const Row& row : rows)
        {
            if (row.meta_class == &meta_class)
                found = &row;
        }
    };
    (look(tables), ...);
    if (!found)
        throw "no table has a row for the class";
    return *found;
}

} // namespace zmlr
