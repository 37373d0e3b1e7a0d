// The adapter access library: everything a program needs to reach the FC host bus adapters and converged network
// adapters of this host through their kernel drivers, from C11 or C++.
//
//     hxal_libinit(hxa_aen_app_cim);
//     int count = hxal_adapter_scan();
//     if (count == 0)
//         fprintf(stderr, "no adapters: %s\n", hxal_status_to_string((int)hxal_get_last_error()));
//     for (int ad = 1; ad <= count; ++ad)
//         puts(hxal_adapter_open_idx(ad)->model_descr);
//     hxal_libexit();
//
// A client calls hxal_libinit() once, then hxal_adapter_scan(), which also scans the I/O controllers (IOCs), and at the
// end hxal_libexit(). When the scan answers 0, hxal_get_last_error() tells why: HXA_STATUS_NO_DRIVER (no driver node could
// be opened), HXA_STATUS_VERSION_FAIL (the driver refused this library), anything else: a general failure. A scan clears no
// earlier error; set HXA_STATUS_OK before it. When that is still there, the drivers answer and serve nothing, or one of them
// counts an IOC that its bitmap of instances lacks: then hxal_ioc_get_num() is more than the handles of hxal_ioc_get_list(),
// which can be used all the same.
//
// An installed library is compiled and linked with as `pkg-config --cflags --libs hxal` prints. Without hardware the simulated
// drivers answer; hxal/README.md of the sources tells how to try that.
//
// Statuses.  A request returns HXA_STATUS_OK or says what failed: the call to the driver (a status mapped from errno; the
//            caller's buffer is untouched, but for hxal_ioc_get_info()'s) or the driver itself (its own status, unchanged;
//            the buffer is filled all the same). No request is repeated, also not an interrupted one (HXA_STATUS_EINTR). A
//            null pointer where a request needs a handle or a buffer is HXA_STATUS_EINVAL, without a request.
// Ownership. The library owns every handle, adapter record and text it returns. They stay valid until the next scan.
// Look-ups.  A null or out-of-range argument finds nothing; each look-up names its answer for "none". Texts are compared
//            byte by byte: "Blue" is not "blue".
// Texts.     A driver's text that fills its field loses its last character to the terminator, but for a serial number, which
//            keeps all 12. Looked up is what the field holds: the driver's whole text finds it, and so does the cut one.
//            In what a request copies out (attributes, names), a text is as the driver left it: it may fill its field without
//            a terminator.
// Threads.   No list is locked. Requests and look-ups may run on any number of threads, but the calls that store what
//            they read or set (hxal_adapter_get_name, hxal_adapter_set_name, hxal_adapter_update_ioc, hxal_ioc_set_name,
//            hxal_ioc_get_current_mac) one at a time for an adapter or handle, and a scan alone: it replaces what the others
//            are looking at. Enabling and disabling an IOC or adapter takes seconds.
// Settings.  What a driver accepts lasts until it is reloaded. It is also recorded in the model of the drivers' configuration
//            file (hxal/config/model.h, which has a lock of its own); hxal_libsync() makes it last.
// Messages.  The few messages of the library go to standard output.
#pragma once

#include "hxal/adapter.h"
#include "hxal/aen.h"
#include "hxal/boot.h"
#include "hxal/config/model.h"
#include "hxal/config/parser.h"
#include "hxal/config/setters.h"
#include "hxal/config/syntax.h"
#include "hxal/config/writer.h"
#include "hxal/diag.h"
#include "hxal/ethport.h"
#include "hxal/fcoe.h"
#include "hxal/fcpt.h"
#include "hxal/flash.h"
#include "hxal/ioc.h"
#include "hxal/iocfc.h"
#include "hxal/itnim.h"
#include "hxal/library.h"
#include "hxal/lport.h"
#include "hxal/port.h"
#include "hxal/rport.h"
#include "hxal/scsi.h"
#include "hxal/sfp.h"
#include "hxal/statistics.h"
#include "hxal/value_names.h"
