// Three small classes with hand-made meta-data and a qualifier table of their own: TST_Element (abstract), TST_Port derived
// from it, and the association TST_Link.
#pragma once

#include "runtime/meta.h"

namespace test
{

extern const zmlr::Meta_Class TST_Element;
extern const zmlr::Meta_Class TST_Port;
extern const zmlr::Meta_Class TST_Link;

} // namespace test
