// What the test module lets a test see and decide, through its function "recorded_calls".
#pragma once

#include <string>
#include <vector>

namespace test
{

struct Recorded_Calls
{
    std::vector<std::string> calls;
    std::string failing; // calls that begin with this fail
};

} // namespace test
