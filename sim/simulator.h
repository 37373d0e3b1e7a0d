// The one simulator of the process: the loaded host, the open descriptors, the faults and the journal, behind one lock.
#pragma once

#include "sim/fault_list.h"
#include "sim/host.h"
#include "sim/journal.h"

#include <map>
#include <memory>
#include <mutex>

namespace hxasim
{

class Simulator
{
public:
    Simulator();
    ~Simulator() = delete; // lives as long as the process: other threads may still send requests while it exits

    // Opens a node with the flags of open(): a descriptor, a negated errno, or none when the system's own node is meant.
    std::optional<int> open(Node node, int flags);

    // Answers a request: 0 or an errno.
    int request(int descriptor, std::uint32_t code, void* record);

    void forget(int descriptor); // it is about to be closed

    void load(Scenario scenario);
    void unload();
    std::vector<Request> take_requests();
    std::uint64_t request_count();
    void inject(const Fault& fault);
    void clear_faults();
    std::vector<std::string> violations();
    int open_descriptors();

    void lock_for_fork() { _mutex.lock(); }
    void unlock_after_fork() { _mutex.unlock(); }

private:
    enum class State : std::uint8_t
    {
        untouched,
        absent,
        broken,
        loaded
    };

    std::unique_lock<std::mutex> locked(); // reads the environment at the first use
    void read_environment();
    void replace_host(std::unique_ptr<Host> host);
    int answer(Descriptor& descriptor, Journal_Entry& entry, void* record);
    int answer_identified(Descriptor& descriptor, Journal_Entry& entry, const hxal::Command& command, void* record);
    int answer_row(Call& call, const Row& row, Journal_Entry& entry, void* record);
    int violate(const Journal_Entry& entry, int error, const std::string& why);

    std::mutex _mutex;
    State _state = State::untouched;
    std::unique_ptr<Host> _host;
    std::uint64_t _host_number = 0;
    std::map<int, Descriptor> _descriptors;
    Fault_List _faults;
    Journal _journal;
};

Simulator& simulator();

} // namespace hxasim
