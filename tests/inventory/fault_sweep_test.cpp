// Every request of every enumeration fails once, is refused once and is answered with garbage once: what does not depend on it
// stays as it was, and the log tells.
#include "hxal/hxal.h"
#include "inventory/adapter_lookup.h"
#include "inventory/adapter_walk.h"
#include "inventory/address_text.h"
#include "providers/enumerations.h"
#include "tests/inventory/inventory_fixture.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <iterator>

using namespace zmlr;

namespace
{

constexpr const char* two_cards = R"({"adapters": [
    {"kind": "cna", "flash": [{"type": "optrom", "status": "good"}], "ports": [
        {"remote_ports": [{"pwwn": "2100000F00000001", "luns": {"count": 2, "vendor": "A", "product": "DISK"}},
                          {"pwwn": "2100000F00000002", "luns": {"count": 1, "vendor": "A", "product": "DISK"}}]}, {}]},
    {"kind": "fc-hba", "ports": [
        {"remote_ports": [{"pwwn": "2100000F00000003", "luns": {"count": 1, "type": "tape", "vendor": "A", "product": "TAPE"}}]},
        {"remote_ports": [{"pwwn": "2100000F00000004", "luns": {"count": 2, "vendor": "A", "product": "DISK"}}]}]}]})";

using Texts = std::vector<std::string>;

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
};

bool is_of_adapters(classId_t id)
{
    return id == CLASSID_PortController || id == CLASSID_PhysicalPackage || id == CLASSID_Product ||
           id == CLASSID_AdapterSoftwareIdentity;
}

// What stands in all instances, and only in those, that are made with the help of a request.
class Mark
{
public:
    Mark(classId_t id, const hxasim::Request& request)
    {
        constexpr Walk_Row row = {.source = "Mark", .iocs = Iocs::any};
        for (Adapter_Walk adapters(row); adapters.next();)
            for (Port_Walk ports(row, adapters.adapter()); ports.next();)
                for (const hxal_t* ioc : {ports.port().fc.get(), ports.port().ethernet.get()})
                    if (ioc && ioc->instance == request.instance && request.node == ioc->devpath)
                        is_of_adapters(id) ? name_adapter(ports.port(), *ioc) : name_port(ports.port());
        if (request.name == "IOCMD_SCSI_CMND" || request.name == "IOCMD_RPORT_GET_ATTR")
            name_target(request);
    }

    bool is_in(const std::string& text) const
    {
        const auto stands = [&](const std::string& part) { return text.find(part) != std::string::npos; };
        return std::ranges::any_of(_any_of, stands) && stands(_target) && stands(_unit);
    }

private:
    void name_adapter(const Open_Port& port, const hxal_t& ioc)
    {
        const std::string address = ProviderUtil::getAddrByAdapterId(port.adapter).c_str();
        _any_of = {address, address.substr(4), std::string(ioc.serialnum, strnlen(ioc.serialnum, sizeof ioc.serialnum)),
                   "\"hxn\"", "\"hxa\""};
    }

    void name_port(const Open_Port& port)
    {
        if (port.fc)
            _any_of.push_back(ProviderUtil::wwn_text(hxal_ioc_get_pwwn(port.fc.get())).c_str());
        if (port.ethernet)
            _any_of.push_back(ProviderUtil::mac_text(port.ethernet->mac).c_str());
        _any_of.push_back("_" + std::to_string(port.adapter) + "_" + std::to_string(port.index) + "\"");
    }

    void name_target(const hxasim::Request& request)
    {
        wwn_t wwn;
        std::memcpy(&wwn, request.sent.data() + 16, sizeof wwn);
        _target = ProviderUtil::wwn_text(wwn).c_str();
        if (request.name == "IOCMD_SCSI_CMND" && request.sent[25] > 0)
            _unit = "_LUN_" + std::to_string(request.sent[25]) + '"';
    }

    Texts _any_of;
    std::string _target, _unit;
};

// Requests whose failure may leave the answer as it was: a CNA's other side, or the library's memory, stands in.
bool has_a_substitute(const hxasim::Request& request)
{
    return request.name == "IOCMD_IOC_GET_INFO" || request.name == "IOCMD_IOC_GET_ATTR" ||
           request.name == "IOCMD_LPORT_GET_RPORTS";
}

// Whether a card is enabled is the library's to find out, and to say.
bool is_told_by_the_library(classId_t id, const hxasim::Request& request)
{
    return id == CLASSID_PortController && request.name == "IOCMD_IOC_GET_ATTR";
}

} // namespace

TEST_F(Fault_Sweep, costs_what_depends_on_the_request_and_nothing_else)
{
    const hxasim::Fault effects[] = {{.error = EIO}, {.status = HXA_STATUS_FAILED}, {.garbage = 1}};
    for (const Enumeration& row : enumerations)
    {
        if (row.id == CLASSID_DiagnosticSoftwareIdentity)
            continue; // tells the version of whichever driver answers first
        plug_text(two_cards);
        const Texts before = sorted_instances(row);
        const std::vector<hxasim::Request> sent = hxasim::take_requests();
        const Texts usual_log = log();
        for (std::size_t i = 0; i < sent.size(); i++)
        {
            const Mark mark(row.id, sent[i]);
            for (const hxasim::Fault& effect : effects)
            {
                SCOPED_TRACE(std::string(row.meta_class->name) + ' ' + sent[i].name + ' ' + std::to_string(i) + ' ' +
                             std::to_string(&effect - effects));
                hxasim::Fault fault = hxasim::fault_at(sent, i);
                fault.error = effect.error;
                fault.status = effect.status;
                fault.garbage = effect.garbage;
                log();
                hxasim::inject(fault);
                const Texts after = sorted_instances(row);
                hxasim::clear_faults();

                Texts lost;
                std::ranges::set_difference(before, after, std::back_inserter(lost));
                for (const std::string& instance : lost)
                    EXPECT_TRUE(mark.is_in(instance)) << instance;
                const bool counts = std::ranges::any_of(before, [&](const std::string& text) { return mark.is_in(text); });
                if (effect.garbage || !counts)
                    continue;
                EXPECT_TRUE(before != after || has_a_substitute(sent[i]));
                if (is_told_by_the_library(row.id, sent[i]))
                    continue;
                const Texts said = log();
                EXPECT_TRUE(std::ranges::any_of(said, [&](const std::string& line)
                                                { return std::ranges::find(usual_log, line) == usual_log.end(); }));
            }
        }
        hxasim::take_requests();
    }
}
