#include "inventory/adapter_walk.h"

namespace zmlr
{

namespace
{

// The values that a line has no place for are left over.
template <class... Values> void say(const Walk_Row& row, const Walk_Line& line, Values... values)
{
    const char* const log_source = row.log_source;
    if (line.text)
        ZMLR_LOG(line.level, line.text, values...);
}

bool is_cna(int adapter) { return hxal_adapter_is_cna_capable(adapter) != HXA_FALSE; }

hxal_t* take_ethernet(const Walk_Row& row, const Open_Adapter& adapter, int port)
{
    if (row.iocs == Iocs::fc || (row.iocs == Iocs::of_card && !adapter.is_cna))
        return nullptr;
    hxal_t* ioc = hxal_adapter_get_ethioc(adapter.handle, port);
    if (!ioc)
        say(row, row.no_ethernet, adapter.index, port);
    return ioc;
}

hxal_t* take_fc(const Walk_Row& row, const Open_Adapter& adapter, int port)
{
    if (row.iocs == Iocs::ethernet)
        return nullptr;
    hxal_t* ioc = hxal_adapter_get_fcioc(adapter.handle, port);
    if (!ioc)
        say(row, row.no_fc, adapter.index, port);
    return ioc;
}

} // namespace

std::optional<Open_Adapter> open_adapter(const Walk_Row& row, int index)
{
    hxal_adapter_t* handle = hxal_adapter_open_idx(index);
    if (!handle)
    {
        say(row, row.not_opened, index);
        say(row, row.not_opened_remark, index);
        return std::nullopt;
    }
    const Open_Adapter adapter = {handle, index, hxal_adapter_get_num_port(index), is_cna(index)};
    say(row, row.kind, adapter.is_cna ? "CNA" : "FC HBA");
    if (adapter.ports <= 0)
    {
        say(row, row.no_ports, index, adapter.ports);
        say(row, row.no_ports_remark, index);
        return std::nullopt;
    }
    return adapter;
}

std::optional<Open_Port> open_port(const Walk_Row& row, const Open_Adapter& adapter, int index)
{
    Ioc_Handle ethernet(take_ethernet(row, adapter, index));
    Ioc_Handle fc(take_fc(row, adapter, index));
    if (ethernet || fc)
        return Open_Port{adapter.index, index, std::move(ethernet), std::move(fc)};
    say(row, row.no_ioc, adapter.index, index);
    return std::nullopt;
}

Adapter_Walk::Adapter_Walk(const Walk_Row& row) : _row(row), _count(static_cast<int>(hxal_adapter_get_num()))
{
    say(row, row.count, _count);
    if (_count == 0)
        say(row, row.none, _count);
}

bool Adapter_Walk::next()
{
    while (++_index <= _count)
    {
        if (_row.no_cna.text && !is_cna(_index))
        {
            say(_row, _row.no_cna, _index);
            continue;
        }
        _adapter = open_adapter(_row, _index);
        if (_adapter)
            return true;
        if (_row.ends_at_unopened && !hxal_adapter_open_idx(_index))
            return false;
    }
    return false;
}

bool Port_Walk::next()
{
    while (++_index < _adapter.ports)
    {
        _port = open_port(_row, _adapter, _index);
        if (_port)
            return true;
    }
    return false;
}

} // namespace zmlr
