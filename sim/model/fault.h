// Requests that go wrong, as a test, a scenario or a person at the control socket wants it.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

namespace hxasim
{

// Bytes that overwrite a part of an answer: how a test gets a count that lies or a text that does not end.
struct Patch
{
    std::size_t offset = 0; // from the start of the whole record, or of the data
    std::vector<std::uint8_t> bytes;
};

// Makes matching requests go wrong, or late. Unset members match everything. The first fault in the order of injection that fires
// decides; later ones do not see the request. With an error, a record status or a SCSI status nothing is carried out, and the
// rest of the record is as it was sent, apart from garbage and overwritten bytes.
struct Fault
{
    std::string command = {};                                    // by name; empty: every command
    std::string node = {};                                       // empty: both
    std::optional<int> instance = {};                            // unset: every instance
    std::optional<std::array<std::uint8_t, 8>> remote_port = {}; // port WWN, of a request that names a remote port
    std::optional<std::uint32_t> lun = {};                       // number, of a SCSI command
    std::vector<std::uint8_t> cdb = {};                          // what the command block of a SCSI command begins with
    int error = 0;                                               // fail the call with this errno ...
    std::uint32_t status = 0;                                    // ... or answer with this record status
    int skip = 0;                                                // let this many matching requests pass first
    int times = -1;                                              // then fail this many, -1: always
    int delay = 0;                                               // answer after this many ms; other requests go on meanwhile
    std::vector<Patch> answer = {};                              // overwrite these bytes of the answered record
    std::optional<std::uint8_t> scsi_status = {};                // ... or answer a SCSI command with this, and without any data
    std::vector<Patch> data = {};                                // overwrite these bytes of the sender's buffer for data
    std::optional<std::uint32_t> garbage = {}; // seed: random bytes for the whole record, but for the status of a request that
                                               // does not fail, and for the sender's buffers; before anything is overwritten
};

} // namespace hxasim
