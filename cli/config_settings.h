// The settings of a port in the drivers' configuration file: their names on the command line and their values.
#pragma once

#include "cli/value.h"
#include "hxal/config/model.h"

#include <span>
#include <string>

namespace hxa
{

struct Setting
{
    const char* name;   // as in the file
    int code;           // hxal_config_code_t
    const char* values; // what it takes, for people
    std::uint32_t most; // of a number; 0: it is a word, a list or a text
    Value (*show)(const hxal_ioc_config_t& entry);
};

std::span<const Setting> settings();

// Throws when there is none with this name.
const Setting& setting_named(const std::string& name);

// Throws when a number is expected and the text is none, or too large: the file's grammar would take it for 0. A word that is
// none of the setting's is told by the grammar itself.
void check_value(const Setting& setting, const std::string& value);

} // namespace hxa
