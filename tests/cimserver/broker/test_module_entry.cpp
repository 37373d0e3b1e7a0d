#include "test_schema.h"

extern "C" __attribute__((visibility("default"))) const zmlr::Registration* cimple_module() { return test_registrations(); }
