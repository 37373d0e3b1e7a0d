// ProviderInit: the probe that initialises the access library and looks for adapters when the module is loaded.
#pragma once

namespace zmlr
{

enum Driver_Status : int
{
    DRIVER_GOOD = 0,        // adapters found
    DRIVER_FAILURE = 1,     // no adapter, but the library works
    DRIVER_MISSING = 2,     // no driver
    DRIVER_VERSION_FAIL = 3 // library and driver versions differ
};

// One static object, made when the module is loaded; its status never changes afterwards.
class ProviderInit
{
public:
    // What the probe found. Safe in static initialisers too, in any order: the first caller makes the object.
    static Driver_Status getDriverStatus();

private:
    ProviderInit();

    const Driver_Status _driver_status;
};

} // namespace zmlr
