#include "taglibrary/Client.h"

#include <cstdio>

namespace Korvane::Veldra::TagLibrary {

Client::Client(LocalOnly, const std::string& configurationId, uint32_t timeoutMs,
               bool allowFallback, bool verbose, std::shared_ptr<TagIngestion::Errors> errors)
    : verbose_(verbose),
      requestMap_(std::make_shared<AsyncRequestMap>()),
      errors_(std::move(errors)),
      tags_(std::make_shared<TagMap>()),
      configurationId_(configurationId),
      timeoutMs_(timeoutMs),
      allowFallback_(allowFallback) {}

void Client::Trace(const char* format, const std::string& path) const {
    if (Verbose()) std::printf(format, path.c_str());
}

void Client::TraceLine(const char* line) const {
    if (Verbose()) std::puts(line);
}

std::shared_ptr<TagData> Client::MapTag(uint64_t instanceId, const std::string& path,
                                        std::optional<TagDataType> dataType) {
    std::lock_guard<std::mutex> lock(mutex_);
    return MapTagLocked(instanceId, path, dataType);
}

std::shared_ptr<TagData> Client::MapTagLocked(uint64_t instanceId, const std::string& path,
                                              std::optional<TagDataType> dataType) {
    const auto found = tags_->find(path);
    if (found != tags_->end()) {
        Trace("Tag data for %s is already mapped and will be updated.\n", path);
        found->second->dataType = dataType;
        ++found->second->sessionCount;
        return found->second;
    }
    Trace("Tag data for %s is not mapped and will be created.\n", path);
    auto tag = std::make_shared<TagData>(instanceId, path, dataType);
    tags_->emplace(path, tag);
    return tag;
}

int32_t Client::CloseTag(const std::shared_ptr<TagData>& tag, bool& last, std::string& error) {
    if (!tag) return ReportError("Tag.InvalidTagReference", error);
    std::lock_guard<std::mutex> lock(mutex_);
    Trace("Closing tag session for tag: %s\n", tag->path);
    if (tag->sessionCount > 1) {
        --tag->sessionCount;
        last = false;
        return 0;
    }
    // Only the record that the map holds is erased: a stale record of a path
    // that was closed and opened again must not take the new one with it.
    const auto found = tags_->find(tag->path);
    if (found != tags_->end() && found->second == tag) tags_->erase(found);
    last = true;
    return 0;
}

int32_t Client::GetDataType(const std::shared_ptr<TagData>& tag, int32_t& type,
                            std::string& error) {
    if (!tag) return ReportError("Tag.InvalidTagReference", error);
    std::lock_guard<std::mutex> lock(mutex_);
    Trace("Getting DataType for tag: %s\n", tag->path);
    type = TypeToExported(tag->dataType);
    return 0;
}

int32_t Client::GetPath(const std::shared_ptr<TagData>& tag, std::string& path,
                        std::string& error) {
    if (!tag) return ReportError("Tag.InvalidTagReference", error);
    std::lock_guard<std::mutex> lock(mutex_);
    Trace("Getting Path for tag: %s\n", tag->path);
    path = tag->path;
    return 0;
}

int32_t Client::ExportedType(const TagData& tag) const {
    return TypeToExported(DataTypeOf(tag));
}

std::optional<TagDataType> Client::DataTypeOf(const TagData& tag) const {
    std::lock_guard<std::mutex> lock(mutex_);
    return tag.dataType;
}

std::vector<std::string> Client::CopyPaths(const std::vector<std::shared_ptr<TagData>>& tags) const {
    std::vector<std::string> paths;
    paths.reserve(tags.size());
    std::lock_guard<std::mutex> lock(mutex_);
    for (const auto& tag : tags) paths.push_back(tag->path);
    return paths;
}

std::size_t Client::OpenTagCount() const {
    std::lock_guard<std::mutex> lock(mutex_);
    return tags_->size();
}

int32_t Client::ReportError(const std::string& name, std::string& error,
                            const std::vector<std::string>& inserts) const {
    error = errors_->messageForName(name, inserts);
    return errors_->codeForName(name);
}

int32_t Client::ReportException(const MessageBus::VeldraException& exception,
                                std::string& error) const {
    error = errors_->messageForCode(exception.Code());
    return exception.Code();
}

int32_t Client::ReportUnexpectedException(const std::exception& exception,
                                          std::string& error) const {
    return ReportError("Veldra.UnexpectedException", error, {exception.what()});
}

int32_t Client::ReportResponseError(const std::string& fullName,
                                    const std::vector<std::string>& inserts,
                                    std::string& error) const {
    return ReportError(fullName, error, inserts);
}

}  // namespace Korvane::Veldra::TagLibrary
