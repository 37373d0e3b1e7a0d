// A client that speaks bytes: good and bad HTTP alike.
#pragma once

#include <chrono>
#include <cstdint>
#include <string>

namespace test
{

class Raw_Client
{
public:
    explicit Raw_Client(std::uint16_t port); // connects to 127.0.0.1
    ~Raw_Client();
    Raw_Client(Raw_Client&& other) noexcept : _socket(other._socket) { other._socket = -1; }
    Raw_Client(const Raw_Client&) = delete;
    Raw_Client& operator=(const Raw_Client&) = delete;

    bool send(const std::string& bytes); // false when the server has closed
    void end_sending();
    bool connected() const { return _socket >= 0; }

    // One whole answer (head and the body that Content-Length tells), or what came before the connection ended or the time
    // was over.
    std::string receive(std::chrono::milliseconds time = std::chrono::seconds(20));

    // Whether the server ends the connection, without another byte, within the time.
    bool closed_within(std::chrono::milliseconds time);

private:
    bool readable_until(std::chrono::steady_clock::time_point deadline) const;

    int _socket;
};

// A POST request around a body.
std::string post(const std::string& body, const std::string& headers = "");

} // namespace test
