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
#include "messagelibrary/MessageBase.h"
#include "messagelibrary/TagRecords.h"
#include "taglibrary/TagData.h"
#include "taglibrary/requests/AsyncRequest.h"
#include "taglibrary/requests/AsyncRequestMap.h"
#include "taglibrary/requests/AsyncResponseCallbacks.h"

namespace Korvane::Veldra::MessageBus {
class AmqpConnectionManager;
class MessageService;
}  // namespace Korvane::Veldra::MessageBus

namespace Korvane::Veldra::VeldraUtilities::TraceLogging {
class ProcessLogger;
}

namespace Korvane::Veldra::TagLibrary {

using TagMap = std::unordered_map<std::string, std::shared_ptr<TagData>>;

// What an instance id of the exported functions stands for: the table of the
// caller's open tags and, through the bus, the tag services. Every operation
// returns 0 or a negative error code and, on failure, stores the formatted
// text in `error`.
//
// A bus operation has two halves: the start half files the caller's request
// under a request id and sends one message; the caller waits on its request
// by its own means; the finish half takes the request out by its id and
// evaluates the reply.
class Client {
public:
    // Selects the broker configuration, connects a manager of its own (within
    // `timeoutMs`), starts the message service "TagClient" and its trace
    // logging. Throws what the configuration or the bus throws.
    Client(const std::string& configurationId, uint32_t timeoutMs, bool allowFallback, bool verbose,
           std::shared_ptr<TagIngestion::Errors> errors);
    // The local half alone, with no bus: for tools and tests of the table.
    // Every send reports "Tag.InvalidState".
    struct LocalOnly {};
    Client(LocalOnly, const std::string& configurationId, uint32_t timeoutMs, bool allowFallback,
           bool verbose, std::shared_ptr<TagIngestion::Errors> errors);
    // Stops the trace logging, then the message service, then the rest.
    ~Client();
    Client(const Client&) = delete;
    Client& operator=(const Client&) = delete;

    // ---- The two send paths and the finish ----
    // Files the request and sends a request message, mandatory; the reply is
    // matched by its message name.
    int32_t SendTrackedRequest(MessageBus::MessageBase& message,
                               const std::shared_ptr<AsyncRequest>& request, uint32_t& requestId,
                               uint32_t& timeoutMs, std::string& error);
    // Files the request and sends a routed message asking for an answer; the
    // reply is matched by the message's correlation id.
    int32_t SendTrackedRouted(MessageBus::MessageBase& message,
                              const std::shared_ptr<AsyncRequest>& request, uint32_t& requestId,
                              uint32_t& timeoutMs, std::string& error);
    // Takes the request out and evaluates it; a second finish of one id
    // reports "Tag.InvalidState".
    int32_t TakeFinishedRequest(uint32_t requestId, std::shared_ptr<AsyncRequest>& request,
                                std::string& error);
    int32_t FinishRequest(uint32_t requestId, std::string& error);

    // ---- Open ----
    // Sends the lookup of one path; a path that is empty or holds '*' is
    // refused before anything is sent.
    int32_t OpenTag(const std::string& path, const std::shared_ptr<AsyncRequest>& request,
                    uint32_t& requestId, uint32_t& timeoutMs, std::string& error);
    // Finishes the lookup of `requestId`. One record of the wanted type maps
    // the tag; one of another type is "Tag.ConflictingTagTypes"; otherwise a
    // create goes out with `request`, and `requestId` becomes its id.
    int32_t OpenOrCreateTag(uint64_t instanceId, const std::string& path,
                            std::optional<TagDataType> dataType,
                            const std::shared_ptr<AsyncRequest>& request, bool& found,
                            std::shared_ptr<TagData>& tag, uint32_t& requestId,
                            uint32_t& timeoutMs, std::string& error);
    // Finishes the create and maps the tag when it succeeded.
    int32_t FinishCreateTag(uint64_t instanceId, const std::string& path,
                            std::optional<TagDataType> dataType, uint32_t requestId,
                            std::shared_ptr<TagData>& tag, std::string& error);

    // ---- Write ----
    // One message with the tag's samples, in their order, to "TagIngestion".
    // The samples move into the message: a write of many values is not copied.
    int32_t WriteValues(const std::shared_ptr<TagData>& tag,
                        std::vector<VeldraMessageLibrary::TagValueSample> samples,
                        const std::shared_ptr<AsyncRequest>& request, uint32_t& requestId,
                        uint32_t& timeoutMs, std::string& error);
    // One message for many paths: samples[i] belongs to paths[i]; a path
    // named several times gets one entry with its samples in input order.
    // `samples` must be at least as long as `paths`.
    int32_t WriteMulti(const std::vector<std::string>& paths,
                       std::vector<VeldraMessageLibrary::TagValueSample> samples,
                       const std::shared_ptr<AsyncRequest>& request, uint32_t& requestId,
                       uint32_t& timeoutMs, std::string& error);

