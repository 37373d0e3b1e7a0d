#include "inventory/adapter_walk.h"

namespace zmlr
{

namespace
{

// The values that a line has no place for are left over.
template <class... Values> void say(const Walk_Row& row, const Walk_Line& line, Values... values)
{
    const char* const log_source = row.source;
    if (line.text)
        ZMLR_LOG(line.level, line.text, values...);
}

hxal_adapter_t* open(const Walk_Row& row, int index)
{
    hxal_adapter_t* handle = hxal_adapter_open_idx(index);
    if (!handle)
    {
        say(row, row.not_opened, index);
        say(row, row.not_opened_remark, index);
    }
    return handle;
}

std::optional<Open_Adapter> with_ports(const Walk_Row& row, hxal_adapter_t& handle)
{
    const Open_Adapter adapter = {&handle, handle.id, handle.port_count, handle.cna_capable != HXA_FALSE};
    say(row, row.kind, adapter.is_cna ? "CNA" : "FC HBA");
    if (adapter.ports > 0)
        return adapter;
    say(row, row.no_ports, adapter.index, adapter.ports);
    say(row, row.no_ports_remark, adapter.index);
    return std::nullopt;
}

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
    hxal_adapter_t* handle = open(row, index);
    return handle ? with_ports(row, *handle) : std::nullopt;
}

std::optional<Open_Port> open_port(const Walk_Row& row, const Open_Adapter& adapter, int index, const Wanted* wanted)
{
    hxal_t* const ethernet = take_ethernet(row, adapter, index);
    hxal_t* const fc = take_fc(row, adapter, index);
    if (!ethernet && !fc)
        say(row, row.no_ioc, adapter.index, index);
    else if (!wanted || wanted->may_be_of(adapter.index, index, ethernet, fc))
        return Open_Port{adapter.index, index, Ioc_Handle(ethernet), Ioc_Handle(fc)};
    return std::nullopt;
}

Adapter_Walk::Adapter_Walk(const Walk_Row& row, const Wanted* wanted)
    : _row(row)
    , _wanted(log_wanted(LL_ERR) ? nullptr : wanted)
    , _count(static_cast<int>(hxal_adapter_get_num()))
{
    say(row, row.count, _count);
    if (_count == 0)
        say(row, row.none, _count);
}

bool Adapter_Walk::next()
{
    while (++_index <= _count)
    {
        // They are listed in the order of their indexes.
        _handle = _handle && _handle->next && _handle->next->id == _index ? _handle->next : open(_row, _index);
        if (!_handle && _row.ends_at_unopened)
            return false;
        if (!_handle)
            continue;
        if (_wanted) // the adapters before it are passed over at once
        {
            _handle = _wanted->first_of(_handle, _row.ports, _row.iocs);
            if (!_handle)
                return false;
            _index = _handle->id;
        }
        if (_row.no_cna.text && !_handle->cna_capable)
        {
            say(_row, _row.no_cna, _index);
            continue;
        }
        _adapter = with_ports(_row, *_handle);
        if (_adapter)
            return true;
    }
    return false;
}

bool Port_Walk::next()
{
    while (++_index < _adapter.ports)
    {
        _port = open_port(_row, _adapter, _index, _wanted);
        if (_port)
            return true;
    }
    return false;
}

} // namespace zmlr
