#include "support/SuiteTagService.h"

#include <gtest/gtest.h>

#include "support/ScratchDirectory.h"

namespace Korvane::Veldra::Testing {

SuiteTagService::SuiteTagService(const std::string& stem)
    : directory_(std::make_unique<ScratchDirectory>(stem)) {}

SuiteTagService::~SuiteTagService() {
    Stop();
}

void SuiteTagService::Start() {
    TagServiceOptions options;
    options.store = directory_->Path() + "/tags.db";
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
