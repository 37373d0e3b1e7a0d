// What is expected, or goes in, where that is a long text: a file in the folder "golden".
#pragma once

#include "tests/support/temporary_folder.h"

#include <gtest/gtest.h>

inline std::string golden(const std::string& name)
{
    const std::string text = Temporary_Folder::content(std::string(GOLDEN) + "/" + name);
    EXPECT_FALSE(text.empty()) << name;
    return text;
}
