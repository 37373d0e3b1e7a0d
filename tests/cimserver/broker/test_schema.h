// The classes of the test module:
//
//     TST_Top                    abstract
//       TST_Base                 abstract; key Id, Name, method Reset
//         TST_Disk               served; arrays, an embedded instance
//         TST_Tape               served
//       TST_Broken               abstract; key Id
//         TST_Failing            served; every request fails
//     TST_Link                   served; a key of every kind
//     TST_Alert                  served, without instances
//     TST_Idle                   known, not served
#pragma once

#include "cmpi/registration.h"

const zmlr::Registration* test_registrations(); // the head of the list: TST_Alert was registered last
