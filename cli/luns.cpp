#include "cli/luns.h"

#include "cli/field_text.h"
#include "hxal/scsi.h"

#include <algorithm>
#include <array>
#include <cstring>
#include <set>
#include <span>

namespace hxa
{

namespace
{

using Bytes = std::vector<std::uint8_t>;

constexpr std::size_t list_head = 8; // REPORT LUNS: length of the list, reserved
constexpr std::size_t list_entry = 8;
constexpr std::size_t most_units = 65536;
constexpr std::size_t page_size = 252; // of an INQUIRY; its length has one byte, and some devices take no odd ones
constexpr std::uint8_t serial_page = 0x80;
constexpr std::uint8_t disk = 0; // peripheral device type

// clang-format off
constexpr const char* types[] = {
    "disk", "tape", "printer", "processor", "write-once", "cd-rom", "scanner", "optical", "changer", "communications",
    "0x0A", "0x0B", "array-controller", "enclosure", "simplified-disk",
};
// clang-format on

std::uint64_t number_at(std::span<const std::uint8_t> bytes, std::size_t at, std::size_t size)
{
    std::uint64_t number = 0;
    for (const auto byte : bytes.subspan(at, size))
        number = number << 8 | byte;
    return number;
}

std::string text_at(const Bytes& bytes, std::size_t at, std::size_t size)
{
    at = std::min(at, bytes.size());
    const std::string_view text(reinterpret_cast<const char*>(bytes.data()) + at, std::min(size, bytes.size() - at));
    return safe_text(text.substr(0, text.find('\0')));
}

// One remote port, asked through the base port.
class Target
{
public:
    Target(const Port& port, wwn_t remote_port) : _ioc(port.fc), _remote_port(remote_port) {}

    // Sends the command. `data` has the room for the answer, and holds 0 where none came. An answer counts when the unit took the
    // command: SCSI status GOOD.
    template <typename Command> hxa_status_t ask(Command command, lun_t lun, scsi_cdb_t cdb, Bytes& data) const
    {
        std::uint8_t scsi_status = 0;
        std::array<std::uint8_t, 252> sense{};
        auto sense_size = static_cast<std::uint32_t>(sense.size());
        const auto status = command(_ioc, 0, _ioc->pwwn, _remote_port, lun, &cdb, 0, data.data(),
                                    static_cast<std::uint32_t>(data.size()), &scsi_status, sense.data(), &sense_size);
        return status == HXA_STATUS_OK && scsi_status != 0 ? HXA_STATUS_IO_FAILURE : status;
    }

    hxa_status_t report_luns(Bytes& list) const
    {
        list.assign(list_head + 256 * list_entry, 0);
        auto status = ask(hxal_scsi_reportluns, 0, {}, list);
        const auto size = list_head + std::min<std::size_t>(number_at(list, 0, 4), most_units * list_entry);
        if (status == HXA_STATUS_OK && size > list.size())
        {
            list.assign(size, 0);
            status = ask(hxal_scsi_reportluns, 0, {}, list);
        }
        const auto told = list_head + number_at(list, 0, 4);
        list.resize(std::min<std::size_t>(list.size(), told));
        return status;
    }

    // An INQUIRY answer, as long as its head says; empty when there is none.
    Bytes inquiry(lun_t lun, int page) const
    {
        Bytes data(page_size, 0);
        scsi_cdb_t cdb{};
        if (page >= 0)
        {
            cdb.scsi_cdb[1] = 1; // a page
            cdb.scsi_cdb[2] = static_cast<std::uint8_t>(page);
        }
        if (ask(hxal_scsi_inquiry, lun, cdb, data) != HXA_STATUS_OK)
            return {};
        const std::size_t told = page >= 0 ? 4 + number_at(data, 2, 2) : std::size_t{5} + data[4];
        data.resize(std::min(data.size(), told));
        return data;
    }

    Value capacity(lun_t lun) const
    {
        Bytes data(8, 0);
        if (ask(hxal_scsi_readcapacity, lun, {}, data) != HXA_STATUS_OK)
            return {};
        if (number_at(data, 0, 4) != 0xFFFFFFFF)
            return (number_at(data, 0, 4) + 1) * number_at(data, 4, 4);
        data.assign(32, 0);
        if (ask(hxal_scsi_readcapacity16, lun, {}, data) != HXA_STATUS_OK)
            return {};
        return (number_at(data, 0, 8) + 1) * number_at(data, 8, 4);
    }

private:
    const hxal_t* _ioc;
    wwn_t _remote_port;
};

// The number in peripheral, flat or extended flat addressing (SAM-3); nothing for another one.
Value lun_number(std::span<const std::uint8_t> entry)
{
    switch (entry[0] >> 6)
    {
    case 0:
        return entry[0] == 0 ? Value(unsigned{entry[1]}) : Value();
    case 1:
        return Value(static_cast<unsigned>(number_at(entry, 0, 2) & 0x3FFF));
    default:
        return entry[0] == 0xD2 ? Value(static_cast<unsigned>(number_at(entry, 1, 3))) : Value();
    }
}

Value lun_tree(const Target& target, std::span<const std::uint8_t> entry)
{
    lun_t lun;
    std::memcpy(&lun, entry.data(), sizeof lun);
    Object tree{{"lun", lun_number(entry)}, {"lun_bytes", hexadecimal(number_at(entry, 0, list_entry), 16)}};
    const auto standard = target.inquiry(lun, -1);
    if (standard.empty())
        return tree;
    const unsigned type = standard[0] & 0x1F;
    tree.push_back({"type", type < std::size(types) ? types[type] : "0x" + hexadecimal(type, 2)});
    tree.push_back({"vendor", text_at(standard, 8, 8)});
    tree.push_back({"product", text_at(standard, 16, 16)});
    tree.push_back({"revision", text_at(standard, 32, 4)});
    const auto serial = target.inquiry(lun, serial_page);
    if (serial.size() > 4)
        tree.push_back({"serial_number", text_at(serial, 4, serial.size())});
    if (type == disk)
        tree.push_back({"capacity_bytes", target.capacity(lun)});
    return tree;
}

} // namespace

List luns_of(Session& session, const Port& port, wwn_t remote_port)
{
    const Target target(port, remote_port);
    Bytes list;
    if (!session.accept(target.report_luns(list), "units of remote port " + wwn_text(remote_port)))
        return {};
    List trees;
    std::set<std::uint64_t> seen; // a list that lies about its length goes on with LUN 0
    for (std::size_t at = list_head; at + list_entry <= list.size(); at += list_entry)
        if (seen.insert(number_at(list, at, list_entry)).second)
        {
            session.progress("port " + port.name() + ", remote port " + wwn_text(remote_port) + ", unit " +
                             std::to_string(trees.size() + 1));
            trees.push_back(lun_tree(target, std::span(list).subspan(at, list_entry)));
        }
    return trees;
}

} // namespace hxa