    // ---- Read and list ----
    int32_t ListTags(const std::vector<std::string>& searchPaths,
                     const std::unordered_map<std::string, std::string>& properties,
                     const std::vector<std::string>& keywords, uint32_t skip, uint32_t take,
                     bool allowStale, const std::shared_ptr<AsyncRequest>& request,
                     uint32_t& requestId, uint32_t& timeoutMs, std::string& error);
    // Opens every tag of the page: each appended record owes one CloseTag.
    // `totalCount` is the service's count of all matches.
    int32_t FinishListTags(uint64_t instanceId, uint32_t requestId,
                           std::vector<std::shared_ptr<TagData>>& tags, int32_t& totalCount,
                           std::string& error);
    // `tags` must not be empty.
    int32_t ReadValues(const std::vector<std::shared_ptr<TagData>>& tags, bool allowStale,
                       const std::shared_ptr<AsyncRequest>& request, uint32_t& requestId,
                       uint32_t& timeoutMs, std::string& error);
    // The service's records as they came: its order, maybe fewer than asked.
    int32_t FinishReadValues(uint32_t requestId,
                             std::vector<VeldraMessageLibrary::TagCurrentValue>& values,
                             std::string& error);

    // ---- Metadata ----
    // The gets and sets hold the mutex across their publish.
    int32_t GetKeywords(const std::shared_ptr<TagData>& tag,
                        const std::shared_ptr<AsyncRequest>& request, uint32_t& requestId,
                        uint32_t& timeoutMs, std::string& error);
    int32_t GetProperties(const std::shared_ptr<TagData>& tag,
                          const std::shared_ptr<AsyncRequest>& request, uint32_t& requestId,
                          uint32_t& timeoutMs, std::string& error);
    int32_t GetCollectAggregates(const std::shared_ptr<TagData>& tag,
                                 const std::shared_ptr<AsyncRequest>& request,
                                 uint32_t& requestId, uint32_t& timeoutMs, std::string& error);
    // The finishes of the gets: "Tag.NoSuchTag" unless exactly one record
    // came. Keywords are appended and properties assigned into what the
    // caller passes.
    int32_t FinishGetKeywords(uint32_t requestId, std::vector<std::string>& keywords,
                              std::string& error);
    int32_t FinishGetProperties(uint32_t requestId,
                                std::unordered_map<std::string, std::string>& properties,
                                std::string& error);
    int32_t FinishGetCollectAggregates(uint32_t requestId, bool& collectAggregates,
                                       std::string& error);
    // The sets: finished by FinishRequest, which also reports the failures
    // that the reply carries in its body.
    int32_t SetKeywords(const std::shared_ptr<TagData>& tag, const std::vector<std::string>& keywords,
                        bool merge, const std::shared_ptr<AsyncRequest>& request,
                        uint32_t& requestId, uint32_t& timeoutMs, std::string& error);
    int32_t SetProperties(const std::shared_ptr<TagData>& tag,
                          const std::unordered_map<std::string, std::string>& properties,
                          bool merge, const std::shared_ptr<AsyncRequest>& request,
                          uint32_t& requestId, uint32_t& timeoutMs, std::string& error);
    // The caller passes a live tag.
    int32_t SetCollectAggregates(const std::shared_ptr<TagData>& tag, bool collectAggregates,
                                 const std::shared_ptr<AsyncRequest>& request,
                                 uint32_t& requestId, uint32_t& timeoutMs, std::string& error);
    // `tags` must not be empty. Deleting leaves the local records open.
    int32_t ResetAggregates(const std::vector<std::shared_ptr<TagData>>& tags,
                            const std::shared_ptr<AsyncRequest>& request, uint32_t& requestId,
                            uint32_t& timeoutMs, std::string& error);
    int32_t DeleteTags(const std::vector<std::shared_ptr<TagData>>& tags,
                       const std::shared_ptr<AsyncRequest>& request, uint32_t& requestId,
                       uint32_t& timeoutMs, std::string& error);
    // Deletes every tag of the service and waits for the answer on the
    // calling thread; the one operation with no request.
    int32_t DeleteAllTags(std::string& error);

