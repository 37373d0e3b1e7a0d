// CMPI return codes: what they mean, for people, and the CIM status codes (DSP0200) they stand for.
#pragma once

#include <cmpidt.h>

#include <string>

namespace cimserver
{

// What became of an action of a class, as a sentence: "ZEMLAR_FCPort does not support RequestStateChange", "ZEMLAR_FCPort:
// GetInstance failed", "ZEMLAR_FCPort: DeleteInstance: access denied".
std::string outcome_text(const std::string& class_name, const char* action, CMPIrc rc);

int cim_status(CMPIrc rc);          // 1 to 17 are the same in both; everything else is CIM_ERR_FAILED
CMPIrc return_code(int cim_status); // the reverse, for up-calls

} // namespace cimserver
