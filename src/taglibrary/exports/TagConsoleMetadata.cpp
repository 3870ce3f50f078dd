// Console functions on a tag's metadata and aggregates, and the deletion of tags.
#include "kvveldra/TagConsole.h"
#include "taglibrary/exports/ConsoleCall.h"

using namespace Korvane::Veldra::TagLibrary;

namespace {

using RequestPtr = std::shared_ptr<ConsoleAsyncRequest>;

// A get of one tag's metadata: start the lookup, wait, and let the finish
// fill the caller's out-argument; a null out-argument gives 1.
template <typename Out, typename Start, typename Finish>
int32_t GetOnConsoleTag(uint32_t tagReference, bool verbose, Out* result, std::string* error,
                        Start start, Finish finish) {
    return RunOnConsoleTag(
        tagReference, verbose, error,
        [&](Client& client, const std::shared_ptr<TagData>& tag, std::string& text) {
            if (result == nullptr) return 1;
            return RunBlocking(
                [&](const RequestPtr& request, uint32_t& id, uint32_t& timeoutMs, std::string& out) {
                    return (client.*start)(tag, request, id, timeoutMs, out);
                },
                [&](uint32_t id, std::string& out) { return (client.*finish)(id, *result, out); },
                text);
        });
}

// An operation on a batch of references whose finish delivers nothing.
template <typename Start>
int32_t OnConsoleReferences(uint64_t instanceId, const std::vector<uint32_t>* tagReferences,
                            bool verbose, std::string* error, Start start) {
    return RunOnConsoleReferences(
        instanceId, tagReferences, verbose, error,
        [&](Client& client, const std::vector<std::shared_ptr<TagData>>& tags, std::string& text) {
            return RunBlockingToFinish(
                client,
                [&](const RequestPtr& request, uint32_t& id, uint32_t& timeoutMs, std::string& out) {
                    return (client.*start)(tags, request, id, timeoutMs, out);
                },
                text);
        });
}

}  // namespace

int32_t TagConsoleGetKeywords(uint32_t tagReference, bool verbose,
                              std::vector<std::string>* keywords, std::string* error) {
    return GetOnConsoleTag(tagReference, verbose, keywords, error, &Client::GetKeywords,
                           &Client::FinishGetKeywords);
}

int32_t TagConsoleGetProperties(uint32_t tagReference, bool verbose,
                                TagConsoleProperties* properties, std::string* error) {
    return GetOnConsoleTag(tagReference, verbose, properties, error, &Client::GetProperties,
                           &Client::FinishGetProperties);
}

int32_t TagConsoleGetCollectAggregates(uint32_t tagReference, bool verbose,
                                       bool* collectAggregates, std::string* error) {
    return GetOnConsoleTag(tagReference, verbose, collectAggregates, error,
                           &Client::GetCollectAggregates, &Client::FinishGetCollectAggregates);
}

int32_t TagConsoleSetKeywords(uint32_t tagReference, const std::vector<std::string>* keywords,
                              bool verbose, std::string* error) {
    return RunOnConsoleTag(
        tagReference, verbose, error,
        [&](Client& client, const std::shared_ptr<TagData>& tag, std::string& text) {
            if (keywords == nullptr) return 1;
            return RunBlockingToFinish(
                client,
                [&](const RequestPtr& request, uint32_t& id, uint32_t& timeoutMs, std::string& out) {
                    return client.SetKeywords(tag, *keywords, false, request, id, timeoutMs, out);
                },
                text);
        });
}

int32_t TagConsoleSetProperties(uint32_t tagReference, const TagConsoleProperties* properties,
                                bool verbose, std::string* error) {
    return RunOnConsoleTag(
        tagReference, verbose, error,
        [&](Client& client, const std::shared_ptr<TagData>& tag, std::string& text) {
            if (properties == nullptr) return 1;
            return RunBlockingToFinish(
                client,
                [&](const RequestPtr& request, uint32_t& id, uint32_t& timeoutMs, std::string& out) {
                    return client.SetProperties(tag, *properties, false, request, id, timeoutMs,
                                                out);
                },
                text);
        });
}

int32_t TagConsoleSetCollectAggregates(uint32_t tagReference, bool collectAggregates,
                                       bool verbose, std::string* error) {
    return RunOnConsoleTag(
        tagReference, verbose, error,
        [&](Client& client, const std::shared_ptr<TagData>& tag, std::string& text) {
            return RunBlockingToFinish(
                client,
                [&](const RequestPtr& request, uint32_t& id, uint32_t& timeoutMs, std::string& out) {
                    return client.SetCollectAggregates(tag, collectAggregates, request, id,
                                                       timeoutMs, out);
                },
                text);
        });
}

int32_t TagConsoleResetAggregates(uint64_t instanceId, const std::vector<uint32_t>* tagReferences,
                                  bool verbose, std::string* error) {
    return OnConsoleReferences(instanceId, tagReferences, verbose, error,
                               &Client::ResetAggregates);
}

int32_t TagConsoleDeleteTag(uint64_t instanceId, const std::vector<uint32_t>* tagReferences,
                            bool verbose, std::string* error) {
    return OnConsoleReferences(instanceId, tagReferences, verbose, error, &Client::DeleteTags);
}
