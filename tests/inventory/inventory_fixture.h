// A host with simulated adapters, a log of its own, and instances as texts.
#pragma once

#include "runtime/instance.h"
#include "tests/inventory/fake_host.h"
#include "tests/support/simulated_host.h"

#include <string>
#include <vector>

namespace zmlr
{

// The program's log level is LL_DBG; its home is a new directory that is removed at the end. Its driver gate is what the scenario
// in HXASIM_SCENARIO ("mixed" when unset) made it when the program was loaded.
class Inventory_Test : public Simulated_Host
{
protected:
    void SetUp() override;

    void plug_text(const std::string& json); // replaces the host ("mixed" at first) and scans it

    std::vector<std::string> log(bool entries = false); // "LEVEL Source: message", since the last call, without exits

private:
    void scan();
};

// The class name, then a line for each property that is not null, in the order of the class.
std::string describe(const Instance* instance);

// A property in the form that describe() gives it; empty when it is null.
std::string value_of(const Instance* instance, const char* property);
std::vector<std::string> values_of(const Instance_Array& instances, const char* property);

} // namespace zmlr
