#include "sim/simulator.h"

#include "sim/caller_memory.h"
#include "sim/request_check.h"
#include "sim/waits.h"

#include <fcntl.h>
#include <pthread.h>
#include <sys/eventfd.h>

#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <exception>

namespace hxasim
{

namespace
{

constexpr const char* scenario_variable = "HXASIM_SCENARIO";

int make_descriptor(int flags)
{
    int event_flags = ((flags & O_CLOEXEC) != 0 ? EFD_CLOEXEC : 0) | ((flags & O_NONBLOCK) != 0 ? EFD_NONBLOCK : 0);
    int descriptor = eventfd(0, event_flags);
    return descriptor < 0 ? -errno : descriptor;
}

} // namespace

Simulator& simulator()
{
    static Simulator& the_one = *new Simulator;
    return the_one;
}

// A child of a process with threads must not inherit the lock in somebody else's hands.
Simulator::Simulator()
{
    pthread_atfork([] { simulator().lock_for_fork(); }, [] { simulator().unlock_after_fork(); },
                   [] { simulator().unlock_after_fork(); });
}

std::unique_lock<std::mutex> Simulator::locked()
{
    std::unique_lock lock(_mutex);
    if (_state == State::untouched)
        read_environment();
    return lock;
}

void Simulator::read_environment()
{
    _state = State::absent;
    const char* name = secure_getenv(scenario_variable);
    if (!name || *name == '\0')
        return;
    try
    {
        replace_host(std::make_unique<Host>(parse_scenario(read_scenario_file(name))));
    }
    catch (const std::exception& error)
    {
        _state = State::broken;
        std::fprintf(stderr, "hxasim: %s=%s: %s\n", scenario_variable, name, error.what());
    }
}

void Simulator::replace_host(std::unique_ptr<Host> host)
{
    _host = std::move(host);
    ++_host_number;
    _state = _host ? State::loaded : State::absent;
    _journal.clear();
    take_slept();
    _faults.assign(_host ? _host->faults() : std::vector<Fault>());
}

void Simulator::load(Scenario scenario)
{
    auto host = std::make_unique<Host>(std::move(scenario));
    std::lock_guard lock(_mutex);
    replace_host(std::move(host));
}

void Simulator::unload()
{
    std::lock_guard lock(_mutex);
    replace_host(nullptr);
}

std::optional<int> Simulator::open(Node node, int flags)
{
    auto lock = locked();
    if (_state == State::absent)
        return std::nullopt;
    if (_state == State::broken)
        return -ENODEV;
    if (!_host->driver(node).present)
        return -ENOENT;
    int descriptor = make_descriptor(flags);
    if (descriptor >= 0)
        _descriptors.insert_or_assign(descriptor, Descriptor{.node = node, .host_number = _host_number});
    return descriptor;
}

void Simulator::forget(int descriptor)
{
    std::lock_guard lock(_mutex);
    _descriptors.erase(descriptor);
}

int Simulator::request(int descriptor, std::uint32_t code, void* record)
{
    auto lock = locked();
    auto found = _descriptors.find(descriptor);
    if (found == _descriptors.end())
        return EBADF;
    if (found->second.host_number != _host_number)
        return ENODEV;
    Journal_Entry entry{.node = found->second.node, .code = code, .slept = take_slept()};
    entry.error = answer(found->second, entry, record);
    int error = entry.error;
    _journal.add(std::move(entry));
    return error;
}

int Simulator::violate(const Journal_Entry& entry, int error, const std::string& why)
{
    std::array<char, 16> code{};
    std::snprintf(code.data(), code.size(), "0x%08X", entry.code);
    auto text = std::string(path_of(entry.node)) + " " + (entry.name.empty() ? code.data() : std::string(entry.name));
    if (entry.instance >= 0)
        text += " instance " + std::to_string(entry.instance);
    _journal.add_violation(text + ": " + why);
    return error;
}

int Simulator::answer(Descriptor& descriptor, Journal_Entry& entry, void* record)
{
    auto identified = identify(descriptor.node, entry.code);
    if (identified.command)
        entry.name = identified.command->name;
    entry.sent.resize(record_size(entry.code));
    if (!copy_from_caller(entry.sent, record))
    {
        entry.sent.clear();
        if (identified.error == 0)
            return violate(entry, EFAULT, "bad address");
    }
    if (identified.error != 0)
        return violate(entry, identified.error, identified.why);
    return answer_identified(descriptor, entry, *identified.command, record);
}

int Simulator::answer_identified(Descriptor& descriptor, Journal_Entry& entry, const hxal::Command& command, void* record)
{
    const Row* row = row_of(command);
    if (!row)
        return violate(entry, ENOTTY, "not simulated");
    entry.instance = instance_of(*row, entry.sent);
    if (auto dirt = find_dirt(*row, entry.sent); !dirt.empty())
        return violate(entry, EINVAL, dirt);
    Call call{.host = *_host, .descriptor = descriptor, .ioc = nullptr};
    if (row->target == Target::ioc)
    {
        call.ioc = _host->find(descriptor.node, static_cast<std::uint32_t>(entry.instance));
        if (!call.ioc)
            return violate(entry, ENODEV, "no such instance");
    }
    return answer_row(call, *row, entry, record);
}

int Simulator::answer_row(Call& call, const Row& row, Journal_Entry& entry, void* record)
{
    const Fault* fault = _faults.strike(row, entry.node, entry.instance);
    if (fault && fault->error != 0)
        return fault->error;
    auto answered = entry.sent;
    if (fault && fault->status != 0)
        std::memcpy(&answered[*row.status], &fault->status, sizeof(fault->status));
    else
        row.answer(call, answered);
    if (call.error != 0)
        return violate(entry, call.error, call.why);
    if (fault)
        overwrite(fault->answer, answered);
    if (!copy_to_caller(record, answered))
        return violate(entry, EFAULT, "bad address");
    entry.answered = std::move(answered);
    return 0;
}

std::uint64_t Simulator::request_count()
{
    const auto lock = locked();
    return _journal.count();
}

std::vector<Request> Simulator::take_requests()
{
    auto lock = locked();
    return _journal.take();
}

void Simulator::inject(const Fault& fault)
{
    check_fault(fault, "fault");
    auto lock = locked();
    _faults.add(fault);
}

void Simulator::clear_faults()
{
    auto lock = locked();
    _faults.clear();
}

std::vector<std::string> Simulator::violations()
{
    auto lock = locked();
    return _journal.violations();
}

int Simulator::open_descriptors()
{
    auto lock = locked();
    return static_cast<int>(_descriptors.size());
}

} // namespace hxasim
