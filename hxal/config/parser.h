// Reading the drivers' configuration file into the model.
//
// A line is one setting: a key, "=", a value. Blanks, tabs, double quotes, semicolons and newlines around either do not count.
//
//     adapter-<serial>-name = "Blue";     an adapter's setting: "name" or "power"
//     hxa3-port-speed = 8;                a setting of the FC port of instance 3
//     hxn3-port-name = "eth";             a setting of the Ethernet port of instance 3: "port-mac" or "port-name"
//     port-speed = 4;                     a setting of all instances so far, or a number that tunes the drivers
//     # anything                          a comment
//
// What a line is decides the first that fits: it contains "adapter" and "-", "hxa" and "-", "hxn" and "-", none of them. A
// line that is none of these, an unknown key and an instance beyond 127 are ignored. The instance is the number that stands right
// before the first "-": "hxa1 -" has none there, which is 0. A number that does not parse, or that its
// field cannot hold, is 0; a word that is none of the setting's makes the setting absent: given for all instances it takes the
// setting from the entries that it reaches, and is written back as it was read. "port-name" for all is that of the FC ports.
#pragma once

#include "hxal/config/model.h"

#ifdef __cplusplus
extern "C"
{
#endif

    // Scan first (hxal_adapter_scan()): a key without instance reaches the entries that exist when it is read, which are those of
    // the scanned cards and FC ports and of the lines before it. What is loaded before a scan is kept as it was read, and reaches
    // the ports when a setter touches the setting.
    //
    // Reads a file into the model, in lines of at most 511 characters; what is longer counts as further lines. Returns
    // HXA_STATUS_OK always: what cannot be opened, or is no regular file, leaves the model as it was. Of a file that grows
    // meanwhile only what was there at first is read, and no more than 16 MiB of any.
    hxa_status_t hxal_config_load(const char* path);

    // One line, terminated, of any length. Every line of the kind "adapter-..." fills a further adapter entry, also for a
    // serial number that has one already; beyond 128 they are ignored. The entries are filled from 0 on, over those that a scan
    // has made: a card that loses its entry so has its settings recorded again after the next scan.
    void hxal_config_parse(const char* line);

    // Stores a value, which is the text behind "=", into entry `idx`: adapter settings 0 to 2, IOC settings 3 to 33, except
    // virtual ports. Any other setting or index, and a null value, do nothing.
    void hxal_config_set_data(int code, int idx, const void* value);

    // Stores a virtual port into IOC entry `idx`: "pwwn, nwwn, symname, roles [, vf_id]"; without a pwwn nothing happens. A
    // port with that pwwn is replaced and keeps its number; a new one is appended with the lowest free number. (The parser
    // gives both the number in the key, where it has one.) Nothing happens when memory is short or 255 are there.
    void hxal_config_set_vportdata(int idx, const char* line);

#ifdef __cplusplus
}
#endif
