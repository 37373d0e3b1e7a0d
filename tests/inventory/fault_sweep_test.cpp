// Every request of every enumeration fails once, is refused once and is answered with garbage: what depends on it is missing or
// changed then, all else is as it was, and the log names what failed.
#include "hxal/hxal.h"
#include "inventory/adapter_lookup.h"
#include "inventory/adapter_walk.h"
#include "inventory/address_text.h"
#include "providers/enumerations.h"
#include "tests/inventory/inventory_fixture.h"

#include <algorithm>
#include <cctype>
#include <cerrno>
#include <cstring>
#include <iterator>

using namespace zmlr;

namespace
{

constexpr const char* two_cards = R"({"adapters": [
    {"kind": "cna", "flash": [{"type": "optrom", "status": "good"}], "ports": [
        {"remote_ports": [{"pwwn": "2100000F00000001", "luns": [{}, {"page_83": "00830000"}]},
                          {"pwwn": "2100000F00000002"}, {"pwwn": "2100000F00000005", "function": "initiator"}]}, {}]},
    {"kind": "fc-hba", "ports": [{"remote_ports": [{"pwwn": "2100000F00000003", "luns": {"type": "tape"}}]},
                                 {"remote_ports": [{"pwwn": "2100000F00000004", "luns": {"count": 2}}]}]}]})";

using Texts = std::vector<std::string>;
using Requests = std::vector<hxasim::Request>;

struct Fault_Sweep : Inventory_Test
{
    Texts sorted_instances(const Enumeration& row)
    {
        Texts texts;
        for (const Instance* instance : row.get_instances(row.id, {}))
            texts.push_back(describe(instance));
        std::ranges::sort(texts);
        return texts;
    }

    // What is left of them when this happens to one request.
    Texts struck_instances(const Enumeration& row, hxasim::Fault fault, const hxasim::Fault& effect)
    {
        fault.error = effect.error;
        fault.status = effect.status;
        fault.scsi_status = effect.scsi_status;
        fault.garbage = effect.garbage;
        log();
        hxasim::inject(fault);
        const Texts texts = sorted_instances(row);
        hxasim::clear_faults();
        return texts;
    }
};

Texts without(const Texts& sorted, const Texts& others)
{
    Texts texts;
    std::ranges::set_difference(sorted, others, std::back_inserter(texts));
    return texts;
}

bool is_of_adapters(classId_t id)
{
    return id == CLASSID_PortController || id == CLASSID_PhysicalPackage || id == CLASSID_Product ||
           id == CLASSID_AdapterSoftwareIdentity;
}

hxa_ioctl_scsi_t scsi_record(const hxasim::Request& request)
{
    hxa_ioctl_scsi_t record{};
    if (request.name == "IOCMD_SCSI_CMND")
        std::memcpy(&record, request.sent.data(), sizeof record);
    return record;
}

bool is_inquiry(const hxasim::Request& request, int page)
{
    const hxa_ioctl_scsi_t record = scsi_record(request);
    return record.cdb.scsi_cdb[0] == 0x12 && record.cdb.scsi_cdb[2] == page;
}

// Whether the same was asked before.
bool is_repeated(const Requests& sent, std::size_t at)
{
    const auto is_same = [&](const hxasim::Request& before)
    {
        const hxa_ioctl_scsi_t scsi = scsi_record(before), that = scsi_record(sent[at]);
        return before.command == sent[at].command && before.node == sent[at].node && before.instance == sent[at].instance &&
               scsi.rpwwn == that.rpwwn && scsi.lun == that.lun && std::ranges::equal(scsi.cdb.scsi_cdb, that.cdb.scsi_cdb);
    };
    return std::any_of(sent.begin(), sent.begin() + static_cast<std::ptrdiff_t>(at), is_same);
}

// What stands in all instances, and only in those, that are made with the help of a request.
class Mark
{
public:
    Mark(classId_t id, const Requests& sent, std::size_t at)
    {
        const hxasim::Request& request = sent[at];
        constexpr Walk_Row row = {.source = "Mark", .iocs = Iocs::any};
        for (Adapter_Walk adapters(row); adapters.next();)
            for (Port_Walk ports(row, adapters.adapter()); ports.next();)
                for (const hxal_t* ioc : {ports.port().fc.get(), ports.port().ethernet.get()})
                    if (ioc && ioc->instance == request.instance && request.node == ioc->devpath)
                        is_of_adapters(id) ? name_adapter(ports.port(), *ioc) : name_port(ports.port());
        if (request.name == "IOCMD_LPORT_GET_RPORTS")
            _part = _any_of.front() + '_';
        if (request.name == "IOCMD_FLASH_GET_ATTR")
            _part = "_bios";
        if (request.name == "IOCMD_SCSI_CMND" || request.name == "IOCMD_RPORT_GET_ATTR")
            name_target(sent, at);
    }

    bool is_in(const std::string& text) const
    {
        const auto stands = [&](const std::string& part) { return text.find(part) != std::string::npos; };
        return std::ranges::any_of(_any_of, stands) && stands(_part) && stands(_unit);
    }

private:
    void name_adapter(const Open_Port& port, const hxal_t& ioc)
    {
        const std::string address = ProviderUtil::getAddrByAdapterId(port.adapter).c_str();
        _any_of = {address, address.substr(4), std::string(ioc.serialnum, strnlen(ioc.serialnum, sizeof ioc.serialnum))};
        if (port.adapter == 1) // tells of the drivers
            _any_of.insert(_any_of.end(), {"\"hxn\"", "\"hxa\""});
    }

