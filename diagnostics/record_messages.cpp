#include "diagnostics/record_messages.h"

#include "runtime/log.h"
#include "runtime/trace.h"

#include <iterator>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "ProviderUtil";

// clang-format off
constexpr const char* diagRecordMsgArray[] = {
    /*  0 */ "--",
    /*  1 */ "Checking whether the adapter is disabled for running memory test",
    /*  2 */ "Adapter is not disabled",
    /*  3 */ "Disabling the adapter for running memory test",
    /*  4 */ "Enabling the adapter after running memory test",
    /*  5 */ "Running memory test on the adapter",
    /*  6 */ "Checking for return codes for memory test run",
    /*  7 */ "Memory test run is successful",
    /*  8 */ "Memory test failed",
    /*  9 */ "Running PCI Loopback test for the port",
    /* 10 */ "Checking for return codes for PCI Loopback test run",
    /* 11 */ "PCI Loopback test run is successful",
    /* 12 */ "PCI Loopback test failed",
    /* 13 */ "Checking whether the port is disabled for running loopback test",
    /* 14 */ "Port is already disabled",
    /* 15 */ "Port is not disabled",
    /* 16 */ "Disabling the port for running loopback test",
    /* 17 */ "Enabling the port after running loopback test",
    /* 18 */ "Running loopback test for the port",
    /* 19 */ "Checking for return codes for loopback test run",
    /* 20 */ "Loopback test run is successful",
    /* 21 */ "Loopback test failed",
    /* 22 */ "Checking whether the port is disabled for running eth loopback test",
    /* 23 */ "Disabling the port for running eth loopback test",
    /* 24 */ "Enabling the port after running eth loopback test",
    /* 25 */ "Running eth loopback test for the port",
    /* 26 */ "Checking for return codes for eth loopback test run",
    /* 27 */ "Eth loopback test run is successful",
    /* 28 */ "Eth loopback test failed",
    /* 29 */ "Disabling the port",
    /* 30 */ "Enabling the port",
    /* 31 */ "Failed to disable the port",
    /* 32 */ "Running memory test may take a few moments",
    /* 33 */ "Adapter is already disabled",
    /* 34 */ "Checking whether VLAN is configured on the given eth port for running eth loopback test",
    /* 35 */ "Eth loopback test aborted",
    /* 36 */ "No VLAN is configured on the given eth port. Create VLAN either through Tessik or Quillon for running eth loopback test",
    /* 37 */ "Unknown failure",
};
// clang-format on
static_assert(std::size(diagRecordMsgArray) == REC_MAX_ID + 1);

} // namespace

const char* ProviderUtil::getRecordData(diag_record_msg_t id)
{
    const Scope_Trace trace(log_source);
    if (id <= REC_MAX_ID)
        return diagRecordMsgArray[id];
    ZMLR_LOG(LL_ERR, "Record ID is greater than REC_MAX_ID");
    return "INVALID RECORD ID";
}

} // namespace zmlr
