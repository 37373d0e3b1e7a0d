#include "hxal/config/internal/vports.h"

#include "hxal/config/internal/syntax.h"
#include "hxal/config/parser.h"
#include "hxal/internal/list.h"

#include <new>
#include <utility>

namespace hxal::config
{

namespace
{

// Two spellings of one WWN are one port; texts that are no WWN are the same only letter by letter.
hxal_vf_config_t* listed(const Ioc_Entry& entry, std::string_view text)
{
    const wwn_t pwwn = wwn_of(text);
    return first_that(entry.vport, [=](const hxal_vf_config_t& port)
                      { return text == port.pwwn || (pwwn != 0 && pwwn == wwn_of(port.pwwn)); });
}

int free_number(hxal_vf_config_t* list)
{
    int number = 0;
    while (first_that(list, [=](const hxal_vf_config_t& port) { return port.vidx == number; }))
        ++number;
    return number;
}

hxal_vf_config_t* append(Ioc_Entry& entry)
{
    if (entry.vpcount >= HXAL_CONFIG_MAX_VPORTS)
        return nullptr;
    auto* port = new (std::nothrow) hxal_vf_config_t{};
    if (!port)
        return nullptr;
    port->vidx = free_number(entry.vport);
    list_append(entry.vport, port);
    ++entry.vpcount;
    return port;
}

// Unlike a filtered value an empty field stays empty.
std::string_view stripped(std::string_view text)
{
    const std::string_view value = filtered(text);
    return value == " " ? std::string_view() : value;
}

} // namespace

void put_vport(Ioc_Entry& entry, const hxal_vf_config_t& port, std::optional<int> vidx)
{
    hxal_vf_config_t* to = listed(entry, port.pwwn);
    if (!to)
        to = append(entry);
    if (!to)
        return;
    hxal_vf_config_t* next = to->next;
    const int own_number = to->vidx;
    *to = port;
    to->vidx = vidx.value_or(own_number);
    to->next = next;
    set(entry.flags, HXAL_CONFIG_VPORT, true);
}

void store_vport(Ioc_Entry& entry, std::string_view text, std::optional<int> vidx)
{
    std::string_view fields[5];
    std::size_t count = 0;
    split(text, ',',
          [&](std::string_view field)
          {
              if (count < std::size(fields))
                  fields[count++] = stripped(field);
          });
    if (fields[0].empty())
        return;
    hxal_vf_config_t port{};
    copy(port.pwwn, fields[0]);
    copy(port.nwwn, fields[1]);
    copy(port.name, fields[2]);
    copy(port.role, fields[3]);
    const int vf_id = number(fields[4]);
    port.vf_id = vf_id <= UINT16_MAX ? static_cast<uint16_t>(vf_id) : 0;
    put_vport(entry, port, vidx);
}

void drop_vport(Ioc_Entry& entry, wwn_t pwwn)
{
    hxal_vf_config_t** link = &entry.vport;
    while (*link && wwn_of((*link)->pwwn) != pwwn)
        link = &(*link)->next;
    if (!*link)
        return;
    delete std::exchange(*link, (*link)->next);
    --entry.vpcount;
    if (!entry.vport)
        set(entry.flags, HXAL_CONFIG_VPORT, false);
}

} // namespace hxal::config

void hxal_config_set_vportdata(int idx, const char* line)
{
    const hxal::config::Locked_Model model;
    if (line && hxal::config::is_entry(idx))
        hxal::config::store_vport(model->iocs[idx], line, {});
}
