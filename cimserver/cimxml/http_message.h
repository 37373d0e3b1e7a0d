// What the HTTP side and the CIM-XML side hand to each other: one request, one answer.
#pragma once

#include <exception>
#include <functional>
#include <string>
#include <utility>

namespace cimserver
{

struct Http_Request
{
    std::string cim_operation; // the CIMOperation header; empty when the client sent none
    std::string body;
    std::string user = "root"; // who asks; a server without credentials does not tell its users apart
};

struct Http_Answer
{
    unsigned status = 200;
    std::string cim_error; // value of the CIMError header (DSP0200); none when empty
    std::string body;      // CIM-XML; empty unless the status is 200
};

// What a handler makes of a request: an answer, or (`rest`) work that may take long, because it waits for somebody else. The
// rest is done by other threads than those that call handlers, so that these are never all held up.
struct Http_Work
{
    Http_Answer answer;
    std::function<Http_Answer()> rest; // none: the answer stands
};

// Called on several threads at once. The request lives until the rest is done. An exception that escapes from either becomes
// status 500.
using Http_Handler = std::function<Http_Work(const Http_Request&)>;

// A request that is refused before any operation could be told from it (DSP0200: HTTP status and CIMError header).
class Http_Refusal : public std::exception
{
public:
    Http_Refusal(unsigned status, std::string cim_error) : _status(status), _cim_error(std::move(cim_error)) {}
    unsigned status() const { return _status; }
    const std::string& cim_error() const { return _cim_error; }
    const char* what() const noexcept override { return _cim_error.c_str(); }

private:
    unsigned _status;
    std::string _cim_error;
};

} // namespace cimserver
