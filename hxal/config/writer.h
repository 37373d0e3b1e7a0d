// Writing the model to the drivers' configuration file.
//
// The file is written whole. What the parser ignored, comments and the numbers that tune the drivers are not in it. A setting
// that was given for all instances is written once, with the value of entry 0; any other once for every entry that has it. What
// was given for all when there was no entry yet is written as it was read, and beside it what entries have of their own. A
// control character in a text, other than a tab, is written as "?", so that a line stays one line; a value for which the file
// has no word is left out.
#pragma once

#include "hxal/config/model.h"

#include <stdio.h>

#ifdef __cplusplus
extern "C"
{
#endif

    // Replaces the file by what the model holds: writes a temporary file in the same directory, flushes it to the disk, gives it
    // the owner and the mode of the old file (0600 when there is none) and renames it over the old one, so that a crash or a full
    // disk never loses the old file. A link to the file is followed and stays; a link to what a process has open, like
    // "/dev/stdout", names no file.
    //     HXA_STATUS_EFOPEN  the file cannot be opened for writing: no such directory, no permission, no regular file
    //     HXA_STATUS_ENOMEM  out of memory
    //     HXA_STATUS_FAILED  it cannot be written: no space left, the process may not write as much (RLIMIT_FSIZE; no SIGXFSZ
    //                        follows), or the owner cannot be kept
    // In all cases the old file is as it was and no temporary file stays behind. Two writers at once each write a whole file;
    // the last one stays.
    hxa_status_t hxal_config_sync(const char* path);

    // Does nothing: the model is kept.
    void hxal_config_unload(void);

    // The two parts of the file, to any stream: the adapters, and the IOCs. The first makes the next adapter line that is read
    // fill entry 0 again.
    void hxal_config_ad_update(FILE* file);
    void hxal_config_ioc_update(FILE* file);

    // The virtual port lines of IOC entry `idx`.
    void vport_traverse(FILE* file, int idx);

#ifdef __cplusplus
}
#endif
