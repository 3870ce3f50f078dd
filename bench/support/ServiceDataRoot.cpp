#include "support/ServiceDataRoot.h"

#include <cstdlib>

#include "support/BrokerEnvironment.h"

namespace Korvane::Veldra::Bench {

ServiceDataRoot::ServiceDataRoot(const std::string& stem) {
    if (!Testing::LoadBrokerSettings(Testing::BrokerEnvironment::EnvFilePath(), broker_, error_)) {
        error_ = "no private broker: " + error_;
        return;
    }
    directory_.emplace(stem);
    Testing::WriteBrokerDataRoot(broker_, directory_->Path(), "veldra_master", kExchange);
    setenv("VELDRA_DATA_DIR", directory_->Path().c_str(), 1);
}

BrokerAddress ServiceDataRoot::Address() const {
    return BrokerAddress{broker_.Host, broker_.User, broker_.Password, broker_.AmqpPort};
}

std::string ServiceDataRoot::Path() const {
    return directory_ ? directory_->Path() : std::string();
}

std::unique_ptr<Testing::TagServiceProcess> ServiceDataRoot::StartService(
    const std::string& store) const {
    Testing::TagServiceProcess::Options options;
    options.dataRoot = Path();
    options.store = store;
    return std::make_unique<Testing::TagServiceProcess>(options);
}

}  // namespace Korvane::Veldra::Bench
