// From a class to its row in one of the tables of providers.
#pragma once

#include "runtime/meta.h"

#include <cstddef>

namespace zmlr
{

// The row whose `meta_class` is the class, found by the compiler; without one the call does not compile.
template <class Row, std::size_t N> consteval const Row& row_of(const Row (&rows)[N], const Meta_Class& meta_class)
{
    for (const Row& row : rows)
    {
        if (row.meta_class == &meta_class)
            return row;
    }
    throw "the table has no row for the class";
}

} // namespace zmlr
