// The injected faults, and which of them strikes a request.
#pragma once

#include "sim/commands/command.h"
#include "sim/model/fault.h"

#include <optional>
#include <span>
#include <string>
#include <vector>

namespace hxasim
{

// Throws std::runtime_error "PLACE.member: ..." for a fault that could never do what it says.
void check_fault(const Fault& fault, const std::string& place);

class Fault_List
{
public:
    void add(const Fault& fault) { _faults.push_back(fault); }
    void assign(const std::vector<Fault>& faults) { _faults = faults; }
    void clear() { _faults.clear(); }
    std::size_t size() const { return _faults.size(); }

    // The fault that strikes this request, if any. Every fault asked counts the request against its `skip` or `times`.
    std::optional<Fault> strike(const Row& row, Node node, int instance, std::span<const std::uint8_t> sent);

private:
    std::vector<Fault> _faults;
};

} // namespace hxasim
