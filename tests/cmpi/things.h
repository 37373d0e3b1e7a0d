// Objects of the classes in tests/e2e/module/test.mof.
#pragma once

#include "schema/TST_Alert.h"
#include "schema/TST_Disk.h"
#include "schema/TST_Pair.h"
#include "schema/TST_Thing.h"
#include "schema/repository.h"

namespace test
{

using namespace zmlr;

Ref<TST_Thing> thing(const char* name);
Ref<TST_Thing> full_thing(const char* name); // every property has a value
Ref<TST_Pair> linked(const char* antecedent, const char* dependent);

} // namespace test
