// The host's name service as these tests want it: the C library's look-ups answer from here.
#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

namespace zmlr
{

struct Fake_Host
{
    std::optional<std::string> name = "storage-host";    // unset: gethostname and uname fail
    int name_answers = -1;                               // then fails after this many answers; -1: never
    std::vector<std::string> addresses = {"192.0.2.10"}; // up to 4
    std::optional<std::string> domain = "(none)";        // unset: getdomainname fails
    std::size_t memory_needed = 100;                     // by gethostbyname_r
    int lookups = 0;                                     // calls of gethostbyname_r
};

extern Fake_Host fake_host;

} // namespace zmlr
