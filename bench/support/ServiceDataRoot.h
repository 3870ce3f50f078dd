#pragma once

#include <memory>
#include <optional>
#include <string>

#include "support/BenchBroker.h"
#include "support/BrokerSettings.h"
#include "support/ScratchDirectory.h"
#include "support/TagServiceProcess.h"

namespace Korvane::Veldra::Bench {

// The private test broker as broker.sh describes it (KVVELDRA_BROKER_ENV,
// else the build tree's file) and a data root of this process's own that
// describes it, as configuration "veldra_master" on kExchange, to the library
// and to kvveldra-tagservice: VELDRA_DATA_DIR points there from construction
// on. The directory goes with the object.
class ServiceDataRoot {
public:
    static constexpr const char* kExchange = "kvveldra.amqpio.test";

    // stem names the directory under $TMPDIR (else /tmp).
    explicit ServiceDataRoot(const std::string& stem);

    // Why there is no broker; empty when there is one.
    const std::string& Error() const { return error_; }
    const Testing::BrokerSettings& Broker() const { return broker_; }
    BrokerAddress Address() const;
    // The directory, which also takes the benchmark's own files; empty
    // without a broker.
    std::string Path() const;

    // Starts kvveldra-tagservice on this root, in memory or, when store is
    // given, over that SQLite file; throws std::runtime_error when it does
    // not come up.
    std::unique_ptr<Testing::TagServiceProcess> StartService(const std::string& store = "") const;

private:
    Testing::BrokerSettings broker_;
    std::string error_;
    std::optional<Testing::ScratchDirectory> directory_;
};

}  // namespace Korvane::Veldra::Bench
