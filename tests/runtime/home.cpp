#include "tests/runtime/home.h"

#include <cstdlib>
#include <fstream>
#include <sys/wait.h>
#include <unistd.h>

namespace sample
{

int Home::start(const std::function<void()>& work, bool with_home) const
{
    const pid_t pid = fork();
    if (pid != 0)
        return pid;
    if (with_home)
        setenv("HOME", _folder.folder.c_str(), 1);
    else
        unsetenv("HOME");
    work();
    _exit(0);
}

bool Home::finish(int pid)
{
    int status = -1;
    return waitpid(pid, &status, 0) == pid && status == 0;
}

std::vector<std::string> Home::lines() const
{
    std::ifstream file(path(".cimple/messages"));
    std::vector<std::string> result;
    for (std::string line; std::getline(file, line);)
        result.push_back(file.eof() ? line + "(no newline)" : line);
    return result;
}

} // namespace sample
