#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

#include "support/ConsoleInstance.h"
#include "support/ConsoleReferences.h"
#include "support/ServiceDataRoot.h"

namespace Korvane::Veldra::Bench {

// What the parts of scale_bench share: the data root, console instance 1
// (configuration veldra_master) and the tag service of the current stage.
// One service at a time: two on the exchange would both answer.
//   Values: a service in memory with one tag, for writes and round trips.
//   Listed: a service over an SQLite store of the listed tags, filled before
//           the service starts, for the listing and the open tags.
class ScaleWorld {
public:
    enum class Stage { None, Values, Listed };
    static constexpr uint64_t kInstance = 1;
    static constexpr int32_t kDouble = 0;  // the console's data type Double

    // listedTags: how many tags the store of stage Listed holds.
    explicit ScaleWorld(int listedTags);
    ~ScaleWorld();
    ScaleWorld(const ScaleWorld&) = delete;
    ScaleWorld& operator=(const ScaleWorld&) = delete;

    // Brings the world to the stage, ending the one before; false, with the
    // reason in Error(), when it cannot be had. A failure stays.
    bool Enter(Stage stage);

    const std::string& Error() const { return error_; }
    const ServiceDataRoot& Root() const { return root_; }
    // The one tag of stage Values, open on the instance.
    const std::string& ValuePath() const { return valuePath_; }
    uint32_t ValueTag() const { return valueTag_; }
    // The paths of the listed tags, in path order.
    const std::vector<std::string>& Listed() const { return listed_; }
    // Tags held open at stage Listed; closed when the stage ends.
    ConsoleReferences& Opened() { return opened_; }

private:
    void Leave();
    void StartValues();
    void StartListed();

    ServiceDataRoot root_{"kvveldra-scale-bench"};
    std::unique_ptr<ConsoleInstance> console_;
    std::unique_ptr<Testing::TagServiceProcess> service_;
    Stage stage_ = Stage::None;
    std::string error_;
    const std::string valuePath_ = "scale.values";
    uint32_t valueTag_ = 0;
    std::vector<std::string> listed_;
    bool filled_ = false;
    ConsoleReferences opened_;
};

}  // namespace Korvane::Veldra::Bench
