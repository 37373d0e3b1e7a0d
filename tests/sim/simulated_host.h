// A test that talks to the simulated drivers itself: opens nodes and sends records.
#pragma once

#include "tests/support/simulated_host.h"

#include "hxal/records/commands.h"

#include <fcntl.h>
#include <sys/ioctl.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>
#include <stdexcept>
#include <string>
#include <utility>

// An open file that is closed at the end.
class Open_File
{
public:
    explicit Open_File(const char* path) : _descriptor(open(path, O_RDWR)) {}
    explicit Open_File(int descriptor) : _descriptor(descriptor) {}
    Open_File(Open_File&& other) noexcept : _descriptor(std::exchange(other._descriptor, -1)) {}
    Open_File& operator=(Open_File&&) = delete;
    ~Open_File() { close_now(); }

    void close_now()
    {
        if (int descriptor = std::exchange(_descriptor, -1); descriptor >= 0)
            close(descriptor);
    }
    int operator*() const { return _descriptor; }

private:
    int _descriptor;
};

// The FC node of a host that is loaded first.
inline int node_on(const char* scenario)
{
    hxasim::load_text(scenario);
    return open("/dev/hxa", O_RDWR);
}

inline std::uint32_t code_of(std::string_view name, char group)
{
    for (const auto& command : hxal::catalogue)
        if (command.name == name)
            return hxal::command_code(command, static_cast<std::uint8_t>(group));
    ADD_FAILURE() << "not in the catalogue: " << name;
    return 0;
}

// Sends the record; 0 or the errno.
template <typename Record> int send(int descriptor, std::string_view name, char group, Record& record)
{
    return ioctl(descriptor, code_of(name, group), &record) == 0 ? 0 : errno;
}

// What an action says that is refused; "done" when it is not.
template <typename Action> std::string refusal_of(Action action)
{
    try
    {
        action();
        return "done";
    }
    catch (const std::runtime_error& error)
    {
        return error.what();
    }
}

// Text of a fixed field, terminated or not.
template <std::size_t size> std::string text_of(const char (&field)[size]) { return {field, strnlen(field, size)}; }

// The bytes of an address in memory order as hexadecimal digits.
template <typename Address> std::string digits_of(const Address& address)
{
    std::array<unsigned char, sizeof(Address)> bytes{};
    std::memcpy(bytes.data(), &address, sizeof(Address));
    std::string digits;
    for (unsigned char byte : bytes)
    {
        digits += "0123456789ABCDEF"[byte >> 4];
        digits += "0123456789ABCDEF"[byte & 15];
    }
    return digits;
}

class Raw_Host : public Simulated_Host
{
protected:
    explicit Raw_Host(const char* scenario = nullptr)
    {
        if (scenario)
            hxasim::load(scenario);
    }

    // The answer of instance `instance`; the request must succeed.
    template <typename Record> Record ask(const Open_File& node, std::string_view name, char group, std::uint16_t instance)
    {
        Record record{};
        record.hxad_num = instance;
        EXPECT_EQ(send(*node, name, group, record), 0) << name;
        return record;
    }

    hxa_ioctl_ioc_info_t info(const Open_File& node, char group, std::uint16_t instance)
    {
        return ask<hxa_ioctl_ioc_info_t>(node, "IOCMD_IOC_GET_INFO", group, instance);
    }
    hxa_pport_attr_t port(const Open_File& node, char group, std::uint16_t instance)
    {
        return ask<hxa_ioctl_port_attr_t>(node, "IOCMD_PORT_GET_ATTR", group, instance).attr;
    }
    std::pair<std::uint32_t, std::string> instances(const Open_File& node, char group)
    {
        hxa_ioctl_ioc_get_inst_t record{};
        EXPECT_EQ(send(*node, "IOCMD_IOC_GET_INST", group, record), 0);
        return {record.cnt, digits_of(record.bm)};
    }
};
