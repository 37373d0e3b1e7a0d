// A test on the configuration model: it starts empty, and files go to a folder of its own.
#pragma once

#include "config_model.h"
#include "hxal/hxal.h"
#include "tests/support/temporary_folder.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <initializer_list>
#include <vector>

class Config_Model : public testing::Test, protected Temporary_Folder
{
protected:
    Config_Model() { empty_model(); }
    ~Config_Model() override { empty_model(); }

    static const hxal_ioc_config_t& ioc(int idx) { return hxal_config_get()->iocs[idx]; }
    static const hxal_ad_config_t& adapter(int idx) { return hxal_config_get()->adapters[idx]; }
    static bool has(const uint32_t (&flags)[4], int code) { return hxal::config::has(flags, code); }

    static void parse(std::initializer_list<const char*> lines)
    {
        for (const char* line : lines)
            hxal_config_parse(line);
    }

    std::vector<std::string> names() const
    {
        std::vector<std::string> found;
        for (const auto& entry : std::filesystem::directory_iterator(folder))
            found.push_back(entry.path().filename());
        return found;
    }

    // Loads what a file of this content says.
    void load(const std::string& text) const { hxal_config_load(file("hxa.conf", text).c_str()); }
};
