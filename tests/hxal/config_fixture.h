// A test on the configuration model: it starts empty, and files go to a directory of its own.
#pragma once

#include "config_model.h"
#include "hxal/hxal.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <initializer_list>
#include <iterator>
#include <vector>

class Config_Model : public testing::Test
{
protected:
    Config_Model() { empty_model(); }
    ~Config_Model() override
    {
        empty_model();
        std::filesystem::remove_all(directory);
    }

    static const hxal_ioc_config_t& ioc(int idx) { return hxal_config_get()->iocs[idx]; }
    static const hxal_ad_config_t& adapter(int idx) { return hxal_config_get()->adapters[idx]; }
    static bool has(const uint32_t (&flags)[4], int code) { return hxal::config::has(flags, code); }

    static void parse(std::initializer_list<const char*> lines)
    {
        for (const char* line : lines)
            hxal_config_parse(line);
    }

    std::string path(const std::string& name) const { return directory / name; }

    std::string file(const std::string& name, const std::string& content) const
    {
        std::ofstream(path(name), std::ios::binary) << content;
        return path(name);
    }

    static std::string content(const std::string& path)
    {
        std::ifstream stream(path, std::ios::binary);
        return {std::istreambuf_iterator<char>(stream), {}};
    }

    std::vector<std::string> names() const
    {
        std::vector<std::string> found;
        for (const auto& entry : std::filesystem::directory_iterator(directory))
            found.push_back(entry.path().filename());
        return found;
    }

    // Loads what a file of this content says.
    void load(const std::string& text) const { hxal_config_load(file("hxa.conf", text).c_str()); }

private:
    static std::filesystem::path make_directory()
    {
        std::string name = std::filesystem::temp_directory_path() / "hxal_config.XXXXXX";
        return ::mkdtemp(name.data()) ? name : "";
    }

    const std::filesystem::path directory = make_directory();
};