    void name_port(const Open_Port& port)
    {
        if (port.fc)
            _any_of.push_back(ProviderUtil::wwn_text(hxal_ioc_get_pwwn(port.fc.get())).c_str());
        if (port.ethernet)
            _any_of.push_back(ProviderUtil::mac_text(port.ethernet->mac).c_str());
        _any_of.push_back("_" + std::to_string(port.adapter) + "_" + std::to_string(port.index) + "\"");
    }

    // LUN 0 is asked what kind of target it is in, then what is there, then what it is itself.
    void name_target(const Requests& sent, std::size_t at)
    {
        wwn_t wwn;
        std::memcpy(&wwn, sent[at].sent.data() + 16, sizeof wwn);
        _part = ProviderUtil::wwn_text(wwn).c_str();
        const int lun = sent[at].sent[25];
        if (lun > 0 || is_inquiry(sent[at], 0x80) || is_inquiry(sent[at], 0x83) ||
            (is_inquiry(sent[at], 0) && is_repeated(sent, at)))
            _unit = "_LUN_" + std::to_string(lun) + '"';
    }

    Texts _any_of;
    std::string _part, _unit;
};

// Whether a card is enabled is the library's to find out, and to say.
bool is_told_by_the_library(classId_t id, const Requests& sent, std::size_t at)
{
    return id == CLASSID_PortController && sent[at].name == "IOCMD_IOC_GET_ATTR" && is_repeated(sent, at);
}

// Whether something else can give the same answer: a CNA's other side, the library's memory, the page that is asked for anyhow.
bool has_a_substitute(classId_t id, const Requests& sent, std::size_t at)
{
    const bool is_of_cna = sent[at].instance == 0 || sent[at].node == "/dev/hxn";
    return is_told_by_the_library(id, sent, at) || (is_of_adapters(id) && is_of_cna && sent[at].name.starts_with("IOCMD_IOC_")) ||
           (is_inquiry(sent[at], 0x83) && at + 1 < sent.size() && is_inquiry(sent[at + 1], 0x80));
}

// What the log calls the request when it fails.
std::string name_of_failure(const hxasim::Request& request)
{
    if (request.name == "IOCMD_SCSI_CMND")
        return scsi_record(request).cdb.scsi_cdb[0] == 0x12 ? "endSCSIInquiry" : "Reportlun had issue";
    if (request.name == "IOCMD_FLASH_GET_ATTR")
        return "hxal_ioc_get_attr call failed";
    std::string name = "hxal_" + request.name.substr(std::strlen("IOCMD_"));
    std::ranges::transform(name, name.begin(), [](unsigned char c) { return static_cast<char>(std::tolower(c)); });
    return name;
}

} // namespace

TEST_F(Fault_Sweep, costs_what_depends_on_the_request_and_nothing_else)
{
    // Garbage is a whole record but for its status, and all data; in it the SCSI status is garbage too, or good.
    const hxasim::Fault effects[] = {{.error = EIO},
                                     {.status = HXA_STATUS_FAILED},
                                     {.scsi_status = 2},
                                     {.garbage = 1},
                                     {.garbage = 2},
                                     {.scsi_status = 0, .garbage = 1},
                                     {.scsi_status = 0, .garbage = 2}};
    for (const Enumeration& row : enumerations)
    {
        if (row.id == CLASSID_DiagnosticSoftwareIdentity)
            continue; // tells the version of whichever driver answers first
        plug_text(two_cards);
        const Texts before = sorted_instances(row);
        const Requests sent = hxasim::take_requests();
        const Texts usual_log = log();
        for (std::size_t i = 0; i < sent.size(); i++)
        {
            const Mark mark(row.id, sent, i);
            const auto is_marked = [&](const std::string& instance) { return mark.is_in(instance); };
            const auto marked = static_cast<std::size_t>(std::ranges::count_if(before, is_marked));
            for (const hxasim::Fault& effect : effects)
            {
                if (effect.scsi_status && sent[i].name != "IOCMD_SCSI_CMND")
                    continue;
                SCOPED_TRACE(std::string(row.meta_class->name) + ' ' + sent[i].name + ' ' + std::to_string(i) + ' ' +
                             std::to_string(&effect - effects));
                const Texts after = struck_instances(row, hxasim::fault_at(sent, i), effect);
                Texts said = log();
                const Texts lost = without(before, after), gained = without(after, before);
                EXPECT_THAT(lost, testing::Each(testing::Truly(is_marked)));
                if (effect.garbage)
                    continue; // may be believed
                EXPECT_THAT(gained, testing::Each(testing::Truly(is_marked)));
                EXPECT_LE(gained.size(), lost.size());
                // With a substitute one may change, and only what a side alone tells of, its driver or the boot code, is missing.
                const std::size_t may_be_missing = row.id == CLASSID_AdapterSoftwareIdentity ? 1 : 0;
                EXPECT_TRUE(has_a_substitute(row.id, sent, i) ? lost.size() <= gained.size() + may_be_missing
                                                              : lost.size() == marked)
                    << lost.size() << " of " << marked;
                std::erase_if(said, [&](const std::string& line) { return std::ranges::count(usual_log, line) > 0; });
                if (!is_told_by_the_library(row.id, sent, i))
                {
                    EXPECT_THAT(said, testing::Contains(testing::HasSubstr(name_of_failure(sent[i]))));
                }
            }
        }
        hxasim::take_requests();
    }
}
