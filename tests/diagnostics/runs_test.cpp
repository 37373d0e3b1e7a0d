// Every test on either kind of card, in service and out of it, and all that can go wrong: what is logged, recorded and sent, and
// how adapters and ports are left, against runs.txt.
#include "tests/diagnostics/diagnostics_fixture.h"

#include "hxal/records/status.h"

#include <algorithm>
#include <fstream>
#include <iomanip>
#include <iterator>
#include <sstream>

namespace
{

using hxasim::Fault;
using Faults = std::vector<Fault>;

struct Case
{
    const char* name; // of the test
    const char* title;
    const char* element_class;
    std::size_t element;
    Faults faults = {};
    const char* named_by = nullptr; // another class: the path carries the DeviceID of its element with this number
};

constexpr const char* FC = "ZEMLAR_FCPort";
constexpr const char* ETHERNET = "ZEMLAR_EthernetPort";
constexpr const char* ADAPTER = "ZEMLAR_PortController";

// Tests answer this status, and these bytes in their result.
Fault answers(const char* command, std::uint32_t status, std::size_t offset = 0, std::vector<std::uint8_t> bytes = {})
{
    Fault fault{.command = std::string("IOCMD_DIAG_") + command, .status = status};
    if (!bytes.empty())
        fault.answer = {{offset, std::move(bytes)}};
    return fault;
}

Fault refuses(const char* command, const char* node)
{
    return {.command = std::string("IOCMD_") + command, .node = node, .status = HXA_STATUS_DEVBUSY, .times = 1};
}

const std::vector<std::uint8_t> frames = {5, 0, 0, 0, 6, 0, 0, 0, 7, 0, 0,
                                          0, 8, 0, 0, 0, 9, 0, 0, 0, 90}; // a whole loopback result
std::vector<std::uint8_t> memory_result(std::uint8_t algorithm)
{
    return {90, 0, 0, 0, 0x10, 0x20, 0, 0, 0xAA, 0, 0, 0, 0xBB, 0, 0, 0, 1, 0, 0, 0, 2, 0, 0, 0, 3, 0, 0, 0, algorithm};
}

const Case cases[] = {
    {"MemoryTest", "of a CNA", ADAPTER, cna},
    {"MemoryTest", "of an HBA", ADAPTER, hba},
    {"MemoryTest", "of a disabled CNA", ADAPTER, disabled_cna},
    {"MemoryTest", "of a disabled HBA", ADAPTER, disabled_hba},
    {"MemoryTest", "that finds a fault by walk01", ADAPTER, hba, {answers("MEMTEST", 90, 16, memory_result(1))}},
    {"MemoryTest", "by marchy", ADAPTER, disabled_hba, {answers("MEMTEST", 90, 16, memory_result(2))}},
    {"MemoryTest", "by movi", ADAPTER, disabled_hba, {answers("MEMTEST", 90, 16, memory_result(8))}},
    {"MemoryTest", "by tlapnpsf1t", ADAPTER, disabled_hba, {answers("MEMTEST", 90, 16, memory_result(16))}},
    {"MemoryTest", "by who knows what", ADAPTER, disabled_hba, {answers("MEMTEST", 90, 16, memory_result(4))}},
    {"MemoryTest", "of an adapter half of which refuses to stop", ADAPTER, cna, {refuses("IOC_DISABLE", "/dev/hxn")}},
    {"MemoryTest", "of a CNA that refuses to stop", ADAPTER, cna, {refuses("IOC_DISABLE", "/dev/hxa")}},
    {"MemoryTest", "of an HBA that refuses to stop", ADAPTER, hba, {refuses("IOC_DISABLE", "/dev/hxa")}},

    {"InternalLoopbackTest", "of an HBA's port", FC, hba_port},
    {"InternalLoopbackTest", "of an HBA's disabled port", FC, hba_port_out},
    {"ExternalLoopbackTest", "of an HBA's port", FC, hba_port},
    {"ExternalLoopbackTest", "of an HBA's disabled port", FC, hba_port_out},
    {"ExternalLoopbackTest", "of a CNA's port", FC, cna_port},
    {"ExternalLoopbackTest", "of a CNA's disabled port", FC, cna_port_out},
    {"SerdesLoopbackTest", "of a CNA's port", FC, cna_port},
    {"SerdesLoopbackTest", "of a CNA's port by its MAC address", FC, cna_port, {}, ETHERNET},
    {"SerdesLoopbackTest", "of an HBA's port", FC, hba_port},
    {"SerdesLoopbackTest", "of an HBA's disabled port", FC, hba_port_out},
    {"SerdesLoopbackTest", "with a bad frame header", FC, hba_port_out, {answers("LOOPBACK", 48, 24, frames)}},
    {"SerdesLoopbackTest", "with a bad frame size", FC, cna_port, {answers("LOOPBACK", 49, 24, frames)}},
    {"SerdesLoopbackTest", "that the driver refuses", FC, hba_port, {answers("LOOPBACK", HXA_STATUS_DIAG_BUSY)}},
    {"SerdesLoopbackTest", "with a bad result", FC, hba_port_out, {answers("LOOPBACK", 0, 24, frames)}},
    {"SerdesLoopbackTest", "of an HBA's port that refuses to go", FC, hba_port, {refuses("PORT_DISABLE", "/dev/hxa")}},
    {"SerdesLoopbackTest", "of a port whose FC side refuses to go", FC, cna_port, {refuses("PORT_DISABLE", "/dev/hxa")}},
    {"SerdesLoopbackTest", "of a port whose Ethernet side refuses to go", FC, cna_port, {refuses("PORT_DISABLE", "/dev/hxn")}},

    {"ExternalEthLoopbackTest", "of a port", ETHERNET, cna_port},
    {"ExternalEthLoopbackTest", "of a disabled port", ETHERNET, cna_port_out},
    {"SerdesEthLoopbackTest", "of a port", ETHERNET, cna_port},
    {"SerdesEthLoopbackTest", "with a bad frame header", ETHERNET, cna_port, {answers("LL_LOOPBACK", 48, 20, frames)}},
    {"SerdesEthLoopbackTest", "with a bad frame size", ETHERNET, cna_port, {answers("LL_LOOPBACK", 49, 20, frames)}},
    {"SerdesEthLoopbackTest", "that the driver refuses", ETHERNET, cna_port_out, {answers("LL_LOOPBACK", HXA_STATUS_DIAG_BUSY)}},
    {"SerdesEthLoopbackTest", "with a bad result", ETHERNET, cna_port_out, {answers("LL_LOOPBACK", 0, 20, frames)}},
    {"SerdesEthLoopbackTest", "with an unknown failure", ETHERNET, cna_port_out, {answers("LL_LOOPBACK", 0, 40, {1})}},
    {"SerdesEthLoopbackTest", "of a port whose FC side refuses to go", ETHERNET, cna_port, {refuses("PORT_DISABLE", "/dev/hxa")}},
    {"SerdesEthLoopbackTest",
     "of a port whose Ethernet side refuses to go",
     ETHERNET,
     cna_port,
     {refuses("PORT_DISABLE", "/dev/hxn")}},

    {"PCILoopbackTest", "of an HBA's port", FC, hba_port},
    {"PCILoopbackTest", "of a CNA's disabled port", FC, cna_port_out},
    {"PCILoopbackTest", "of an Ethernet port", ETHERNET, cna_port},
    {"PCILoopbackTest", "of a disabled Ethernet port", ETHERNET, cna_port_out},
    {"PCILoopbackTest", "that fails", ETHERNET, cna_port, {answers("FWPING", HXA_STATUS_DATACORRUPTED)}},
};

class Runs : public Diagnostics
{
protected:
    static std::string test_class(const std::string& name)
    {
        const std::string kind = name == "MemoryTest"                    ? "Memory"
                                 : name == "PCILoopbackTest"             ? "PCILoopback"
                                 : name.find("Eth") != std::string::npos ? "EthLoopback"
                                                                         : "Loopback";
        return "ZEMLAR_" + kind + "DiagnosticTest";
    }

