// The defaults that the meta-data gives to properties.
#pragma once

#include "cimserver/model/values.h"
#include "runtime/meta.h"

namespace cimserver
{

// A value of the property's type, null when it has no default.
Value default_of(const zmlr::Meta_Property& property);

} // namespace cimserver
