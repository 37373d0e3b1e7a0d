#include "cli/session.h"

#include "cli/field_text.h"
#include "cli/json.h"

#include <fcntl.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>
#include <cstring>
#include <iostream>

namespace hxa
{

namespace
{

// A node that the library opens must not get the number of a standard descriptor that the caller has closed: messages would be
// written to it.
void hold_standard_descriptors()
{
    int descriptor = open("/dev/null", O_RDWR | O_CLOEXEC);
    while (descriptor >= 0 && descriptor <= STDERR_FILENO)
        descriptor = open("/dev/null", O_RDWR | O_CLOEXEC);
    close(descriptor);
}

} // namespace

Session::Session(const Common_Options& options) : _options(options), _output(fcntl(STDOUT_FILENO, F_DUPFD_CLOEXEC, 3))
{
    hold_standard_descriptors();
    std::setvbuf(stdout, nullptr, _IOLBF, BUFSIZ);
    dup2(STDERR_FILENO, STDOUT_FILENO);
}

Session::~Session()
{
    std::fflush(stdout);
    close(_output);
}

void Session::answer(const Value& tree, const std::string& text) { print(_options.json ? json_text(tree) : text); }

void Session::answer_line(const Value& tree, const std::string& text) { print(_options.json ? json_line(tree) : text); }

void Session::print(std::string_view text)
{
    clear_progress();
    while (!text.empty())
    {
        const auto written = write(_output, text.data(), text.size());
        if (written < 0 && errno == EINTR)
            continue;
        if (written < 0)
            throw Failure(Exit::refused, std::string("standard output: ") + std::strerror(errno));
        text.remove_prefix(static_cast<std::size_t>(written));
    }
}

void Session::answer_change(const char* kind, const std::string& element, const std::string& action, const std::string& value)
{
    Object tree{{kind, element}, {"action", action}};
    if (!value.empty())
        tree.push_back({"value", safe_text(value)});
    answer(tree, std::string(kind) + ' ' + element + ": " + action + (value.empty() ? "" : ' ' + safe_text(value)) + ": done\n");
}

void Session::confirm(const std::string& what_happens)
{
    if (_options.yes)
        return;
    if (!isatty(STDIN_FILENO) || !isatty(STDERR_FILENO))
        throw Failure(Exit::not_confirmed, what_happens + " Nothing was done: there is no terminal to ask on, and no --yes.");
    std::cerr << what_happens << " Go on? [y/N] " << std::flush;
    std::string answer;
    std::getline(std::cin, answer);
    if (answer != "y" && answer != "Y" && answer != "yes")
        throw Failure(Exit::not_confirmed, "Nothing was done.");
}

bool Session::accept(hxa_status_t status, const std::string& what)
{
    if (status == HXA_STATUS_OK)
        return true;
    clear_progress();
    std::cerr << "hxa: " << what << ": " << status_text(status) << '\n';
    fail();
    return false;
}

void Session::progress(const std::string& what)
{
    const auto now = std::chrono::steady_clock::now();
    if (now - _shown < std::chrono::seconds(1) || !isatty(STDERR_FILENO))
        return;
    clear_progress();
    std::cerr << what << std::flush;
    _shown = now;
    _progress = true;
}

void Session::clear_progress()
{
    if (_progress)
        std::cerr << "\r\x1B[K" << std::flush;
    _progress = false;
}

} // namespace hxa
