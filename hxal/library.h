// The library itself: start and end, the last error, status messages, checksums.
#pragma once

#include "hxal/records/status.h"
#include "hxal/records/types.h"

#ifdef __cplusplus
extern "C"
{
#endif

    // Stores the identity under which the driver queues events for this program. Returns 0. Opens nothing.
    int hxal_libinit(hxa_aen_app_t app);

    // Ends the use of the library. There is nothing to release.
    void hxal_libexit(void);

    // From now on the end of the process leaves the handles and adapters of the last scan alone: a thread that still runs then
    // may use them. For a program, or a module that is never unloaded.
    void hxal_libkeep(void);

    // The drivers' configuration file, "/etc/hxa.conf": reads it into the model (hxal/config/model.h), writes it from there,
    // ends the use of the model. A client scans, then loads, then changes settings and syncs;
    // whoever never syncs changes the drivers only. Loading answers HXA_STATUS_OK, also where there is no file. How writing went
    // is not told here: hxal_config_sync() does. Ending keeps the model: a later client of the process finds it.
    hxa_status_t hxal_libload(void);
    void hxal_libsync(void);
    void hxal_libunload(void);

    // The last error, one cell for the process: the scans and the adapter naming set it, nothing clears it. The last writer
    // wins, so read it right after the call that failed.
    void hxal_set_last_error(hxa_status_t status);
    hxa_status_t hxal_get_last_error(void);

    // The message text of a status, ending in one blank; "Unknown Failure" for every number that is no status.
    const char* hxal_status_to_string(int code);

    // The status that stands for an errno value; HXA_STATUS_FAILED for those without one of their own.
    hxa_status_t hxal_get_status(int error);

    // The byte that makes the sum of all bytes and itself 0 modulo 256. 0 for no bytes.
    uint32_t hxal_checksum_u8(const uint8_t* bytes, uint32_t count);

    // The exclusive-or of the 32-bit words in `size` bytes; up to three bytes left over do not count.
    uint32_t hxa_checksum_u32(const uint32_t* words, int size);

#ifdef __cplusplus
}
#endif
