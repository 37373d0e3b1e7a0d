// The configuration model from outside: emptied, which the library never does, and as the library writes it.
#pragma once

#include "hxal/config/internal/state.h"
#include "hxal/config/writer.h"

#include <cstdio>
#include <cstdlib>
#include <memory>
#include <string>
#include <utility>
#include <vector>

inline void empty_model()
{
    const hxal::config::Locked_Model model;
    for (hxal_ioc_config_t& entry : model->iocs)
        while (entry.vport)
            delete std::exchange(entry.vport, entry.vport->next);
    *model = {};
}

// What the library writes of the model, to memory.
inline std::string written()
{
    char* text = nullptr;
    std::size_t size = 0;
    std::FILE* file = ::open_memstream(&text, &size);
    hxal_config_ad_update(file);
    hxal_config_ioc_update(file);
    std::fclose(file);
    const std::unique_ptr<char, decltype(&std::free)> owner(text, std::free);
    return {text, size};
}

// The settings that are written: the lines that are no comment.
inline std::vector<std::string> settings()
{
    std::vector<std::string> lines;
    const std::string text = written();
    for (std::size_t begin = 0, end; (end = text.find('\n', begin)) != text.npos; begin = end + 1)
        if (end > begin && text[begin] != '#')
            lines.push_back(text.substr(begin, end - begin));
    return lines;
}
