// A home directory of a test's own, and processes that log into it.
#pragma once

#include "tests/support/temporary_folder.h"

#include <functional>
#include <string>
#include <vector>

namespace sample
{

class Home
{
public:
    void options(const std::string& text) const { _folder.file(".cimplerc", text); }
    std::string path(const std::string& name) const { return _folder.path(name); }
    bool has(const std::string& name) const { return std::filesystem::exists(path(name)); }

    // Starts a process that does the work with this home (or with HOME unset) and ends; the log of each process is fresh.
    int start(const std::function<void()>& work, bool with_home = true) const;

    // Waits for a process: whether the work was done.
    static bool finish(int pid);
    bool run(const std::function<void()>& work) const { return finish(start(work)); }

    // The log's lines without their newlines; an incomplete last line comes with "(no newline)".
    std::vector<std::string> lines() const;

private:
    const Temporary_Folder _folder{};
};

} // namespace sample
