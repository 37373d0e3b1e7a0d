// The rows of a table that is a file: fields between tabs; lines that are empty or begin with "#" do not count.
#pragma once

#include <gtest/gtest.h>

#include <fstream>
#include <string>
#include <vector>

inline std::vector<std::vector<std::string>> rows_of(const std::string& file)
{
    std::vector<std::vector<std::string>> rows;
    std::ifstream lines(TEST_TABLES "/" + file);
    for (std::string line; std::getline(lines, line);)
    {
        if (line.empty() || line[0] == '#')
            continue;
        std::vector<std::string> fields(1);
        for (const char c : line)
            c == '\t' ? fields.emplace_back() : fields.back() += c;
        rows.push_back(fields);
    }
    EXPECT_FALSE(rows.empty()) << file;
    return rows;
}
