#include "inventory/fc_port_statistics.h"

#include "runtime/trace.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "PortHelper";
constexpr uint64 bytes_per_word = 4; // FC-FS

void set_fc(ZEMLAR_FCPortStatistics& out, const fc_port_counters& in)
{
    out.BytesTransmitted.set(in.tx_words * bytes_per_word);
    out.BytesReceived.set(in.rx_words * bytes_per_word);
    out.PacketsTransmitted.set(in.tx_frames);
    out.PacketsReceived.set(in.rx_frames);
    out.LIPCount.set(in.rx_lip);
    out.NOSCount.set(in.rx_nos);
    out.ErrorFrames.set(in.errored_frames);
    out.DumpedFrames.set(in.dropped_frames);
    out.LinkFailures.set(in.link_failures);
    out.LossOfSignalCounter.set(in.loss_of_signals);
    out.LossOfSyncCounter.set(in.loss_of_syncs);
    out.PrimitiveSeqProtocolErrCount.set(in.primitive_sequence_errors);
    out.CRCErrors.set(in.crc_errors);
    out.InvalidTransmissionWords.set(in.invalid_words);
}

// What only a Fibre Channel link has is 0.
void set_fcoe(ZEMLAR_FCPortStatistics& out, const eth_port_counters& in)
{
    out.BytesTransmitted.set(in.tx_bytes);
    out.BytesReceived.set(in.rx_bytes);
    out.PacketsTransmitted.set(in.tx_packets);
    out.PacketsReceived.set(in.rx_packets);
    out.LIPCount.set(0);
    out.NOSCount.set(0);
    out.ErrorFrames.set(in.rx_jabber + in.tx_jabber + in.rx_fcs_errors + in.rx_alignment_errors + in.rx_frame_length_errors);
    out.DumpedFrames.set(in.rx_drops);
    out.LinkFailures.set(0);
    out.LossOfSignalCounter.set(0);
    out.LossOfSyncCounter.set(0);
    out.PrimitiveSeqProtocolErrCount.set(0);
    out.CRCErrors.set(in.rx_fcs_errors);
    out.InvalidTransmissionWords.set(0);
}

} // namespace

Ref<ZEMLAR_FCPortStatistics> getFCPortStatisticsInstance(const _hbaPortInfo& info, const prov_pport_stats_u& statistics,
                                                         bool is_fcoe)
{
    const Scope_Trace trace(log_source);
    Ref<ZEMLAR_FCPortStatistics> instance(ZEMLAR_FCPortStatistics::create());
    instance->InstanceID.set(info.address);
    instance->ElementName.set("FC Port Statistics");
    if (is_fcoe)
        set_fcoe(*instance.ptr(), statistics.eth);
    else
        set_fc(*instance.ptr(), statistics.fc);
    return instance;
}

} // namespace zmlr
