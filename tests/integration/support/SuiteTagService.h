#pragma once

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "support/TagServiceProcess.h"

namespace Korvane::Veldra::Testing {

class ScratchDirectory;

// The reference tag service of one test suite, on a store file of its own so
// that it can be stopped and started again with its tags, and the suite's
// start: run by the first test rather than in SetUpTestSuite, where a failure
// would show every test as skipped and ctest would pass the run.
class SuiteTagService {
public:
    // `stem` names the scratch directory of the store; `extraArgs` go to
    // the service's command line.
    explicit SuiteTagService(const std::string& stem, std::vector<std::string> extraArgs = {});
    ~SuiteTagService();

    void Start();
    void Stop();
    // Runs `startSuite` (UseBrokerDataRoot, Start, and the family's
    // reservation and initialize) for the first caller; true once it ran
    // without a fatal failure.
    bool EnsureSuite(const std::function<void()>& startSuite);

private:
    std::unique_ptr<ScratchDirectory> directory_;
    std::unique_ptr<TagServiceProcess> process_;
    std::vector<std::string> extraArgs_;
    bool attempted_ = false;
    bool ready_ = false;
};

}  // namespace Korvane::Veldra::Testing
