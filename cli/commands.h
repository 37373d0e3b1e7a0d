// The commands. Each reads the host, does what its options say and answers through the session; what stops it is a Failure.
//
// Where an `action` is asked for, command_line.cpp lets no other words through than those named here.
#pragma once

#include "cli/session.h"

#include <cstdint>
#include <optional>
#include <string>

namespace hxa
{

struct List_Options
{
    std::string adapter; // all without
    bool names = false;  // only what selects adapters and ports
};
void list(Session& session, const List_Options& options);

// The drivers' configuration file, where a setting that a driver has accepted is kept for its next start.
struct Keep_Options
{
    bool keep = false;
    std::string file = "/etc/hxa.conf";
};

struct Adapter_Options
{
    std::string action = "list"; // show, enable, disable, name, power
    std::string adapter;
    std::string value;
    Keep_Options keep;
};
void adapter(Session& session, const Adapter_Options& options);

struct Port_Options
{
    // show, sfp, virtual, enable, disable, name, beacon, speed, topology, frame-size, address, trunk
    std::string action = "list";
    std::string port;
    std::string value;
    std::uint32_t seconds = 0; // of a beacon; 0: until it is turned off
    bool link = false;         // the beacon at the other end too
    Keep_Options keep;
};
void port(Session& session, const Port_Options& options);

struct Stats_Options
{
    std::string port; // or adapter; all without
    bool reset = false;
    std::optional<double> watch; // seconds between two readings
    unsigned count = 0;          // of readings that are watched; 0: until interrupted
    std::string openmetrics;     // file to write instead
};
void stats(Session& session, const Stats_Options& options);

struct Targets_Options
{
    std::string port; // or adapter; all without
    bool no_luns = false;
};
void targets(Session& session, const Targets_Options& options);

struct Flash_Options
{
    std::string action = "show"; // update, write, read, erase, option-rom
    std::string adapter;         // of an update "all" too
    std::string partition;       // TYPE or TYPE/INSTANCE
    std::string file;
    std::string value;
};
void flash(Session& session, const Flash_Options& options);

struct Diag_Options
{
    std::string action;  // temperature, ping, queue, memory, loopback, registers
    std::string element; // adapter or port
    std::string mode = "internal";
    std::string speed = "auto";
    bool ethernet = false;
    std::uint32_t count = 0; // 0: what the test takes by itself
    std::uint32_t pattern = 0xA5A5A5A5;
    std::uint32_t number = 0; // of the queue, or of the first register
};
void diag(Session& session, const Diag_Options& options);

struct Events_Options
{
    std::string port;   // or adapter; all without
    unsigned count = 0; // of events; 0: until interrupted
};
void events(Session& session, const Events_Options& options);

struct Config_Options
{
    std::string action = "show"; // set, sync
    std::string port;
    std::string setting;
    std::string value;
    std::string file = "/etc/hxa.conf";
};
void config(Session& session, const Config_Options& options);

} // namespace hxa
