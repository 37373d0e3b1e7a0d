// The texts of the drivers' configuration file, taken apart: keys, values, numbers, lists, WWNs.
//
// A null text is an empty one where nothing else is said. Buffers are the caller's.
#pragma once

#include "hxal/records/types.h"

#include <stdio.h>

#ifdef __cplusplus
extern "C"
{
#endif

    // Reads up to and including the next newline, at most `size` - 1 characters, and terminates the line. Returns how many
    // characters that were; 0 at the end of the file and after an error. A NUL in the file is a character like any other.
    int hxal_getline(char* line, int size, FILE* file);

    // Copies a text without the blanks, tabs, double quotes, semicolons and newlines at both ends; one blank when nothing is
    // left. `out` holds the text with its terminator, and 2 characters at least; it may be `in`.
    void hxal_config_filter_space(const char* in, char* out);

    // The key of a line, filtered as above: from behind the first "-" when `start` is '-', else from the beginning, up to the
    // first `end` from there on. Nothing is stored when there is no such `end` or nothing before it. `tmp` receives the key as it
    // stands in the line; both hold what the line holds, and 2 characters at least.
    void hxal_config_get_key(char start, char end, const char* line, char* tmp, char* key);

    // The value of a line, filtered as above: what is behind the first `token`. Nothing is stored when there is none. `tmp`
    // receives the value as it stands in the line; both hold what the line holds, and 2 characters at least.
    void hxal_config_get_data(char token, const char* line, char* tmp, char* value);

    // The decimal number at the end of a text ("hxa12": 12); newlines do not count. 0 without a digit there, INT_MAX when it
    // is larger, -1 without a text.
    int hxal_config_get_num(const char* text);

    // Hexadecimal: the value of one digit, 0 for any other character; the value of a text whose every character is a digit in
    // that sense ("0x1f": 31), behind the digits in `value` already; the value of a text. The last eight digits count.
    unsigned xtod(char digit);
    unsigned HextoDec(const char* text, unsigned value);
    unsigned xstrtoi(const char* text);

    // The bits of the numbers in a list, each modulo 32; the positions of the bits in ascending order, at most `n`, and how
    // many they are.
    uint32_t listtobmp(const int* list, int n);
    int bmptolist(uint32_t bmp, int* list, int n);

    // The WWN of a text like "10:00:00:05:1e:10:00:00": each part between ":" is a byte (its low eight bits), at most 8, the
    // first lowest in memory; bytes without a part are 0.
    wwn_t wwn_convert(const char* text);

#ifdef __cplusplus
}
#endif
