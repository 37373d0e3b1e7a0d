// The one instance that a request of a client is for. Walks leave out what the library's memory already shows to be something
// else; a hint, no filter: what is left in may still be another instance.
#pragma once

#include "hxal/hxal.h"
#include "runtime/instance.h"
#include "runtime/string.h"

#include <cstdint>
#include <vector>

namespace zmlr
{

// Which IOCs of a port are taken. A port is visited when it has one of them.
enum class Iocs
{
    fc,
    ethernet,
    of_card, // the FC one, on a CNA the Ethernet one too
    any      // both, whatever the adapter says it is
};

// Which ports of an adapter are looked at: what belongs to a card is read through its port 0.
enum class Ports
{
    first,
    all
};

class Wanted
{
public:
    // All instances: nothing is left out.
    Wanted() = default;

    // The instance with the model's keys; all instances when a key is null, empty, no text, longer than those of any instance, or
    // holds an address of zeros.
    explicit Wanted(const Instance* model);

    bool is_all() const { return _keys.empty(); }

    // False when the WWN's digits stand in no key (hyphens between them do not count), when no key ends with the text, or with
    // the number behind an underscore. The last is asked for every unit of a long list.
    bool may_hold(wwn_t wwn) const;
    bool may_end_with(const char* text) const;
    bool may_end_with_number(std::uint32_t number) const;

    // False when no key ends with the indexes of adapter and port, each behind an underscore, and none holds an address of one of
    // the port's IOCs (which may be null), or is its interface's name or its card's serial number, as the last scan found them.
    bool may_be_of(int adapter, int port, const hxal_t* ethernet, const hxal_t* fc) const;

    // The first adapter of the list that has such a port with such IOCs; null when there is none. Cheap: it passes over every
    // other adapter of the host.
    hxal_adapter_t* first_of(hxal_adapter_t* list, Ports ports, Iocs iocs) const;

private:
    struct Place
    {
        std::uint64_t adapter;
        std::uint64_t port;

        bool operator==(const Place&) const = default;
    };

    // How a field begins whose text is shown as the key, as two numbers: the first and the last 8 bytes of those that are
    // compared, zeros behind the text. The masks leave out what may differ: the case of letters, and bytes that are shown as '?'.
    struct Name
    {
        std::uint64_t first_mask, first, last_mask, last;

        explicit Name(const String& key);
        bool is_in(const char* field) const;
    };

    // False when there is an address of zeros, which many things have.
    bool append_numbers(const String& key);
    bool append_address(std::size_t digits, std::uint64_t number);

    // Hands over a function for each address and name in the keys: whether it is one of an IOC.
    template <class Use> void use_tests(Use use) const;

    std::vector<String> _keys;
    std::vector<wwn_t> _wwns;
    std::vector<wwn_t> _macs;            // behind two bytes of zeros
    std::vector<std::uint64_t> _numbers; // behind the last underscores
    std::vector<Place> _places;
    std::vector<Name> _serial_numbers;
    std::vector<Name> _interfaces;
};

} // namespace zmlr
