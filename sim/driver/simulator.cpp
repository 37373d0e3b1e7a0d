#include "sim/driver/simulator.h"

#include "sim/commands/caller_memory.h"
#include "sim/commands/request_check.h"
#include "sim/driver/event_descriptor.h"
#include "sim/driver/fault_effects.h"
#include "sim/model/state_changes.h"

#include <fcntl.h>
#include <sys/syscall.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <exception>

namespace hxasim
{

namespace
{

constexpr const char* scenario_variable = "HXASIM_SCENARIO";

// The system's own wait: the driver's time is not the product's, which a test may shorten.
void wait(std::chrono::milliseconds time)
{
    timespec left{.tv_sec = time.count() / 1000, .tv_nsec = time.count() % 1000 * 1'000'000};
    while (syscall(SYS_clock_nanosleep, CLOCK_MONOTONIC, 0, &left, &left) != 0 && errno == EINTR)
        ;
}

Scenario checked(Scenario scenario)
{
    for (std::size_t i = 0; i < scenario.faults.size(); ++i)
        check_fault(scenario.faults[i], "faults[" + std::to_string(i) + "]");
    return scenario;
}

std::unique_ptr<Host> make_host(Scenario& scenario)
{
    return std::make_unique<Host>(scenario.drivers, std::move(scenario.adapters));
}

} // namespace

// Both processes have the same open file: what is read from it here is missed there.
void Simulator::after_fork_in_child()
{
    for (auto& [number, descriptor] : _descriptors)
        descriptor.inherited = true;
    _mutex.unlock();
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
        auto scenario = checked(parse_scenario(read_scenario_file(name)));
        replace_host(make_host(scenario), scenario.faults);
    }
    catch (const std::exception& error)
    {
        _state = State::broken;
        std::fprintf(stderr, "hxasim: %s=%s: %s\n", scenario_variable, name, error.what());
    }
}

void Simulator::replace_host(std::unique_ptr<Host> host, const std::vector<Fault>& faults)
{
    _host = std::move(host);
    ++_host_number;
    show_events();
    _state = _host ? State::loaded : State::absent;
    _journal.clear();
    _faults.assign(faults);
}

void Simulator::load(Scenario scenario)
{
    scenario = checked(std::move(scenario));
    auto host = make_host(scenario);
    std::lock_guard lock(_mutex);
    replace_host(std::move(host), scenario.faults);
}

void Simulator::unload()
{
    std::lock_guard lock(_mutex);
    replace_host(nullptr, {});
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
    if ((flags & O_ACCMODE) != O_RDWR)
    {
        _journal.add_violation(std::string(path_of(node)) + ": not opened for reading and writing");
        return -EACCES;
    }
    int descriptor = make_event_descriptor(flags);
    if (descriptor >= 0)
        _descriptors.insert_or_assign(descriptor, Descriptor{.node = node, .host_number = _host_number});
    return descriptor;
}

void Simulator::forget(int descriptor)
{
    std::lock_guard lock(_mutex);
    _descriptors.erase(descriptor);
}

Descriptor* Simulator::find(int descriptor)
{
    auto found = _descriptors.find(descriptor);
    return found == _descriptors.end() || found->second.host_number != _host_number ? nullptr : &found->second;
}

