// The drivers at work: the loaded host, the open descriptors, the faults and the journal, behind one lock.
#pragma once

#include "sim/driver/fault_list.h"
#include "sim/driver/journal.h"
#include "sim/hxasim.h"
#include "sim/model/host.h"
#include "sim/model/host_summary.h"
#include "sim/scenario/scenario.h"

#include <map>
#include <memory>
#include <mutex>

namespace hxasim
{

class Simulator
{
public:
    // Opens a node with the flags of open(): a descriptor, a negated errno, or none when the system's own node is meant.
    std::optional<int> open(Node node, int flags);

    // Answers a request: 0 or an errno. `slept` is how long the process asked to sleep since the request before.
    int request(int descriptor, std::uint32_t code, void* record, std::chrono::nanoseconds slept);

    void forget(int descriptor); // it is about to be closed

    // Throws std::runtime_error for a fault that could never do what it says, here and below.
    void load(Scenario scenario);
    void unload();
    std::vector<Request> take_requests();
    std::uint64_t request_count();
    std::size_t remembered_requests();
    void inject(const Fault& fault, const std::string& place = "fault");
    void clear_faults();
    std::vector<std::string> violations();
    int open_descriptors();
    void raise_event(const Event& event);
    std::uint64_t lost_events(std::uint32_t application);
    void plug(std::size_t adapter, bool plugged);
    void link(std::size_t adapter, std::size_t port, bool up);
    void sfp(std::size_t adapter, std::size_t port, bool inserted);
    std::vector<Card_Summary> cards();
    std::size_t fault_count();

    // A child of a process with threads must not inherit the lock in somebody else's hands.
    void before_fork() { _mutex.lock(); }
    void after_fork_in_parent() { _mutex.unlock(); }
    void after_fork_in_child();

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
    void replace_host(std::unique_ptr<Host> host, const std::vector<Fault>& faults);
    Descriptor* find(int descriptor); // null when it is not open on the present host
    Host& loaded_host();              // throws without one
    Adapter& adapter(std::size_t number);
    Port& port(std::size_t adapter_number, std::size_t number);
    const Row* accept(Journal_Entry& entry, const void* record);
    int answer(std::unique_lock<std::mutex>& lock, int descriptor, Journal_Entry& entry, void* record);
    int answer_row(Call& call, const Row& row, const std::optional<Fault>& fault, Journal_Entry& entry, void* record);
    int violate(const Journal_Entry& entry, int error, const std::string& why);
    bool has_events(const Descriptor& descriptor) const;
    void show_news(); // makes nodes readable or not, when that has changed
    void show_events();

    std::mutex _mutex;
    State _state = State::untouched;
    std::unique_ptr<Host> _host;
    std::uint64_t _host_number = 0;
    std::map<int, Descriptor> _descriptors;
    Fault_List _faults;
    Journal _journal;
};

} // namespace hxasim
