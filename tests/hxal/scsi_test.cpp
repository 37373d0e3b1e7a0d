// SCSI commands to simulated targets: what arrives in the caller's buffers.
#include "simulated_host.h"

namespace
{

using testing::ElementsAre;
using testing::IsEmpty;
using Bytes = std::vector<std::uint8_t>;

std::uint64_t number(const Bytes& bytes, std::size_t at, std::size_t size)
{
    std::uint64_t value = 0;
    for (std::size_t i = 0; i < size; ++i)
        value = value << 8 | bytes.at(at + i);
    return value;
}

std::string text(const Bytes& bytes, std::size_t at, std::size_t size)
{
    return {bytes.begin() + static_cast<std::ptrdiff_t>(at), bytes.begin() + static_cast<std::ptrdiff_t>(at + size)};
}

constexpr wwn_t no_wwn = 0;
const wwn_t target = wwn({0x21, 0, 0, 0, 0, 0, 0, 1});

// One HBA and a target behind its first port.
class Scsi : public Simulated_Host
{
protected:
    // Everything that a command brings back.
    struct Answer
    {
        hxa_status_t status = HXA_STATUS_OK;
        std::uint8_t scsi_status = 0xEE;
        Bytes data;
        Bytes sense;
    };

    void plug(const std::string& keys, const std::string& port = "")
    {
        scan(R"({"adapters": [{"kind": "fc-hba", "ports": [{)" + port +
             R"("remote_ports": [{"pwwn": "2100000000000001", "nwwn": "200000A0B0C0D0E0")" + keys + "}]}]}]}");
        ioc = hxal_ioc_open_idx(0);
    }

    Answer send(decltype(&hxal_scsi_inquiry) function, lun_t unit, std::size_t room, scsi_cdb_t cdb = {},
                std::uint32_t sense_room = 18) const
    {
        Answer answer{.data = Bytes(room, 0xEE), .sense = Bytes(sense_room, 0xEE)};
        answer.status = function(ioc, 0, ioc->pwwn, target, unit, &cdb, 0, answer.data.data(), static_cast<uint32_t>(room),
                                 &answer.scsi_status, answer.sense.data(), &sense_room);
        answer.sense.resize(sense_room);
        return answer;
    }

    Answer inquire(lun_t unit, std::size_t room, int page = -1) const
    {
        scsi_cdb_t cdb{};
        if (page >= 0)
            cdb = {{0, 1, static_cast<std::uint8_t>(page)}};
        return send(hxal_scsi_inquiry, unit, room, cdb);
    }

    static void expect_good(const Answer& answer)
    {
        EXPECT_EQ(answer.status, HXA_STATUS_OK);
        EXPECT_EQ(answer.scsi_status, 0);
        EXPECT_THAT(answer.sense, IsEmpty());
    }

