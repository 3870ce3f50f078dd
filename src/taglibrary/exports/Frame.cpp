#include "taglibrary/exports/Frame.h"

#include "errors/ErrorCodes.h"
#include "errors/ErrorTable.h"
#include "errors/MessageInserts.h"

namespace Korvane::Veldra::TagLibrary {

int32_t FormatNamedError(const std::string& name, const std::vector<std::string>& inserts,
                         std::string& text) {
    if (const auto errors = ProcessState::Get().SharedErrors()) {
        text = errors->messageForName(name, inserts);
        return errors->codeForName(name);
    }
    // No reservation is held: still give the caller the right code and text.
    if (const auto* row = MessageBus::FindErrorRow(name.c_str())) {
        text = MessageBus::ApplyInserts(row->message, inserts);
        return row->code;
    }
    text.clear();
    return ErrorCodes::kInternalServiceError;
}

std::shared_ptr<Client> LookupClient(uint64_t instanceId) {
    auto& state = ProcessState::Get();
    std::lock_guard<std::mutex> lock(state.TableMutex);
    const auto found = state.ClientTable.find(instanceId);
    return found == state.ClientTable.end() ? nullptr : found->second;
}

std::shared_ptr<TagData> LookupTag(uint32_t tagReference) {
    auto& state = ProcessState::Get();
    std::lock_guard<std::mutex> lock(state.TableMutex);
    const auto found = state.TagReferenceTable.find(tagReference);
    return found == state.TagReferenceTable.end() ? nullptr : found->second;
}

void RegisterReference(const std::shared_ptr<TagData>& tag) {
    auto& state = ProcessState::Get();
    std::lock_guard<std::mutex> lock(state.TableMutex);
    state.TagReferenceTable[tag->Reference()] = tag;
}

void RegisterReferenceIfAbsent(const std::shared_ptr<TagData>& tag) {
    auto& state = ProcessState::Get();
    std::lock_guard<std::mutex> lock(state.TableMutex);
    state.TagReferenceTable.emplace(tag->Reference(), tag);
}

void RegisterReferencesIfAbsent(const std::vector<std::shared_ptr<TagData>>& tags) {
    auto& state = ProcessState::Get();
    std::lock_guard<std::mutex> lock(state.TableMutex);
    for (const auto& tag : tags) state.TagReferenceTable.emplace(tag->Reference(), tag);
}

std::vector<std::shared_ptr<TagData>> LookupTags(const std::vector<uint32_t>& references,
                                                 bool& missing) {
    std::vector<std::shared_ptr<TagData>> tags;
    tags.reserve(references.size());
    missing = false;
    auto& state = ProcessState::Get();
    std::lock_guard<std::mutex> lock(state.TableMutex);
    for (const uint32_t reference : references) {
        const auto found = state.TagReferenceTable.find(reference);
        // Only a number the table does not hold is left out; a tag opened on
        // another instance goes with the others, by its path.
        if (found == state.TagReferenceTable.end()) {
            missing = true;
            continue;
        }
        tags.push_back(found->second);
    }
    return tags;
}

void EraseReference(uint32_t tagReference) {
    std::shared_ptr<TagData> released;  // dies after the lock is let go
    auto& state = ProcessState::Get();
    std::lock_guard<std::mutex> lock(state.TableMutex);
    const auto found = state.TagReferenceTable.find(tagReference);
    if (found == state.TagReferenceTable.end()) return;
    released = std::move(found->second);
    state.TagReferenceTable.erase(found);
}

}  // namespace Korvane::Veldra::TagLibrary
