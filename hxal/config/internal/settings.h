// The settings of the configuration file: their keys, and how a value is read and written. One table for parser and writer.
#pragma once

#include "hxal/config/internal/state.h"

#include <cstdio>
#include <string_view>

namespace hxal::config
{

// How one setting's value stands in the file.
struct Form
{
    // Stores what a text says. False when it is none of the setting's words; then the entry is as it was.
    bool (*store)(Ioc_Entry& entry, std::string_view text);

    // Writes the line "<key> = <value>;\n"; nothing when the value has no word.
    void (*write)(std::FILE* file, const char* key, const Ioc_Entry& entry);
};

// What becomes of a key without instance.
enum class For_All
{
    unknown,
    read,    // stored into the entries and written per instance; as it was read where it reached none
    written, // and written for all
};

struct Setting
{
    hxal_config_code_t code;
    const char* prefix; // of the key with an instance: "hxa" or "hxn"
    const char* key;
    For_All for_all;
    Form form;
};

// The IOC setting with this code, or with this key and prefix, or with this key for all instances; none: null. Virtual ports
// are no setting of one value.
const Setting* setting_of(int code);
const Setting* setting_with(std::string_view prefix, std::string_view key);
const Setting* setting_for_all(std::string_view key);

// Stores the value of an IOC setting, or of any, into an entry and marks it present, or absent when the text is none of the
// setting's words. False then, and when there is no such setting or entry.
bool store(hxal_config_t& model, const Setting& setting, int idx, std::string_view text);
bool store(hxal_config_t& model, int code, int idx, std::string_view text);

// Gives a setting, or the power state, to all entries so far and remembers it. What is none of the setting's words is absent
// there.
void store_for_all(hxal_config_t& model, int code, std::string_view text);

// Before a setter looks at a setting that was given for all: gives it to the entries that have come since and have none of their
// own. What no entry can have is given up.
void spread_for_all(hxal_config_t& model, int code);

// Writes a text of at most `size` characters. A control character other than a tab would end the line or hide in it.
void write_text(std::FILE* file, const char* text, std::size_t size);

} // namespace hxal::config