    struct Record
    {
        int number;
        std::string kind;
        std::string text;
    };

    // The records from that number on, in the order of their numbers, whichever list they are in.
    static std::vector<Record> records(int first, const std::string& label)
    {
        std::vector<Record> all;
        for (const char* kind : {"Service", "Completion"})
            for (const auto& record : enumerate(std::string("ZEMLAR_Diagnostic") + kind + "Record"))
            {
                const std::string id = value(record, "InstanceID");
                const int number = std::stoi(id.substr(id.rfind(':') + 1));
                if (number < first)
                    continue;
                EXPECT_EQ(id, label + ':' + std::to_string(number));
                EXPECT_EQ(value(record, "ServiceName"), label);
                EXPECT_EQ(value(record, "RecordType"), kind[0] == 'S' ? "4" : "6");
                const std::string state = value(record, "CompletionState");
                all.push_back({number, state.empty() ? "note" : state == "2" ? "passed" : "failed", value(record, "RecordData")});
            }
        std::ranges::sort(all, {}, &Record::number);
        for (const Record& record : all)
            EXPECT_EQ(record.number, first++);
        return all;
    }

    // A line for each line of the log, told with its record if it has one.
    static std::string told(const std::vector<std::string>& log, const std::vector<Record>& records)
    {
        std::string text;
        auto record = records.begin();
        const auto tell = [&] { text += record->kind + ": " + record->text + '\n'; };
        for (const std::string& line : log)
        {
            const std::string level = line.substr(0, line.find(' '));
            text += "    " + level + ' ';
            if (record != records.end() && line == level + ' ' + record->text)
            {
                tell();
                ++record;
            }
            else
                text += line.substr(level.size() + 1) + '\n';
        }
        for (; record != records.end(); ++record)
        {
            text += "    - ";
            tell();
        }
        return text;
    }

