#pragma once

#include <atomic>
#include <cstdint>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <unordered_map>
#include <vector>

#include "errors/Errors.h"
#include "errors/VeldraException.h"
#include "taglibrary/TagData.h"

namespace Korvane::Veldra::TagLibrary {

using TagMap = std::unordered_map<std::string, std::shared_ptr<TagData>>;

// What an instance id of the exported functions stands for: the table of the
// caller's open tags and, through the bus, the tag services. Every operation
// returns 0 or a negative error code and, on failure, stores the formatted
// text in `error`.
class Client {
public:
    Client(const std::string& configurationId, uint32_t timeoutMs, bool allowFallback, bool verbose,
           std::shared_ptr<TagIngestion::Errors> errors);
    Client(const Client&) = delete;
    Client& operator=(const Client&) = delete;

    // Maps a path to its record: a new one with one session, or the existing
    // one with its type replaced and one more session.
    std::shared_ptr<TagData> MapTag(uint64_t instanceId, const std::string& path,
                                    std::optional<TagDataType> dataType);
    // Ends one session of the tag; `last` tells whether the record left the map.
    int32_t CloseTag(const std::shared_ptr<TagData>& tag, bool& last, std::string& error);
    // The exported type number of the record, from local state only.
    int32_t GetDataType(const std::shared_ptr<TagData>& tag, int32_t& type, std::string& error);
    int32_t GetPath(const std::shared_ptr<TagData>& tag, std::string& path, std::string& error);

    void SetVerbose(bool verbose) { verbose_.store(verbose, std::memory_order_relaxed); }
    bool Verbose() const { return verbose_.load(std::memory_order_relaxed); }

    const std::string& ConfigurationId() const { return configurationId_; }
    uint32_t ConnectTimeoutMs() const { return timeoutMs_; }
    bool AllowFallback() const { return allowFallback_; }
    const std::shared_ptr<TagIngestion::Errors>& GetErrors() const { return errors_; }

    // The four ways in which an operation turns a failure into a status and a text.
    int32_t ReportError(const std::string& name, std::string& error,
                        const std::vector<std::string>& inserts = {}) const;
    int32_t ReportException(const MessageBus::VeldraException& exception, std::string& error) const;
    int32_t ReportUnexpectedException(const std::exception& exception, std::string& error) const;
    int32_t ReportResponseError(const std::string& fullName,
                                const std::vector<std::string>& inserts, std::string& error) const;

    // The number of open paths; for diagnostics and tests.
    std::size_t OpenTagCount() const;

private:
    // Prints a verbose progress line that carries a tag path.
    void Trace(const char* format, const std::string& path) const;

    std::atomic<bool> verbose_;
    std::shared_ptr<TagIngestion::Errors> errors_;
    std::shared_ptr<TagMap> tags_;
    mutable std::mutex mutex_;

    const std::string configurationId_;
    const uint32_t timeoutMs_;
    const bool allowFallback_;
};

}  // namespace Korvane::Veldra::TagLibrary
