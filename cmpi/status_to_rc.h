// What a server is told of a provider's status.
//
// A status that is none of its operation's (a procedure's -1, for one) is a failed retrieval, and elsewhere a success without
// a result.
#pragma once

#include "cmpi/status.h"

#include <cmpidt.h>

namespace zmlr
{

CMPIrc to_rc(Enum_Instances_Status status);
CMPIrc to_rc(Get_Instance_Status status);
CMPIrc to_rc(Create_Instance_Status status);
CMPIrc to_rc(Modify_Instance_Status status);
CMPIrc to_rc(Delete_Instance_Status status);
CMPIrc to_rc(Enum_Associators_Status status);
CMPIrc to_rc(Enum_Associator_Names_Status status);
CMPIrc to_rc(Enum_References_Status status);
CMPIrc to_rc(Invoke_Method_Status status);
CMPIrc to_rc(Enable_Indications_Status status);
CMPIrc to_rc(Disable_Indications_Status status);

} // namespace zmlr
