// The walk over the adapters of this host and over the ports of an adapter: the only place that opens, counts, skips and closes
// them.
//
//     for (Adapter_Walk adapters(row); adapters.next();)
//         for (Port_Walk ports(row, adapters.adapter()); ports.next();)
//             use(ports.port());
//
// A row tells what is taken and what is logged on the way, so that walks differ by their rows only. A look-up is a walk that its
// caller leaves.
#pragma once

#include "hxal/hxal.h"
#include "inventory/wanted.h"
#include "runtime/log.h"

#include <memory>
#include <optional>

namespace zmlr
{

// A line of a walk: a format for the values that stand beside its field in Walk_Row. Without a text there is no line.
struct Walk_Line
{
    Log_Level level = LL_INFO;
    const char* text = nullptr;
};

struct Walk_Row
{
    const char* source = nullptr;
    Iocs iocs = Iocs::any;
    Ports ports = Ports::all;
    bool ends_at_unopened = false; // instead of going on with the next adapter

    // Lines of a walk over all adapters. Behind each its values.
    Walk_Line count = {};  // adapters
    Walk_Line none = {};   // -
    Walk_Line no_cna = {}; // -; with it, adapters that are no CNA are passed over

    // Lines of each adapter that is opened.
    Walk_Line not_opened = {};        // adapter
    Walk_Line not_opened_remark = {}; // -
    Walk_Line kind = {};              // "CNA" or "FC HBA"
    Walk_Line no_ports = {};          // adapter, ports
    Walk_Line no_ports_remark = {};   // -

    // Lines of each port.
    Walk_Line no_ethernet = {}; // adapter, port
    Walk_Line no_fc = {};       // adapter, port
    Walk_Line no_ioc = {};      // adapter, port; none of those that are taken
};

// An IOC that is closed at the end of its scope; release() keeps it open for the caller.
struct Ioc_Closer
{
    void operator()(hxal_t* ioc) const { hxal_ioc_close(ioc); }
};
using Ioc_Handle = std::unique_ptr<hxal_t, Ioc_Closer>;

struct Open_Adapter
{
    hxal_adapter_t* handle;
    int index; // from 1
    int ports; // at least 1
    bool is_cna;
};

struct Open_Port
{
    int adapter; // the adapter's index
    int index;   // from 0
    Ioc_Handle ethernet;
    Ioc_Handle fc;
};

// One adapter: empty when it cannot be opened or has no ports.
std::optional<Open_Adapter> open_adapter(const Walk_Row& row, int index);

// One port: empty when it has none of the IOCs, or when what is wanted (null: everything) is not of it.
std::optional<Open_Port> open_port(const Walk_Row& row, const Open_Adapter& adapter, int index, const Wanted* wanted = nullptr);

class Adapter_Walk
{
public:
    // Adapters that have nothing of what is wanted (null: everything) may be left out.
    explicit Adapter_Walk(const Walk_Row& row, const Wanted* wanted = nullptr);

    int count() const { return _count; } // of all adapters
    bool next();                         // to the next adapter that can be visited; false at the end
    const Open_Adapter& adapter() const { return *_adapter; }

private:
    const Walk_Row& _row;
    const Wanted* const _wanted; // null too while the log takes lines of each adapter
    const int _count;
    int _index = 0;
    hxal_adapter_t* _handle = nullptr; // of the index; null when it cannot be opened
    std::optional<Open_Adapter> _adapter;
};

class Port_Walk
{
public:
    Port_Walk(const Walk_Row& row, const Open_Adapter& adapter, const Wanted* wanted = nullptr)
        : _row(row)
        , _adapter(adapter)
        , _wanted(wanted)
    {
    }

    bool next(); // to the next port that can be visited and may be wanted; false at the end
    Open_Port& port() { return *_port; }

private:
    const Walk_Row& _row;
    const Open_Adapter& _adapter;
    const Wanted* const _wanted;
    int _index = -1;
    std::optional<Open_Port> _port;
};

} // namespace zmlr
