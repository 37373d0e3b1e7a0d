// Every class of the repository.
#pragma once

#include "schema/repository.h"

#include <span>

namespace zmlr
{

inline std::span<const Meta_Class* const> repository_classes()
{
    return {meta_repository().meta_classes, meta_repository().num_meta_classes};
}

} // namespace zmlr
