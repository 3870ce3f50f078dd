// The write path: samples go to "TagIngestion" as they are, one message a call.
#include <unordered_map>
#include <utility>

#include "messagelibrary/tagingestion/TagUpdateValuesRoutedMessage.h"
#include "taglibrary/Client.h"

namespace Korvane::Veldra::TagLibrary {

using VeldraMessageLibrary::TagPathUpdates;
using VeldraMessageLibrary::TagValueSample;
using VeldraMessageLibrary::TagIngestionMessages::TagUpdateValuesRoutedMessage;

int32_t Client::WriteValues(const std::shared_ptr<TagData>& tag,
                            std::vector<TagValueSample> samples,
                            const std::shared_ptr<AsyncRequest>& request, uint32_t& requestId,
                            uint32_t& timeoutMs, std::string& error) {
    if (!tag) return ReportError("Tag.InvalidTagReference", error);
    std::string path;
    {
        std::lock_guard<std::mutex> lock(mutex_);
        path = tag->path;
    }
    // Built in place: a braced list would copy every sample once more.
    std::vector<TagPathUpdates> updates;
    updates.push_back(TagPathUpdates{std::move(path), std::move(samples)});
    TagUpdateValuesRoutedMessage message(std::move(updates));
    return SendTrackedRouted(message, request, requestId, timeoutMs, error);
}

int32_t Client::WriteMulti(const std::vector<std::string>& paths,
                           std::vector<TagValueSample> samples,
                           const std::shared_ptr<AsyncRequest>& request, uint32_t& requestId,
                           uint32_t& timeoutMs, std::string& error) {
    if (samples.size() < paths.size()) return ReportError("Tag.InvalidState", error);
    // Grouped by exact path; the order of the paths means nothing, the order
    // of one path's samples is the caller's.
    std::unordered_map<std::string, std::vector<TagValueSample>> grouped;
    for (std::size_t i = 0; i < paths.size(); ++i) {
        grouped[paths[i]].push_back(std::move(samples[i]));
    }
    std::vector<TagPathUpdates> updates;
    updates.reserve(grouped.size());
    for (auto& [path, pathSamples] : grouped) {
        updates.push_back(TagPathUpdates{path, std::move(pathSamples)});
    }
    TagUpdateValuesRoutedMessage message(std::move(updates));
    return SendTrackedRouted(message, request, requestId, timeoutMs, error);
}

}  // namespace Korvane::Veldra::TagLibrary
