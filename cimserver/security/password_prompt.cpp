#include "cimserver/security/password_prompt.h"

#include "cimserver/security/password_hash.h"

#include <termios.h>
#include <unistd.h>

#include <csignal>
#include <cstdio>
#include <stdexcept>

namespace cimserver
{
namespace
{

volatile std::sig_atomic_t interrupted = 0;

void note_signal(int signal) { interrupted = signal; }

// No echo for a scope. A signal that would end the program ends the reading first, so that the echo comes back.
class Silent_Terminal
{
public:
    Silent_Terminal()
    {
        struct sigaction action = {};
        action.sa_handler = note_signal; // without SA_RESTART: read() returns
        for (const int signal : {SIGINT, SIGTERM, SIGHUP, SIGQUIT})
            sigaction(signal, &action, nullptr);
        tcgetattr(STDIN_FILENO, &_before);
        termios silent = _before;
        silent.c_lflag &= static_cast<tcflag_t>(~ECHO);
        silent.c_cc[VSUSP] = _POSIX_VDISABLE;
        tcsetattr(STDIN_FILENO, TCSAFLUSH, &silent);
    }
    ~Silent_Terminal()
    {
        tcsetattr(STDIN_FILENO, TCSAFLUSH, &_before);
        std::fputc('\n', stderr);
    }
    Silent_Terminal(const Silent_Terminal&) = delete;
    Silent_Terminal& operator=(const Silent_Terminal&) = delete;

private:
    termios _before{};
};

// Byte by byte: nothing of the password stays in a buffer of the library.
std::string read_line()
{
    std::string line;
    char c = 0;
    while (!interrupted && read(STDIN_FILENO, &c, 1) == 1 && c != '\n')
        if (line.size() <= max_password_bytes)
            line.push_back(c);
    return line;
}

// Silent before it asks: what is typed earlier is dropped.
std::string ask(const char* prompt)
{
    const Silent_Terminal silent;
    std::fputs(prompt, stderr);
    return read_line();
}

std::string ask_twice()
{
    const std::string password = ask("Password: ");
    const std::string again = interrupted ? "" : ask("The same again: ");
    if (interrupted)
        throw std::runtime_error("interrupted");
    if (password != again)
        throw std::runtime_error("the two passwords differ");
    return password;
}

} // namespace

std::string ask_password() { return isatty(STDIN_FILENO) ? ask_twice() : read_line(); }

} // namespace cimserver