    // The 16 bytes behind the head of the record.
    static std::string parameters(const std::vector<std::uint8_t>& record)
    {
        std::ostringstream text;
        for (std::size_t i = 8; i < 24; ++i)
            text << std::hex << std::setw(2) << std::setfill('0') << int{record.at(i)} << (i % 4 == 3 ? " " : "");
        return text.str().substr(0, 35);
    }

    static std::string pause_before(const hxasim::Request& request)
    {
        const auto slept = std::chrono::duration_cast<std::chrono::seconds>(request.slept).count();
        return slept > 0 ? "    after " + std::to_string(slept) + " s " : "    ";
    }

    static std::string sent()
    {
        std::string text;
        for (const auto& request : hxasim::take_requests())
        {
            text += pause_before(request) + request.name.substr(6) + ' ' + request.node.substr(5) + ' ' +
                    std::to_string(request.instance);
            if (request.name.starts_with("IOCMD_DIAG_") && request.name != "IOCMD_DIAG_LB_STAT")
                text += " with " + parameters(request.sent);
            text += '\n';
        }
        enumerate(FC);
        return text + pause_before(hxasim::take_requests().at(0)) + "the end\n";
    }

    static std::string sees(const Case& each)
    {
        static int next_number = 1;
        const std::string before = states();
        auto element = path(each.element_class, each.element);
        if (each.named_by)
            cimserver::put(element.keys, "DeviceID", {CMPI_string, value(enumerate(each.named_by).at(each.element), "DeviceID")});
        for (const Fault& fault : each.faults)
            hxasim::inject(fault);
        hxasim::take_requests();
        new_log();

        const Answer answer = run(test_class(each.name), each.name, element);
        wait_for_end();
        hxasim::clear_faults();
        std::string text = std::string(each.name) + ' ' + each.title + ": " + answer.code + ' ' + answer.job + '\n';
        const std::string requests = sent();
        const auto left = records(next_number, answer.job);
        next_number += static_cast<int>(left.size());
        text += told(new_log(), left) + "  sent\n" + requests;
        EXPECT_EQ(states(), before) << text;
        const auto jobs = enumerate("ZEMLAR_ConcreteJob");
        EXPECT_EQ(jobs.size(), 1U);
        EXPECT_EQ(value(jobs.at(0), "JobState") + ' ' + value(jobs.at(0), "PercentComplete"), "7 100") << text;
        return text;
    }
};

} // namespace

const bool wants_log = true;

TEST_F(Runs, are_told_step_by_step)
{
    std::string seen;
    for (const Case& each : cases)
        seen += sees(each) + '\n';
    if (const char* file = std::getenv("RUNS_WRITE"))
        std::ofstream(file) << seen;
    std::ostringstream expected;
    expected << std::ifstream(RUNS_TEXT).rdbuf();
    EXPECT_EQ(seen, expected.str());
}
