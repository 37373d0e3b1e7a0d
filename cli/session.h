// One run of the program: where its answer goes, and how it asks before it changes what is in use.
//
// The library prints messages of its own to standard output. From the start of a session they go to standard error instead, and
// the answer alone goes where standard output led.
#pragma once

#include "cli/failure.h"
#include "cli/value.h"

#include <chrono>
#include <string>
#include <string_view>

namespace hxa
{

// What every command takes.
struct Common_Options
{
    bool json = false;
    bool yes = false; // ask nothing
};

class Session
{
public:
    explicit Session(const Common_Options& options);
    Session(const Session&) = delete;
    Session& operator=(const Session&) = delete;
    ~Session();

    bool json() const { return _options.json; }

    // Prints the tree as JSON, or else the text. Throws when nobody takes it.
    void answer(const Value& tree, const std::string& text);
    void answer_line(const Value& tree, const std::string& text); // one of many: JSON on one line
    void print(std::string_view text);

    // Tells that something was changed: {"port": "1/0", "action": "speed", "value": "8"}, or "port 1/0: speed 8: done".
    void answer_change(const char* kind, const std::string& element, const std::string& action, const std::string& value = {});

    // Says on the terminal what is about to happen and returns when the answer is yes; "--yes" says it for all questions. Throws
    // when the answer is another one, and when standard input or standard error is no terminal: then nobody can be asked.
    void confirm(const std::string& what_happens);

    // Tells on standard error what could not be read, when the status is not HXA_STATUS_OK; the program then goes on and exits
    // with 1. Returns whether it was read.
    bool accept(hxa_status_t status, const std::string& what);

    // Tells on a terminal how far a command is that takes longer than a second.
    void progress(const std::string& what);

    Exit code() const { return _code; }
    void fail() { _code = Exit::refused; } // the command did its work and what it found is bad

private:
    void clear_progress();

    Common_Options _options;
    int _output = -1;
    std::chrono::steady_clock::time_point _shown = std::chrono::steady_clock::now(); // the last progress, or the start
    bool _progress = false;                                                          // it stands on the terminal
    Exit _code = Exit::done;
};

} // namespace hxa
