#include "support/ScaleWorld.h"

#include <cstdio>
#include <exception>
#include <stdexcept>

#include "kvveldra/TagConsole.h"
#include "support/TagStoreFile.h"

namespace Korvane::Veldra::Bench {

ScaleWorld::ScaleWorld(int listedTags) {
    error_ = root_.Error();
    if (error_.empty()) {
        console_ = std::make_unique<ConsoleInstance>(kInstance, "veldra_master");
        error_ = console_->Error();
    }
    listed_.reserve(static_cast<size_t>(listedTags));
    char path[32];
    for (int i = 0; i < listedTags; ++i) {
        std::snprintf(path, sizeof path, "scale.tag.%06d", i);
        listed_.emplace_back(path);
    }
}

ScaleWorld::~ScaleWorld() {
    Leave();
}

bool ScaleWorld::Enter(Stage stage) {
    if (!error_.empty() || stage == stage_) return error_.empty();
    Leave();
    try {
        if (stage == Stage::Values) {
            StartValues();
        } else {
            StartListed();
        }
        stage_ = stage;
    } catch (const std::exception& failure) {
        error_ = failure.what();
    }
    return error_.empty();
}

void ScaleWorld::Leave() {
    opened_.CloseAll();
    if (valueTag_ != 0) CloseReferences({valueTag_});
    valueTag_ = 0;
    service_.reset();
    stage_ = Stage::None;
}

void ScaleWorld::StartValues() {
    service_ = root_.StartService();
    std::string text;
    if (TagConsoleOpen(kInstance, &valuePath_, kDouble, false, &valueTag_, &text) != 0) {
        throw std::runtime_error("cannot create the tag of values: " + text);
    }
}

void ScaleWorld::StartListed() {
    const std::string store = root_.Path() + "/listed.db";
    if (!filled_) WriteTagStore(store, listed_);
    filled_ = true;
    service_ = root_.StartService(store);
}

}  // namespace Korvane::Veldra::Bench
