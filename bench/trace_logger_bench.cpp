// ITraceLogger::Log of a TraceLogger on an enabled and on a disabled point,
// from 1 and from 4 threads. The process logger ships to a publisher that
// drops every message, so the figures are those of the caller's side.
//
//   build/bench/trace_logger_bench
#include <benchmark/benchmark.h>

#include <memory>

#include "messagebus/interfaces/IPublishCallback.h"
#include "messagebus/interfaces/IRegisterBroadcastCallback.h"
#include "utilities/tracelogging/ProcessLogger.h"
#include "utilities/tracelogging/TraceLogger.h"

namespace {

namespace Bus = Korvane::Veldra::MessageBus;
namespace Trace = Korvane::Veldra::VeldraUtilities::TraceLogging;

class DroppingService : public Bus::Interfaces::IPublishCallback,
                        public Bus::Interfaces::IRegisterBroadcastCallback {
public:
    void Publish(Bus::MessageBase&, bool) override {}
    void RegisterBroadcast(const std::string&,
                           std::shared_ptr<Bus::Interfaces::IBroadcastCallback>) override {}
};

// One logger for all threads of a run, as a Client has.
Bus::Interfaces::ITraceLogger& Logger() {
    static const auto service = std::make_shared<DroppingService>();
    static const auto process = std::make_shared<Trace::ProcessLogger>("Bench", service, service);
    static Trace::TraceLogger logger("Bench", process);
    return logger;
}

void Log(benchmark::State& state, bool enabled) {
    Bus::Interfaces::ITraceLogger& logger = Logger();
    Bus::TracePoint point = logger.GetTracePoint("Point");
    point.enabled = enabled;
    const std::string text = "value 42 written to line/speed";
    for (auto _ : state) logger.Log(point, text);
}

void BM_LogEnabled(benchmark::State& state) {
    Log(state, true);
}
void BM_LogDisabled(benchmark::State& state) {
    Log(state, false);
}

BENCHMARK(BM_LogEnabled)->Threads(1)->Threads(4)->UseRealTime();
BENCHMARK(BM_LogDisabled)->Threads(1)->Threads(4)->UseRealTime();

}  // namespace

BENCHMARK_MAIN();
