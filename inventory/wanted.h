// The one instance that a request of a client is for. Walks leave out what the library's memory already shows to be something
// else; a hint, no filter: what is left in may still be another instance.
#pragma once

#include "inventory/adapter_walk.h"
#include "runtime/instance.h"
#include "runtime/string.h"

#include <cstdint>
#include <vector>

namespace zmlr
{

class Wanted
{
public:
    // All instances: nothing is left out.
    Wanted() = default;

    // The instance with the model's keys; all instances when a key is null, empty, no text, or longer than
    // those of any instance.
    explicit Wanted(const Instance* model);

    bool is_all() const { return _keys.empty(); }

    // False when the WWN's digits stand in no key (hyphens between them do not count), when no key ends with the text, or with
    // the number behind an underscore. The last is asked for every unit of a long list.
    bool may_hold(wwn_t wwn) const;
    bool may_end_with(const char* text) const;
    bool may_end_with_number(std::uint32_t number) const;

    // False when no key holds an address of the port and none is its interface's name or its card's serial number, as the last
    // scan found them. Cheap: it is asked for every port that is passed over.
    bool may_be_of(const Open_Port& port) const;

private:
    bool may_be_of_ioc(const hxal_t& ioc) const;

    // True when a key is the text of the field, as a property would show it.
    template <std::size_t N> bool has_key(const char (&field)[N]) const;

    std::vector<String> _keys;
    std::uint64_t _sizes = 0;         // of the keys, a bit each
    std::vector<std::uint64_t> _wwns; // all that the digits in the keys may be, in memory order
    std::vector<std::uint64_t> _macs; // the same, 6 bytes each
    std::vector<std::uint64_t> _numbers;
};

} // namespace zmlr
