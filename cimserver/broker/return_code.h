// CMPI return codes: their names, and the CIM status codes (DSP0200) they stand for.
#pragma once

#include <cmpidt.h>

#include <string>

namespace cimserver
{

std::string return_code_name(CMPIrc rc); // "CMPI_RC_ERR_NOT_FOUND"; a number for a code outside the standard

int cim_status(CMPIrc rc);          // 1 to 17 are the same in both; everything else is CIM_ERR_FAILED
CMPIrc return_code(int cim_status); // the reverse, for up-calls

} // namespace cimserver
