#pragma once

#include <atomic>
#include <cstdint>
#include <map>
#include <memory>
#include <mutex>

#include "errors/Errors.h"
#include "taglibrary/Client.h"
#include "taglibrary/TagData.h"

namespace Korvane::Veldra::TagLibrary {

// The process-wide state behind both exported families: the reservation
// count, the error registry of the current reservation cycle, and the two
// tables from caller numbers to objects.
struct ProcessState {
    std::atomic<int32_t> ReserveCount{0};
    // The table mutex guards both tables. It is never held across a Client
    // operation, except for the construction of a Client at initialize.
    std::mutex TableMutex;
    // An entry with a null Client is a left-over of a failed initialize.
    std::map<uint64_t, std::shared_ptr<Client>> ClientTable;
    std::map<uint32_t, std::shared_ptr<TagData>> TagReferenceTable;

    std::shared_ptr<TagIngestion::Errors> SharedErrors() const {
        return std::atomic_load(&sharedErrors_);
    }
    void SetSharedErrors(std::shared_ptr<TagIngestion::Errors> errors) {
        std::atomic_store(&sharedErrors_, std::move(errors));
    }

    static ProcessState& Get();

private:
    std::shared_ptr<TagIngestion::Errors> sharedErrors_;
};

}  // namespace Korvane::Veldra::TagLibrary
