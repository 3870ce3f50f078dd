#include "support/SuiteTagService.h"

#include <gtest/gtest.h>

#include "support/ScratchDirectory.h"

#include <utility>

namespace Korvane::Veldra::Testing {

SuiteTagService::SuiteTagService(const std::string& stem, std::vector<std::string> extraArgs)
    : directory_(std::make_unique<ScratchDirectory>(stem)), extraArgs_(std::move(extraArgs)) {}

SuiteTagService::~SuiteTagService() {
    Stop();
}

void SuiteTagService::Start() {
    TagServiceOptions options;
    options.store = directory_->Path() + "/tags.db";
    options.extraArgs = extraArgs_;
    process_ = std::make_unique<TagServiceProcess>(options);
}

void SuiteTagService::Stop() {
    if (process_) process_->Stop();
    process_.reset();
}

bool SuiteTagService::EnsureSuite(const std::function<void()>& startSuite) {
    if (!attempted_) {
        attempted_ = true;
        startSuite();
        ready_ = !::testing::Test::HasFatalFailure();
    }
    return ready_;
}

}  // namespace Korvane::Veldra::Testing