    // Maps a path to its record: a new one with one session, or the existing
    // one with its type replaced and one more session.
    std::shared_ptr<TagData> MapTag(uint64_t instanceId, const std::string& path,
                                    std::optional<TagDataType> dataType);
    // Ends one session of the tag; `last` tells whether the record left the map.
    int32_t CloseTag(const std::shared_ptr<TagData>& tag, bool& last, std::string& error);
    // The exported type number of the record, from local state only.
    int32_t GetDataType(const std::shared_ptr<TagData>& tag, int32_t& type, std::string& error);
    int32_t GetPath(const std::shared_ptr<TagData>& tag, std::string& path, std::string& error);
    // The exported type number of a record that the caller knows to be live;
    // no verbose line.
    int32_t ExportedType(const TagData& tag) const;
    // The client's type of a record: unset, None and the six types apart.
    std::optional<TagDataType> DataTypeOf(const TagData& tag) const;

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
    // The time-out that the start halves hand out: the service's default.
    uint32_t RequestTimeoutMs() const;
    const std::shared_ptr<AsyncRequestMap>& RequestMap() const { return requestMap_; }
    // Null for a local Client.
    MessageBus::MessageService* Service() const { return messageService_.get(); }

private:
    // Prints a verbose progress line that carries a tag path.
    void Trace(const char* format, const std::string& path) const;
    // Prints a verbose progress line without arguments.
    void TraceLine(const char* line) const;
    // MapTag with the mutex already held.
    std::shared_ptr<TagData> MapTagLocked(uint64_t instanceId, const std::string& path,
                                          std::optional<TagDataType> dataType);
    // The paths of the records, in order, copied under the mutex.
    std::vector<std::string> CopyPaths(const std::vector<std::shared_ptr<TagData>>& tags) const;
    // The shared start of the three gets: a lookup of the tag's one path.
    int32_t SendTagLookup(const char* traceFormat, const std::shared_ptr<TagData>& tag,
                          const std::shared_ptr<AsyncRequest>& request, uint32_t& requestId,
                          uint32_t& timeoutMs, std::string& error);
    // The shared finish of the three gets: the one record, or "Tag.NoSuchTag".
    int32_t FinishTagLookup(uint32_t requestId, VeldraMessageLibrary::TagRecord& record,
                            std::string& error);
    // The shared body of the three sets: one change of one record, merged or not.
    int32_t SendTagChange(const char* traceFormat, const std::shared_ptr<TagData>& tag,
                          VeldraMessageLibrary::TagRecord record,
                          VeldraMessageLibrary::TagChangeFlags change, bool merge,
                          const std::shared_ptr<AsyncRequest>& request, uint32_t& requestId,
                          uint32_t& timeoutMs, std::string& error);
    // What both send paths share: file the request, send, hand out the
    // time-out, and on failure take the request back out.
    template <typename Send>
    int32_t FileAndSend(MessageBus::MessageBase& message,
                        const std::shared_ptr<AsyncRequest>& request, Send send,
                        uint32_t& requestId, uint32_t& timeoutMs, std::string& error);
    // Before a send: the reply queue must be in place for the reply to come.
    // 0 when the message may go; else the status and text for the caller.
    int32_t AwaitReplyRoute(MessageBus::MessageService& service, const AsyncRequest& request,
                            std::string& error) const;
    // After a failed send: takes the request back out and drops its
    // correlation entry.
    void Forget(uint32_t requestId, const AsyncRequest& request);
    // Stops the logging thread and releases the service, then the logger.
    void ShutdownBus() noexcept;

    std::atomic<bool> verbose_;
    // Declared so that the members left after ShutdownBus go in an order that
    // is safe for the bus: the service's threads end before the callback and
    // the manager that they use.
    std::shared_ptr<AsyncRequestMap> requestMap_;
    std::shared_ptr<MessageBus::AmqpConnectionManager> connectionManager_;
    std::shared_ptr<GenericAsyncResponseCallback> responseCallback_;
    std::shared_ptr<VeldraUtilities::TraceLogging::ProcessLogger> processLogger_;
    std::shared_ptr<MessageBus::MessageService> messageService_;
    std::shared_ptr<TagIngestion::Errors> errors_;
    std::shared_ptr<TagMap> tags_;
    mutable std::mutex mutex_;

    const std::string configurationId_;
    const uint32_t timeoutMs_;
    const bool allowFallback_;
};

}  // namespace Korvane::Veldra::TagLibrary