    const hxal_t* ioc = nullptr;
};

TEST_F(Scsi, inquiry_tells_the_unit)
{
    plug(R"(, "luns": [{}, {"type": "tape", "vendor": "Maker", "product": "Streamer", "revision": "7"}, {"type": "changer"}])");
    const auto disk = inquire(0, 36);
    expect_good(disk);
    EXPECT_EQ(disk.data[0], 0);
    EXPECT_EQ(disk.data[1], 0);
    EXPECT_EQ(disk.data[4], 31);
    EXPECT_EQ(text(disk.data, 8, 28), "ZEMLAR  VIRTUAL DISK    1.00");
    const auto tape = inquire(lun({0, 1}), 40);
    EXPECT_EQ(tape.data[0], 1);
    EXPECT_EQ(tape.data[1], 0x80) << "removable";
    EXPECT_EQ(text(tape.data, 8, 28), "Maker   Streamer        7   ");
    EXPECT_EQ(tape.data[36], 0xEE) << "36 bytes, and no more";
    EXPECT_EQ(inquire(lun({0, 2}), 36).data[0], 8);
    EXPECT_EQ(inquire(lun({0, 3}), 36).data[0], 0x7F) << "nothing can be there";
    EXPECT_THAT(inquire(0, 5).data, ElementsAre(0, 0, 5, 0x12, 31));
}

TEST_F(Scsi, vital_product_data_identify_the_unit)
{
    struct Case
    {
        const char* keys;
        Bytes pages;
        Bytes serial;
        Bytes descriptor;
    };
    const auto of = [](const char* text) { return Bytes(text, text + std::strlen(text)); };
    // clang-format off
    const Case cases[] = {
        {R"("count": 3)", {0x00, 0x80, 0x83}, of("C0D0E000002"),
         {1, 3, 0, 16, 0x60, 0, 0, 0xA0, 0xB0, 0xC0, 0xD0, 0xE0, 0, 0, 0, 0, 0, 0, 0, 2}},
        {R"("count": 3, "serial": "S", "identification": "eui64")", {0x00, 0x80, 0x83}, of("S00002"),
         {1, 2, 0, 8, 0, 0xA0, 0xB0, 0xC0, 0xD0, 0xE0, 0, 2}},
        {R"("lun": 2, "serial": "SN-9", "vendor": "Maker", "identification": "t10")", {0x00, 0x80, 0x83}, of("SN-9"),
         {2, 1, 0, 12, 'M', 'a', 'k', 'e', 'r', ' ', ' ', ' ', 'S', 'N', '-', '9'}},
        {R"("lun": 2, "serial_page": false, "identification": "name")", {0x00, 0x83}, {},
         {3, 8, 0, 20, 'e', 'u', 'i', '.', '0', '0', 'A', '0', 'B', '0', 'C', '0', 'D', '0', 'E', '0', '0', '0', '0', '2'}},
        {R"("lun": 2, "serial": "X", "identification": "none")", {0x00, 0x80}, of("X"), {}},
        {R"("lun": 2, "serial": "X", "identification": "none", "descriptors": "0104000401020304")", {0x00, 0x80, 0x83}, of("X"),
         {1, 4, 0, 4, 1, 2, 3, 4}},
    };
    // clang-format on
    for (const auto& row : cases)
    {
        SCOPED_TRACE(row.keys);
        plug(R"(, "luns": {)" + std::string(row.keys) + "}");
        const auto unit = lun({0, 2});
        const std::pair<int, Bytes> pages[] = {{0x00, row.pages}, {0x80, row.serial}, {0x83, row.descriptor}};
        for (const auto& [page, contents] : pages)
        {
            const auto answer = inquire(unit, 4 + contents.size(), page);
            if (contents.empty())
            {
                EXPECT_EQ(answer.scsi_status, 2) << page;
                continue;
            }
            expect_good(answer);
            Bytes expected{0, static_cast<std::uint8_t>(page), 0, static_cast<std::uint8_t>(contents.size())};
            expected.insert(expected.end(), contents.begin(), contents.end());
            EXPECT_EQ(answer.data, expected) << page;
        }
    }
}

TEST_F(Scsi, report_luns_lists_all_units)
{
    plug(R"(, "luns": [{"count": 256}, {"count": 16130}, {"lun": 65535}])");
    const auto answer = send(hxal_scsi_reportluns, 0, 8 + 16387 * 8);
    expect_good(answer);
    EXPECT_EQ(number(answer.data, 0, 4), 16387u * 8);
    const std::pair<std::size_t, Bytes> entries[] = {{0, {0, 0}},
                                                     {255, {0, 255}},
                                                     {256, {0x41, 0}},
                                                     {16383, {0x7F, 0xFF}},
                                                     {16384, {0xD2, 0, 0x40, 0}},
                                                     {16386, {0xD2, 0, 0xFF, 0xFF}}};
    for (const auto& [index, lun_bytes] : entries)
    {
        Bytes expected = lun_bytes;
        expected.resize(8);
        const auto at = answer.data.begin() + 8 + static_cast<std::ptrdiff_t>(index) * 8;
        EXPECT_EQ(Bytes(at, at + 8), expected) << index;
        wwn_t unit;
        std::memcpy(&unit, &*at, sizeof unit);
        EXPECT_EQ(inquire(unit, 36).data[0], 0) << index;
    }
    const auto first = send(hxal_scsi_reportluns, 0, 16);
    EXPECT_EQ(number(first.data, 0, 4), 16387u * 8) << "the whole length, in a buffer that is too small";

    plug(R"(, "flat_luns": true, "luns": {"lun": 5})");
    EXPECT_THAT(send(hxal_scsi_reportluns, 0, 16).data, ElementsAre(0, 0, 0, 8, 0, 0, 0, 0, 0x40, 5, 0, 0, 0, 0, 0, 0));
    plug(R"(, "luns": {"count": 65536})");
    EXPECT_EQ(number(send(hxal_scsi_reportluns, 0, 8 + 65536 * 8).data, 0, 4), 65536u * 8);
}

TEST_F(Scsi, capacity_is_that_of_the_disk)
{
    plug(R"(, "luns": [{}, {"capacity": 3145728, "block_size": 512}, {"capacity": 1, "block_size": 4096}])");
    EXPECT_THAT(send(hxal_scsi_readcapacity, 0, 8).data, ElementsAre(0, 0x1F, 0xFF, 0xFF, 0, 0, 2, 0));
    EXPECT_THAT(send(hxal_scsi_readcapacity, lun({0, 1}), 8).data, ElementsAre(255, 255, 255, 255, 0, 0, 2, 0));
    const auto large = send(hxal_scsi_readcapacity16, lun({0, 1}), 32);
    expect_good(large);
    EXPECT_EQ(number(large.data, 0, 8), 0x17FFFFFFFu);
    EXPECT_EQ(number(large.data, 8, 4), 512u);
    EXPECT_EQ(number(large.data, 24, 8), 0u);
    EXPECT_EQ(number(send(hxal_scsi_readcapacity16, lun({0, 2}), 32).data, 4, 8), (255ull << 32) + 4096);
}

TEST_F(Scsi, command_that_the_unit_refuses_brings_sense)
{
    plug(R"(, "luns": [{}, {"state": "not-ready"}, {"type": "tape", "state": "no-medium"}])");
    struct Case
    {
        const char* name;
        decltype(&hxal_scsi_inquiry) function;
        scsi_cdb_t cdb;
        lun_t unit;
        std::uint8_t key, code; // 0: no sense
    };
    const auto other_command = [](const hxal_t* handle, uint16_t vf, wwn_t local, wwn_t remote, lun_t unit, scsi_cdb_t* cdb,
                                  int write, void* data, uint32_t size, uint8_t* status, void* sense, uint32_t* sense_size)
    { return hxal_scsi_cmnd(handle, vf, local, remote, unit, cdb, write, data, size, status, sense, sense_size); };
    // clang-format off
    const Case cases[] = {
        {"ready",                   hxal_scsi_testunitready,  {},             lun({0, 0}), 0, 0},
        {"not ready",               hxal_scsi_testunitready,  {},             lun({0, 1}), 2, 0x04},
        {"no medium",               hxal_scsi_testunitready,  {},             lun({0, 2}), 2, 0x3A},
        {"no such unit",            hxal_scsi_testunitready,  {},             lun({0, 3}), 5, 0x25},
        {"capacity, not ready",     hxal_scsi_readcapacity,   {},             lun({0, 1}), 2, 0x04},
        {"inquiry, not ready",      hxal_scsi_inquiry,        {},             lun({0, 1}), 0, 0},
        {"inquiry, no such page",   hxal_scsi_inquiry,        {{0, 1, 0xB0}}, lun({0, 0}), 5, 0x24},
        {"inquiry, page not vital", hxal_scsi_inquiry,        {{0, 0, 0x80}}, lun({0, 0}), 5, 0x24},
        {"vital page, no unit",     hxal_scsi_inquiry,        {{0, 1, 0x00}}, lun({0, 3}), 5, 0x25},
        {"report luns elsewhere",   hxal_scsi_reportluns,     {},             lun({0, 9}), 5, 0x25},
        {"report luns, selected",   hxal_scsi_reportluns,     {{0, 0, 3}},    lun({0, 0}), 5, 0x24},
        {"bus 1",                   hxal_scsi_testunitready,  {},             lun({1, 0}), 5, 0x25},
        {"second level",            hxal_scsi_testunitready,  {},             lun({0, 0, 0, 1}), 5, 0x25},
        {"service action",          other_command,            {{0x9E, 0x11}}, lun({0, 0}), 5, 0x24},
        {"reading blocks",          other_command,            {{0x28}},       lun({0, 0}), 5, 0x20},
        {"reading blocks, no unit", other_command,            {{0x28}},       lun({0, 3}), 5, 0x25},
    };
    // clang-format on
    for (const auto& row : cases)
    {
        SCOPED_TRACE(row.name);
        const auto answer = send(row.function, row.unit, 64, row.cdb);
        EXPECT_EQ(answer.status, HXA_STATUS_OK);
        if (row.key == 0)
        {
            expect_good(answer);
            continue;
        }
        EXPECT_EQ(answer.scsi_status, 2);
        EXPECT_THAT(answer.sense, ElementsAre(0x70, 0, row.key, 0, 0, 0, 0, 10, 0, 0, 0, 0, row.code, 0, 0, 0, 0, 0));
        EXPECT_EQ(answer.data, Bytes(64, 0xEE));
    }
    plug(R"(, "luns": {"type": "tape"})");
    EXPECT_EQ(send(hxal_scsi_readcapacity, 0, 8).sense.at(12), 0x20) << "a tape has no blocks to count";
    EXPECT_THAT(send(hxal_scsi_readcapacity, 0, 8, {}, 3).sense, ElementsAre(0x70, 0, 5)) << "no more than there is room";
}

TEST_F(Scsi, command_that_reaches_no_unit_has_the_drivers_status)
{
    struct Case
    {
        const char* remote;
        const char* port;
        hxa_status_t status;
    };
    // clang-format off
    const Case cases[] = {
        {R"(, "function": "initiator")",          "",                         HXA_STATUS_NO_FCPIM_NEXUS},
        {R"(, "nexus": {"state": "prli-retry"})", "",                         HXA_STATUS_NO_FCPIM_NEXUS},
        {R"(, "state": "logo")",                  "",                         HXA_STATUS_RPORT_OFFLINE},
        {"",                                      R"("state": "linkdown", )", HXA_STATUS_PORT_OFFLINE},
    };
    // clang-format on
    for (const auto& row : cases)
    {
        plug(row.remote, row.port);
        const auto answer = inquire(0, 36);
        EXPECT_EQ(answer.status, row.status) << row.remote << row.port;
        EXPECT_EQ(answer.data, Bytes(36, 0xEE));
    }
    plug("");
    scsi_cdb_t cdb{};
    std::uint8_t data[36];
    const auto inquiry = [&](wwn_t local, wwn_t remote)
    { return hxal_scsi_inquiry(ioc, 0, local, remote, 0, &cdb, 0, data, sizeof data, nullptr, nullptr, nullptr); };
    EXPECT_EQ(inquiry(ioc->pwwn, target), HXA_STATUS_OK);
    EXPECT_EQ(inquiry(no_wwn, target), HXA_STATUS_UNKNOWN_LWWN);
    EXPECT_EQ(inquiry(ioc->pwwn, no_wwn), HXA_STATUS_UNKNOWN_RWWN);
    EXPECT_EQ(hxal_scsi_cmnd(ioc, 0, ioc->pwwn, target, 0, &cdb, 1, data, sizeof data, nullptr, nullptr, nullptr),
              HXA_STATUS_EINVAL)
        << "an INQUIRY does not write";
}

TEST_F(Scsi, missing_buffers_are_refused_without_a_request)
{
    plug("");
    scsi_cdb_t cdb{};
    std::uint8_t data[8];
    std::uint32_t sense_room = 18;
    const auto send_with = [&](scsi_cdb_t* command, void* buffer)
    { return hxal_scsi_inquiry(ioc, 0, ioc->pwwn, target, 0, command, 0, buffer, sizeof data, nullptr, nullptr, &sense_room); };
    EXPECT_EQ(send_with(nullptr, data), HXA_STATUS_EINVAL);
    EXPECT_EQ(send_with(&cdb, nullptr), HXA_STATUS_EINVAL);
    EXPECT_EQ(send_with(&cdb, data), HXA_STATUS_EINVAL) << "room for sense data, but no buffer";
    EXPECT_THAT(requests(), IsEmpty());
    EXPECT_EQ(hxal_scsi_testunitready(ioc, 0, ioc->pwwn, target, 0, &cdb, 0, nullptr, 0, nullptr, nullptr, nullptr),
              HXA_STATUS_OK);
}

} // namespace
