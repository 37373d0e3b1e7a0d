// Requests that go wrong, as a test, a scenario or a person at the control socket wants it.
#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

namespace hxasim
{

// Bytes that overwrite a part of an answered record: how a test gets a count that lies or a text that does not end.
struct Patch
{
    std::size_t offset = 0; // from the start of the whole record
    std::vector<std::uint8_t> bytes;
};

// Makes matching requests go wrong, or late. Unset members match everything. The first fault in the order of injection that fires
// decides; later ones do not see the request. A record status leaves the rest of the record as it was sent.
struct Fault
{
    std::string command = {};         // by name; empty: every command
    std::string node = {};            // empty: both
    std::optional<int> instance = {}; // unset: every instance
    int error = 0;                    // fail the call with this errno ...
    std::uint32_t status = 0;         // ... or answer with this record status
    int skip = 0;                     // let this many matching requests pass first
    int times = -1;                   // then fail this many, -1: always
    int delay = 0;                    // answer after this many ms; other requests go on meanwhile
    std::vector<Patch> answer = {};   // without an error: overwrite these bytes of the answered record
};

} // namespace hxasim
