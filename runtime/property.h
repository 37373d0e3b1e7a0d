// Property<T>: one property of an instance record, its value followed directly by its null flag.
#pragma once

#include "runtime/types.h"

namespace zmlr
{

// An aggregate without constructors of its own: generic code makes and destroys it through the meta-data.
template <class T> struct Property
{
    T value;
    uint8 null;

    // Gives the property a value and makes it non-null.
    void set(const T& x)
    {
        value = x;
        null = 0;
    }
};

} // namespace zmlr
