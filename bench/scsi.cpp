// SCSI discovery behind one target: REPORT LUNS, and a standard INQUIRY to every unit, from the access library down.
//
// Under callgrind with --collect-atstart=no only the commands are counted.

#include "hxal/hxal.h"
#include "sim/hxasim.h"

#include <benchmark/benchmark.h>
#include <valgrind/callgrind.h>

#include <cstring>
#include <string>
#include <vector>

namespace
{

constexpr uint32_t header_size = 8;
constexpr uint32_t inquiry_size = 36;

// An HBA with a target of so many units, and a handle to reach it.
class Target
{
public:
    explicit Target(int64_t units) : _list(header_size + static_cast<size_t>(units) * sizeof(lun_t))
    {
        hxasim::load_text(R"({"adapters": [{"kind": "fc-hba", "ports": [{"remote_ports": {"luns": {"count": )" +
                          std::to_string(units) + "}}}]}]}");
        hxal_libinit(hxa_aen_app_cim);
        hxal_adapter_scan();
        _ioc = hxal_ioc_open_idx(0);
        uint32_t room = 1;
        hxal_lport_get_rports(_ioc, 0, _ioc->pwwn, &_wwn, &room);
    }

    bool report_luns()
    {
        scsi_cdb_t cdb{};
        return send(hxal_scsi_reportluns, 0, cdb, _list.data(), static_cast<uint32_t>(_list.size()));
    }

    // How many units answer.
    int64_t inquire_all()
    {
        int64_t answers = 0;
        for (size_t at = header_size; at < _list.size(); at += sizeof(lun_t))
        {
            lun_t lun;
            std::memcpy(&lun, &_list[at], sizeof lun);
            scsi_cdb_t cdb{};
            uint8_t data[inquiry_size];
            answers += send(hxal_scsi_inquiry, lun, cdb, data, sizeof data);
        }
        return answers;
    }

private:
    bool send(decltype(&hxal_scsi_inquiry) function, lun_t lun, scsi_cdb_t& cdb, void* data, uint32_t size)
    {
        uint8_t scsi_status = 0;
        uint8_t sense[18];
        uint32_t sense_size = sizeof sense;
        return function(_ioc, 0, _ioc->pwwn, _wwn, lun, &cdb, 0, data, size, &scsi_status, sense, &sense_size) == HXA_STATUS_OK &&
               scsi_status == 0;
    }

    const hxal_t* _ioc;
    wwn_t _wwn = 0;
    std::vector<uint8_t> _list;
};

void report_luns(benchmark::State& state)
{
    Target target(state.range(0));
    for (auto _ : state)
    {
        CALLGRIND_TOGGLE_COLLECT;
        const bool good = target.report_luns();
        CALLGRIND_TOGGLE_COLLECT;
        if (!good)
            state.SkipWithError("REPORT LUNS failed");
    }
    state.counters["time/LUN"] = benchmark::Counter(static_cast<double>(state.range(0)),
                                                    benchmark::Counter::kIsIterationInvariantRate | benchmark::Counter::kInvert);
}

void inquire_luns(benchmark::State& state)
{
    Target target(state.range(0));
    target.report_luns();
    for (auto _ : state)
    {
        CALLGRIND_TOGGLE_COLLECT;
        const int64_t answers = target.inquire_all();
        CALLGRIND_TOGGLE_COLLECT;
        if (answers != state.range(0))
            state.SkipWithError("a unit did not answer");
    }
    state.counters["time/LUN"] = benchmark::Counter(static_cast<double>(state.range(0)),
                                                    benchmark::Counter::kIsIterationInvariantRate | benchmark::Counter::kInvert);
}

} // namespace

BENCHMARK(report_luns)->Arg(10)->Arg(1000)->Arg(10000)->Unit(benchmark::kMicrosecond);
BENCHMARK(inquire_luns)->Arg(10)->Arg(1000)->Arg(10000)->Unit(benchmark::kMicrosecond);

BENCHMARK_MAIN();
