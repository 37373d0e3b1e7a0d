// A helper's table: what each of its classes makes of what was read.
#pragma once

#include "inventory/class_id.h"
#include "runtime/instance.h"
#include "runtime/log.h"

#include <algorithm>
#include <iterator>

namespace zmlr
{

template <class Reading> struct Builder
{
    classId_t id;
    void (*append)(Instance_Array& instances, Reading& reading);
};

// Appends what the class's row makes of the reading. A class without a row is logged with the helper's text.
template <class Reading, std::size_t N>
void build(Instance_Array& instances, const Builder<Reading> (&builders)[N], classId_t id, Reading& reading,
           const char* log_source, const char* no_row)
{
    const auto builder = std::ranges::find(builders, id, &Builder<Reading>::id);
    if (builder != std::end(builders))
        builder->append(instances, reading);
    else
        ZMLR_LOG(LL_INFO, "%s", no_row);
}

} // namespace zmlr
