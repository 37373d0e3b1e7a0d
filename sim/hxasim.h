// The simulated driver as tests see it: load a host, look at the requests it was sent, make requests fail.
//
// A program that links libhxasim has its "/dev/hxa" and "/dev/hxn" answered by the loaded scenario; all other files and
// descriptors go to libc. Without a scenario (neither HXASIM_SCENARIO nor load()) both nodes go to libc as well.
// Every function may be called from any thread. Failures to read a scenario throw std::runtime_error that names the place
// in it; the host that was loaded before then stays. HXASIM_SCENARIO is looked at once, at the first use of a node or of a
// function below; a scenario that cannot be read is told on standard error, and opening a node answers ENODEV.
#pragma once

#include "sim/model/fault.h"

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#pragma GCC visibility push(default)

namespace hxasim
{

// One ioctl as the driver saw it.
struct Request
{
    std::string node;                   // "/dev/hxa" or "/dev/hxn"
    unsigned long command = 0;          // the whole request code
    std::string name;                   // "IOCMD_PORT_GET_ATTR"; empty when the driver does not know the command
    int instance = -1;                  // -1 where the record carries none
    std::vector<std::uint8_t> sent;     // the record as it came in
    std::vector<std::uint8_t> answered; // the record as it went out
    int error = 0;                      // the errno the call failed with, 0 when it succeeded
    bool carries_status = false;        // a fault may give it a record status
    std::chrono::nanoseconds slept{};   // how long the process asked to sleep since the request before
};

// What a driver tells its applications: queued at one IOC for each of them, and a node that an application has synchronised
// on is readable while there is something to fetch. Enumerations are those of hxal/records/aen.h.
struct Event
{
    std::string node = "/dev/hxa";       // of the IOC that raises it ...
    int instance = 0;                    // ... and its instance
    std::uint32_t category = 0;          // hxa_aen_category_t
    std::uint32_t type = 0;              // event of the category
    std::int16_t level = 0;              // hxa_pom_health_t, of optical monitoring
    std::vector<std::uint8_t> data = {}; // up to 40 bytes of event data; empty: about that IOC's own objects
};

// Replaces the simulated host by a scenario: a shipped one by name ("mixed") or a JSON file by path; or JSON text.
// Descriptors that are open on the old host answer ENODEV. Clears faults and recorded requests.
void load(const std::string& name_or_path);
void load_text(const std::string& json);
void unload();

// Returns and forgets the recorded requests, oldest first. Only the newest are kept: 100,000 of them, 128 MiB of records.
std::vector<Request> take_requests();
std::uint64_t request_count(); // requests since load(), taken ones included

// Throws std::runtime_error for a fault that could never do what it says: an unknown command or node, a status for a record
// that carries none, bytes beyond the record, a LUN for what is no SCSI command, nothing to do at all.
void inject(const Fault& fault);
void clear_faults();

// Strikes once, and among recorded requests that are sent again in their order the one at `index`: what is to happen to it is
// for the caller to set. Faults that are injected already must not strike the same requests.
Fault fault_at(const std::vector<Request>& requests, std::size_t index);

// Requests that no driver would accept (unknown command, wrong size, dirty reserved field, bad instance, a node that is not
// opened for reading and writing), since load(): one text each, at most the first 1,000.
std::vector<std::string> violations();

// Open descriptors on the simulated nodes.
int open_descriptors();

// Raises an event for every application. Nothing else happens on the host. Throws std::runtime_error when there is no such
// IOC, or for more data than an event holds.
void raise_event(const Event& event);

// How many events the application has lost since load(): an IOC keeps the newest 65,536.
std::uint64_t lost_events(std::uint32_t application);

// Pulls a card out of the host and puts it back as it was, raising the event of that; meanwhile its IOCs answer ENODEV to
// everything but event fetches. Adapters are counted from 0, as in the scenario. Throw std::runtime_error when there is no
// such adapter or port, or nothing to do.
void unplug(std::size_t adapter);
void plug(std::size_t adapter);

// Takes the link of a port down, or up again, and the module out of its cage, or back; a port out of service keeps silent.
void set_link(std::size_t adapter, std::size_t port, bool up);
void set_sfp(std::size_t adapter, std::size_t port, bool inserted);

// Serves the control socket (README.md) at this path instead of where it was; an empty path ends it. Throws
// std::runtime_error when the socket cannot be made, as when another process serves it.
void serve_control(const std::string& path);

// Shortens the sleeps of the whole process - nanosleep(), usleep(), select() without descriptors - to this part of their time:
// 1 leaves them, 0 skips them. It begins with HXASIM_TIME_SCALE, or 1. Throws std::runtime_error beyond 0 to 1.
void set_time_scale(double scale);

} // namespace hxasim

#pragma GCC visibility pop
