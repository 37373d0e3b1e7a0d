// The one instance that a request of a client is for. Walks leave out what the library's memory already shows to be something
// else; a hint, no filter: what is left in may still be another instance.
#pragma once

#include "inventory/adapter_walk.h"
#include "runtime/instance.h"
#include "runtime/string.h"

namespace zmlr
{

class Wanted
{
public:
    // All instances: nothing is left out.
    Wanted() = default;

    // The instance with the model's keys; all instances when a key is null, empty or no text.
    explicit Wanted(const Instance* model);

    bool is_all() const { return _keys.empty(); }

    // False when no key holds the text (which is not empty), ends with it. Case and hyphens do not count.
    bool may_hold(const char* text) const;
    bool may_end_with(const char* text) const;

    // False when no key holds an address, the interface name or the card's serial number of the port, as the last scan found
    // them.
    bool may_be_of(const Open_Port& port) const;

private:
    String _keys; // in lower case, without hyphens, each with a line feed behind it
};

} // namespace zmlr
