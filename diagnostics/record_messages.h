// The messages of diagnostic records: one table of all of them.
#pragma once

#include "runtime/string.h"

namespace zmlr
{

enum diag_record_msg_t : uint32
{
    REC_NONE = 0,
    REC_ADAPTER_CHECKING = 1,
    REC_ADAPTER_NOT_DISABLED = 2,
    REC_ADAPTER_DISABLING = 3,
    REC_ADAPTER_ENABLING = 4,
    REC_MEMORY_RUNNING = 5,
    REC_MEMORY_EVALUATING = 6,
    REC_MEMORY_PASSED = 7,
    REC_MEMORY_FAILED = 8,
    REC_PCI_RUNNING = 9,
    REC_PCI_EVALUATING = 10,
    REC_PCI_PASSED = 11,
    REC_PCI_FAILED = 12,
    REC_LOOPBACK_CHECKING = 13,
    REC_PORT_ALREADY_DISABLED = 14,
    REC_PORT_NOT_DISABLED = 15,
    REC_LOOPBACK_DISABLING = 16,
    REC_LOOPBACK_ENABLING = 17,
    REC_LOOPBACK_RUNNING = 18,
    REC_LOOPBACK_EVALUATING = 19,
    REC_LOOPBACK_PASSED = 20,
    REC_LOOPBACK_FAILED = 21,
    REC_ETH_CHECKING = 22,
    REC_ETH_DISABLING = 23,
    REC_ETH_ENABLING = 24,
    REC_ETH_RUNNING = 25,
    REC_ETH_EVALUATING = 26,
    REC_ETH_PASSED = 27,
    REC_ETH_FAILED = 28,
    REC_PORT_DISABLING = 29,
    REC_PORT_ENABLING = 30,
    REC_PORT_DISABLE_FAILED = 31,
    REC_MEMORY_TAKES_TIME = 32,
    REC_ADAPTER_ALREADY_DISABLED = 33,
    REC_VLAN_CHECKING = 34,
    REC_ETH_ABORTED = 35,
    REC_NO_VLAN = 36,
    REC_UNKNOWN_FAILURE = 37,
};

inline constexpr uint32 REC_MAX_ID = 37;

namespace ProviderUtil
{

// The message's text, for the program's life; "INVALID RECORD ID" for what is no message.
const char* getRecordData(diag_record_msg_t id);

} // namespace ProviderUtil

} // namespace zmlr
