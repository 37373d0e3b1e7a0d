// Small helpers around the objects of a broker: ownership, and texts read without surprises.
#pragma once

#include "runtime/string.h"

#include <cmpimacs.h>

#include <memory>

namespace zmlr
{

// Releases an object. A server that throws here must not end the process: destructors call this.
struct CMPI_Release
{
    template <class T> void operator()(T* object) const noexcept
    {
        try
        {
            CMRelease(object);
        }
        catch (...)
        {
        }
    }
};

// Owns an object that the broker made for us. (Objects read out of other objects belong to the broker.)
template <class T> using CMPI_Ptr = std::unique_ptr<T, CMPI_Release>;

inline bool okay(const CMPIStatus& status) { return status.rc == CMPI_RC_OK; }

// The characters of a broker's string, which keeps owning them, or null when there are none.
const char* chars_of(const CMPIString* string);

// The name space and the class of a path; empty when it has none (or is null).
String name_space_of(const CMPIObjectPath* path);
String class_name_of(const CMPIObjectPath* path);

} // namespace zmlr
