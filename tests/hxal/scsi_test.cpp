// SCSI commands: what a caller gets back, and what is refused before a request. The commands themselves stand in the table of
// operations.
#include "tests/hxal/library_fixture.h"

namespace
{

using testing::ElementsAre;

// One HBA, and a target with one unit behind its first port.
class Scsi : public Library_Test
{
protected:
    Scsi()
    {
        scan(R"({"adapters": [{"kind": "fc-hba", "ports": [{"remote_ports": [{"pwwn": "2100000000000001"}]}]}]})");
        ioc = hxal_ioc_open_idx(0);
    }

    hxa_status_t send(decltype(&hxal_scsi_inquiry) function, lun_t unit = 0)
    {
        sense_size = sizeof sense;
        return function(ioc, 0, ioc->pwwn, target, unit, &cdb, 0, data, sizeof data, &scsi_status, sense, &sense_size);
    }

    const wwn_t target = wwn({0x21, 0, 0, 0, 0, 0, 0, 1});
    const hxal_t* ioc = nullptr;
    scsi_cdb_t cdb{};
    std::uint8_t data[8] = {};
    std::uint8_t scsi_status = 0xEE;
    std::uint8_t sense[3] = {};
    std::uint32_t sense_size = 0;
};

TEST_F(Scsi, answers_arrive_in_the_callers_buffers)
{
    EXPECT_EQ(send(hxal_scsi_readcapacity), HXA_STATUS_OK);
    EXPECT_THAT(data, ElementsAre(0, 0x1F, 0xFF, 0xFF, 0, 0, 2, 0));
    EXPECT_EQ(scsi_status, 0);
    EXPECT_EQ(sense_size, 0u);

    EXPECT_EQ(send(hxal_scsi_testunitready, lun({0, 3})), HXA_STATUS_OK) << "refused by the target, not by the driver";
    EXPECT_EQ(scsi_status, 2);
    EXPECT_THAT(sense, ElementsAre(0x70, 0, 5)) << "no more than there is room";
    EXPECT_EQ(sense_size, sizeof sense);

    EXPECT_EQ(hxal_scsi_testunitready(ioc, 0, ioc->pwwn, target, 0, &cdb, 0, nullptr, 0, nullptr, nullptr, nullptr),
              HXA_STATUS_OK);
    EXPECT_EQ(hxal_scsi_testunitready(ioc, 0, ioc->pwwn, 0, 0, &cdb, 0, nullptr, 0, nullptr, nullptr, nullptr),
              HXA_STATUS_UNKNOWN_RWWN);
}

TEST_F(Scsi, missing_buffers_are_refused_without_a_request)
{
    std::uint32_t sense_room = 18;
    const auto send_with = [&](scsi_cdb_t* command, void* buffer)
    { return hxal_scsi_inquiry(ioc, 0, ioc->pwwn, target, 0, command, 0, buffer, sizeof data, nullptr, nullptr, &sense_room); };
    EXPECT_EQ(send_with(nullptr, data), HXA_STATUS_EINVAL);
    EXPECT_EQ(send_with(&cdb, nullptr), HXA_STATUS_EINVAL);
    EXPECT_EQ(send_with(&cdb, data), HXA_STATUS_EINVAL) << "room for sense data, but no buffer";
    EXPECT_THAT(requests(), testing::IsEmpty());
}

} // namespace
