// What converting one FC port for the broker costs, beside the broker calls that it cannot do without: those that make the
// same path and set the same non-null properties, from values that are at hand.

#include "bench/simulated_host.h"
#include "cimserver/broker/objects.h"
#include "cimserver/broker/request.h"
#include "cmpi/converter.h"
#include "schema/ZEMLAR_FCPort.h"

#include <benchmark/benchmark.h>
#include <valgrind/callgrind.h>

#include <cmpimacs.h>

namespace
{

using cimserver::Value;

constexpr int ports_per_iteration = 100;
constexpr const char* name_space = "root/zemlar";

// One port as the module reports it, and a broker for it.
class Port
{
public:
    Port()
    {
        bench::Simulated_Host host(bench::two_port_hbas(1));
        wire = host.operations().enumerate_instances("ZEMLAR_FCPort", true, std::nullopt).at(0);
        properties = wire.properties;
        auto& object = cimserver::make<cimserver::Instance_Object>(wire);
        zmlr::make_cimple_instance(broker(), &zmlr::ZEMLAR_FCPort::static_meta_class,
                                   cimserver::make<cimserver::Path_Object>(wire.path).face(), object.face(), instance);
    }

    const CMPIBroker* broker() const { return _broker.face(); }

    cimserver::Instance wire;
    std::vector<cimserver::Named_Value> properties; // its
    zmlr::Ref<zmlr::Instance> instance;

private:
    static constexpr zmlr::Registration registration = {"bench", "ZEMLAR_FCPort_Provider", nullptr,
                                                        &zmlr::ZEMLAR_FCPort::static_meta_class, nullptr};
    cimserver::Request _request;
    cimserver::Repository _repository{&registration};
    cimserver::Broker _broker{_repository};
};

void convert(const Port& port)
{
    zmlr::CMPI_Ptr<CMPIInstance> instance;
    zmlr::make_cmpi_object(port.broker(), port.instance, name_space, nullptr, instance);
}

// ---- the bare calls ----

// Gives set(value, type) the CMPI value of a scalar and releases what was made for it.
template <class Set> void with_scalar(const CMPIBroker* broker, const Value& value, Set set)
{
    CMPIValue data{};
    if (const auto* text = value.as<cimserver::Text>())
    {
        if (value.type == CMPI_dateTime)
        {
            data.dateTime = CMNewDateTimeFromChars(broker, text->c_str(), nullptr);
            set(&data, value.type);
            CMRelease(data.dateTime);
            return;
        }
        data.string = CMNewString(broker, text->c_str(), nullptr);
        set(&data, value.type);
        CMRelease(data.string);
        return;
    }
    if (const auto* flag = value.as<bool>())
        data.boolean = *flag;
    else if (const auto* number = value.as<std::uint64_t>())
        data.uint64 = *number; // little-endian: the shorter types lie at its start
    else if (const auto* signed_number = value.as<std::int64_t>())
        data.sint64 = *signed_number;
    set(&data, value.type);
}

template <class Set> void with_value(const CMPIBroker* broker, const Value& value, Set set)
{
    const auto* elements = value.as<std::vector<Value>>();
    if (!elements)
        return with_scalar(broker, value, set);
    const auto element_type = static_cast<CMPIType>(value.type & ~CMPI_ARRAY);
    CMPIValue data{};
    data.array = CMNewArray(broker, static_cast<CMPICount>(elements->size()), element_type, nullptr);
    for (CMPICount i = 0; i < elements->size(); ++i)
        with_scalar(broker, (*elements)[i],
                    [&](const CMPIValue* element, CMPIType type) { CMSetArrayElementAt(data.array, i, element, type); });
    set(&data, value.type);
    CMRelease(data.array);
}

void call_broker(const Port& port)
{
    const CMPIBroker* broker = port.broker();
    CMPIObjectPath* path = CMNewObjectPath(broker, name_space, "ZEMLAR_FCPort", nullptr);
    for (const auto& key : port.wire.path.keys)
        with_value(broker, key.value,
                   [&](const CMPIValue* value, CMPIType type) { CMAddKey(path, key.name.string().c_str(), value, type); });
    CMPIInstance* instance = CMNewInstance(broker, path, nullptr);
    for (const auto& property : port.properties)
        if (!property.value.null())
            with_value(broker, property.value,
                       [&](const CMPIValue* value, CMPIType type)
                       { CMSetProperty(instance, property.name.string().c_str(), value, type); });
    CMRelease(instance);
    CMRelease(path);
}

template <void (*work)(const Port&)> void run(benchmark::State& state)
{
    const Port port;
    work(port);
    for (auto _ : state)
    {
        CALLGRIND_TOGGLE_COLLECT;
        for (int i = 0; i < ports_per_iteration; ++i)
            work(port);
        CALLGRIND_TOGGLE_COLLECT;
    }
    state.SetItemsProcessed(state.iterations() * ports_per_iteration);
}

} // namespace

BENCHMARK(run<convert>)->Name("convert_fc_port");
BENCHMARK(run<call_broker>)->Name("bare_broker_calls");

BENCHMARK_MAIN();
