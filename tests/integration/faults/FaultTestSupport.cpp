#include "faults/FaultTestSupport.h"

#include <unistd.h>

#include <atomic>
#include <cstdio>
#include <cstdlib>
#include <memory>
#include <thread>
#include <vector>

#include "support/BrokerEnvironment.h"
#include "support/ScratchDirectory.h"
#include "support/TagServiceProcess.h"

namespace Korvane::Veldra::Testing {
namespace {

using Clock = std::chrono::steady_clock;

// Between failed calls, so that a failure that comes at once does not spin.
constexpr Millis kRetryPace{50};

Millis Since(Clock::time_point start) {
    return std::chrono::duration_cast<Millis>(Clock::now() - start);
}

// What the suite starts once: the proxy with a data root that names it, and
// the service on a store of its own and the node's own port.
struct FaultSuite {
    ScratchDirectory proxyRoot{"kvveldra-fault-data"};
    ScratchDirectory storeDirectory{"kvveldra-fault-store"};
    std::unique_ptr<FaultProxy> proxy;
    std::unique_ptr<TagServiceProcess> service;
    bool attempted = false;
    bool ready = false;

    void StartService() {
        service.reset();
        TagServiceOptions options;
        options.store = storeDirectory.Path() + "/tags.db";
        options.dataRoot = UseBrokerDataRoot();
        service = std::make_unique<TagServiceProcess>(options);
    }
};

FaultSuite& Suite() {
    static FaultSuite suite;
    return suite;
}

}  // namespace

bool IsBusFailure(int32_t status) {
    return status == kRequestTimedOut || (status <= -251017 && status >= -251035);
}

void FaultBrokerTest::SetUp() {
    FaultSuite& suite = Suite();
    if (!suite.attempted) {
        suite.attempted = true;
        StartSuite();
        suite.ready = !HasFatalFailure();
    }
    ASSERT_TRUE(suite.ready) << "the tag service or the instance did not start (see above)";
}

void FaultBrokerTest::StartSuite() {
    FaultSuite& suite = Suite();
    suite.StartService();
    suite.proxy = std::make_unique<FaultProxy>(Broker().AmqpPort);
    BrokerSettings viaProxy = Broker();
    viaProxy.AmqpPort = suite.proxy->Port();
    WriteBrokerDataRoot(viaProxy, suite.proxyRoot.Path());
    // Read once, by the first initialize of the process.
    setenv("VELDRA_DATA_DIR", suite.proxyRoot.Path().c_str(), 1);
    bool reserved = false;
    ASSERT_EQ(TagConsoleReserve(&reserved), 0);
    std::string error;
    ASSERT_EQ(TagConsoleInitialize(0, nullptr, nullptr, nullptr, &error), 0) << error;
}

void FaultBrokerTest::TearDownTestSuite() {
    bool reserved = true;
    TagConsoleUnreserve(&reserved);
    Suite().service.reset();
}

FaultProxy& FaultBrokerTest::Proxy() {
    return *Suite().proxy;
}

void FaultBrokerTest::RestartService() {
    Suite().StartService();
}

std::string FaultBrokerTest::UniquePath(const std::string& stem) {
    static std::atomic<int> counter{0};
    return "fault." + std::to_string(getpid()) + "." + std::to_string(++counter) + "." + stem;
}

uint32_t FaultBrokerTest::Open(const std::string& path) {
    uint32_t reference = 0;
    std::string error;
    EXPECT_EQ(TagConsoleOpen(0, &path, kDouble, false, &reference, &error), 0) << path << ": " << error;
    return reference;
}

CallResult FaultBrokerTest::Write(uint32_t reference, const std::string& value) {
    const TagConsoleSamples samples{{value, TagConsoleTime(std::chrono::seconds(1))}};
    CallResult result;
    const auto start = Clock::now();
    result.status = TagConsoleWriteTag(reference, kDouble, &samples, false, &result.error);
    result.took = Since(start);
    return result;
}

CallResult FaultBrokerTest::Read(uint32_t reference, TagConsoleValue& value) {
    const std::vector<uint32_t> references{reference};
    std::vector<TagConsoleValue> results;
    CallResult result;
    const auto start = Clock::now();
    result.status = TagConsoleReadValues(0, &references, false, 0, &results, &result.error);
    result.took = Since(start);
    if (result.status == 0 && results.size() == 1) value = results.front();
    return result;
}

FaultFigures FaultBrokerTest::MeasureFault(const std::string& name,
                                           const std::function<CallResult()>& call, Millis window,
                                           const std::function<void()>& lift, Millis recoveryLimit) {
    const auto check = [&](const CallResult& result) {
        EXPECT_LE(result.took, kRequestTimeout + kCallMargin) << name << ": a call overran its time-out";
        if (result.status != 0) {
            EXPECT_TRUE(IsBusFailure(result.status)) << name << ": status " << result.status << " " << result.error;
            EXPECT_FALSE(result.error.empty()) << name << ": status " << result.status << " without a text";
        }
    };
    FaultFigures figures;
    const auto faulted = Clock::now();
    while (Since(faulted) < window) {
        const CallResult result = call();
        check(result);
        if (result.status != 0) {
            figures.firstError = Since(faulted);
            figures.errorStatus = result.status;
            break;
        }
    }
    lift();
    const auto lifted = Clock::now();
    std::string failures;  // the first calls that failed after the lift
    int failed = 0;
    while (Since(lifted) < recoveryLimit) {
        const CallResult result = call();
        check(result);
        if (result.status != 0) {
            if (++failed <= 6) failures += " " + std::to_string(result.status) + "/" + std::to_string(result.took.count()) + "ms";
            std::this_thread::sleep_for(kRetryPace);
        } else {
            figures.firstSuccess = Since(lifted);
            break;
        }
    }
    EXPECT_TRUE(figures.firstSuccess) << name << ": no call succeeded within " << recoveryLimit.count()
                                      << " ms of lifting the fault";
    std::printf("fault %-22s first error %s, first success %s after recovery (failed before it:%s)\n",
                name.c_str(),
                figures.firstError ? (std::to_string(figures.firstError->count()) + " ms (status " +
                                      std::to_string(figures.errorStatus) + ")").c_str()
                                   : ("none in " + std::to_string(window.count()) + " ms").c_str(),
                figures.firstSuccess ? (std::to_string(figures.firstSuccess->count()) + " ms").c_str()
                                     : "never",
                failures.empty() ? " none" : (failures + (failed > 6 ? " ... " + std::to_string(failed) + " in all" : "")).c_str());
    std::fflush(stdout);
    return figures;
}

}  // namespace Korvane::Veldra::Testing