int Simulator::request(int descriptor, std::uint32_t code, void* record, std::chrono::nanoseconds slept)
{
    auto lock = locked();
    if (!_descriptors.contains(descriptor))
        return EBADF;
    const auto* open = find(descriptor);
    if (!open)
        return ENODEV;
    Journal_Entry entry{.node = open->node, .code = code, .slept = slept};
    entry.error = answer(lock, descriptor, entry, record);
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

// The row that answers the request; null, with the entry's error set, when no driver would accept it.
const Row* Simulator::accept(Journal_Entry& entry, const void* record)
{
    auto refuse = [&](int error, const std::string& why)
    {
        entry.error = violate(entry, error, why);
        return nullptr;
    };
    auto identified = identify(entry.node, entry.code);
    const Row* row = identified.command ? row_of(*identified.command) : nullptr;
    if (identified.command)
        entry.name = identified.command->name;
    entry.sent.resize(identified.error == 0 && row ? row->sent_size : record_size(entry.code));
    if (!copy_from_caller(entry.sent, record))
    {
        entry.sent.clear();
        if (identified.error == 0)
            return refuse(EFAULT, "bad address");
    }
    if (identified.error != 0)
        return refuse(identified.error, identified.why);
    if (!row)
        return refuse(ENOTTY, "not simulated");
    entry.instance = instance_of(*row, entry.sent);
    entry.carries_status = row->status.has_value();
    if (auto dirt = find_dirt(*row, entry.sent); !dirt.empty())
        return refuse(EINVAL, dirt);
    if (row->target == Target::ioc && !_host->find(entry.node, static_cast<std::uint32_t>(entry.instance)))
        return refuse(ENODEV, "no such instance");
    return row;
}

int Simulator::answer(std::unique_lock<std::mutex>& lock, int descriptor, Journal_Entry& entry, void* record)
{
    const Row* row = accept(entry, record);
    if (!row)
        return entry.error;
    auto fault = _faults.strike(*row, entry.node, entry.instance, entry.sent);
    const auto host_number = _host_number;
    if (fault && fault->delay > 0)
    {
        lock.unlock();
        wait(std::chrono::milliseconds(fault->delay));
        lock.lock();
    }
    auto* open = find(descriptor);
    if (!open || _host_number != host_number)
        return ENODEV; // closed, or another host, meanwhile
    Call call{.host = *_host, .descriptor = *open, .ioc = nullptr};
    if (row->target == Target::ioc)
        call.ioc = _host->find(open->node, static_cast<std::uint32_t>(entry.instance));
    if (call.ioc && !call.ioc->adapter->plugged && !row->of_absent)
        return ENODEV;
    int error = answer_row(call, *row, fault, entry, record);
    show_news();
    return error;
}

int Simulator::answer_row(Call& call, const Row& row, const std::optional<Fault>& fault, Journal_Entry& entry, void* record)
{
    auto answered = entry.sent;
    const auto before = call.ioc ? std::optional(function_state(*call.ioc)) : std::nullopt;
    if (!fault || is_carried_out(*fault))
        row.answer(call, answered);
    if (before)
        follow(call.host, *call.ioc, *before);
    if (call.error != 0)
        return violate(entry, call.error, call.why);
    if (fault)
        spoil(*fault, row, entry.sent, answered);
    const int error = fault ? fault->error : 0;
    if (error != 0 && answered == entry.sent)
        return error; // a driver leaves the record alone
    if (!copy_to_caller(record, answered))
        return violate(entry, EFAULT, "bad address");
    entry.answered = std::move(answered);
    return error;
}

bool Simulator::has_events(const Descriptor& descriptor) const
{
    if (!_host || descriptor.host_number != _host_number)
        return false;
    const auto& iocs = _host->iocs(descriptor.node);
    return std::any_of(iocs.begin(), iocs.end(),
                       [&](const Ioc& ioc)
                       { return descriptor.known[ioc.instance] && ioc.events.unread(descriptor.application.value_or(0)) > 0; });
}

void Simulator::show_news()
{
    if (_host->take_event_news())
        show_events();
}

void Simulator::show_events()
{
    for (auto& [number, descriptor] : _descriptors)
    {
        const bool readable = has_events(descriptor);
        if (descriptor.inherited || readable == descriptor.readable)
            continue;
        readable ? make_readable(number) : make_unreadable(number);
        descriptor.readable = readable;
    }
}

std::uint64_t Simulator::request_count()
{
    const auto lock = locked();
    return _journal.count();
}

std::size_t Simulator::remembered_requests()
{
    const auto lock = locked();
    return _journal.kept();
}

std::vector<Request> Simulator::take_requests()
{
    auto lock = locked();
    return _journal.take();
}

void Simulator::inject(const Fault& fault, const std::string& place)
{
    check_fault(fault, place);
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
