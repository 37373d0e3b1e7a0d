#include "tests/runtime/home.h"

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <sys/wait.h>
#include <unistd.h>

namespace sample
{

Home::Home()
{
    char name[] = "/tmp/zmlr-home-XXXXXX";
    _path = mkdtemp(name);
}

Home::~Home() { std::filesystem::remove_all(_path); }

void Home::options(const std::string& text) const { std::ofstream(path(".cimplerc")) << text; }

bool Home::has(const std::string& name) const { return std::filesystem::exists(path(name)); }

int Home::start(const std::function<void()>& work, bool with_home) const
{
    const pid_t pid = fork();
    if (pid != 0)
        return pid;
    if (with_home)
        setenv("HOME", _path.c_str(), 1);
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
    const std::string text{std::istreambuf_iterator<char>(file), {}};
    std::vector<std::string> result;
    for (std::size_t begin = 0; begin < text.size();)
    {
        const std::size_t end = text.find('\n', begin);
        result.push_back(end == std::string::npos ? text.substr(begin) + "(no newline)" : text.substr(begin, end - begin));
        begin = end == std::string::npos ? text.size() : end + 1;
    }
    return result;
}

} // namespace sample
