// Host functions on a tag's metadata and aggregates, the deletion of tags,
// and the finishes of requests that deliver nothing.
#include <algorithm>

#include "kvveldra/TagWB.h"
#include "taglibrary/exports/wb/HostArrays.h"
#include "taglibrary/exports/wb/HostCall.h"

using namespace Korvane::Veldra::TagLibrary;

namespace {

// The start of a get: the tag's lookup.
using GetStart = int32_t (Client::*)(const std::shared_ptr<TagData>&,
                                     const std::shared_ptr<AsyncRequest>&, uint32_t&, uint32_t&,
                                     std::string&);

int32_t GetOnHostTag(uint32_t tagReference, uint32_t* requestId, uint32_t* timeoutMs,
                     uint32_t* signal, WBStrHandle* error, GetStart start) {
    return RequestOnHostTag(
        tagReference, requestId, timeoutMs, signal, error,
        [&](Client& client, const std::shared_ptr<TagData>& tag,
            const HostRequestMaker& makeRequest, uint32_t& id, uint32_t& timeout,
            std::string& text) {
            return (client.*start)(tag, makeRequest(), id, timeout, text);
        });
}

// A finish of a get: reference 0 reads as a bad data type here, by design.
template <typename Finish>
int32_t FinishGetOnHostTag(uint32_t tagReference, WBStrHandle* error, Finish&& finish) {
    return FinishOnHostTag(tagReference, "Tag.InvalidTagDataType", error,
                           [&](Client& client, const std::shared_ptr<TagData>&,
                               std::string& text) { return finish(client, text); });
}

// A set of one tag's metadata; the instance goes out for the finish.
template <typename Start>
int32_t SetOnHostTag(uint32_t tagReference, uint64_t* instanceId, uint32_t* requestId,
                     uint32_t* timeoutMs, uint32_t* signal, WBStrHandle* error, Start&& start) {
    if (instanceId == nullptr) return 1;
    return RequestOnHostTag(
        tagReference, requestId, timeoutMs, signal, error,
        [&](Client& client, const std::shared_ptr<TagData>& tag,
            const HostRequestMaker& makeRequest, uint32_t& id, uint32_t& timeout,
            std::string& text) {
            *instanceId = tag->instanceId;
            return start(client, tag, makeRequest(), id, timeout, text);
        });
}

// An operation on a batch of references whose finish delivers nothing.
using BatchStart = int32_t (Client::*)(const std::vector<std::shared_ptr<TagData>>&,
                                       const std::shared_ptr<AsyncRequest>&, uint32_t&,
                                       uint32_t&, std::string&);

int32_t OnHostReferences(uint64_t instanceId, WBReferenceArrayHandle tagReferences,
                         uint32_t* requestId, uint32_t* timeoutMs, uint32_t* signal,
                         WBStrHandle* error, BatchStart start) {
    return RequestOnHostReferences(
        instanceId, tagReferences, nullptr, requestId, timeoutMs, signal, error,
        [&](Client& client, const HostTags& tags, const HostRequest& request, uint32_t& id,
            uint32_t& timeout, std::string& text) {
            return (client.*start)(tags, request, id, timeout, text);
        });
}

int32_t SetPropertiesOnHostTag(uint32_t tagReference, WBPropertyArrayHandle properties,
                               bool merge, uint64_t* instanceId, uint32_t* requestId,
                               uint32_t* timeoutMs, uint32_t* signal, WBStrHandle* error) {
    return SetOnHostTag(tagReference, instanceId, requestId, timeoutMs, signal, error,
                        [&](Client& client, const std::shared_ptr<TagData>& tag,
                            const HostRequest& request, uint32_t& id, uint32_t& timeout,
                            std::string& text) {
                            return client.SetProperties(tag, ReadHostProperties(properties), merge,
                                                        request, id, timeout, text);
                        });
}

}  // namespace

int32_t TagWBGetKeywords(uint32_t tagReference, uint32_t* requestId, uint32_t* timeoutMs,
                         uint32_t* signal, WBStrHandle* error) {
    return GetOnHostTag(tagReference, requestId, timeoutMs, signal, error, &Client::GetKeywords);
}

int32_t TagWBFinishGetKeywords(uint32_t tagReference, uint32_t requestId,
                               WBStrArrayHandle* keywords, WBStrHandle* error) {
    if (AnyNull(keywords, error)) return 1;
    return FinishGetOnHostTag(tagReference, error, [&](Client& client, std::string& text) {
        std::vector<std::string> found;
        if (const int32_t status = client.FinishGetKeywords(requestId, found, text)) return status;
        return WriteHostStrings(keywords, found);
    });
}

int32_t TagWBGetProperties(uint32_t tagReference, uint32_t* requestId, uint32_t* timeoutMs,
                           uint32_t* signal, WBStrHandle* error) {
    return GetOnHostTag(tagReference, requestId, timeoutMs, signal, error,
                        &Client::GetProperties);
}

int32_t TagWBFinishGetProperties(uint32_t tagReference, uint32_t requestId,
                                 WBPropertyArrayHandle* properties, WBStrHandle* error) {
    if (AnyNull(properties, error)) return 1;
    return FinishGetOnHostTag(tagReference, error, [&](Client& client, std::string& text) {
        std::unordered_map<std::string, std::string> found;
        if (const int32_t status = client.FinishGetProperties(requestId, found, text))
            return status;
        // In key order, so that the host sees the same array for the same tag.
        std::vector<std::pair<std::string, std::string>> sorted(found.begin(), found.end());
        std::sort(sorted.begin(), sorted.end());
        return WriteHostProperties(properties, sorted);
    });
}

int32_t TagWBGetCollectAggregates(uint32_t tagReference, uint32_t* requestId,
                                  uint32_t* timeoutMs, uint32_t* signal, WBStrHandle* error) {
    return GetOnHostTag(tagReference, requestId, timeoutMs, signal, error,
                        &Client::GetCollectAggregates);
}

int32_t TagWBFinishGetCollectAggregates(uint32_t tagReference, uint32_t requestId,
                                        bool* collectAggregates, WBStrHandle* error) {
    if (AnyNull(collectAggregates, error)) return 1;
    return FinishGetOnHostTag(tagReference, error, [&](Client& client, std::string& text) {
        return client.FinishGetCollectAggregates(requestId, *collectAggregates, text);
    });
}

int32_t TagWBSetKeywords(uint32_t tagReference, WBStrArrayHandle keywords, uint64_t* instanceId,
                         uint32_t* requestId, uint32_t* timeoutMs, uint32_t* signal,
                         WBStrHandle* error) {
    return SetOnHostTag(tagReference, instanceId, requestId, timeoutMs, signal, error,
                        [&](Client& client, const std::shared_ptr<TagData>& tag,
                            const HostRequest& request, uint32_t& id, uint32_t& timeout,
                            std::string& text) {
                            return client.SetKeywords(tag, ReadHostStrings(keywords), false,
                                                      request, id, timeout, text);
                        });
}

int32_t TagWBSetProperties(uint32_t tagReference, WBPropertyArrayHandle properties,
                           uint64_t* instanceId, uint32_t* requestId, uint32_t* timeoutMs,
                           uint32_t* signal, WBStrHandle* error) {
    return SetPropertiesOnHostTag(tagReference, properties, false, instanceId, requestId,
                                  timeoutMs, signal, error);
}

int32_t TagWBUpdateProperties(uint32_t tagReference, WBPropertyArrayHandle properties,
                              uint64_t* instanceId, uint32_t* requestId, uint32_t* timeoutMs,
                              uint32_t* signal, WBStrHandle* error) {
    return SetPropertiesOnHostTag(tagReference, properties, true, instanceId, requestId,
                                  timeoutMs, signal, error);
}

int32_t TagWBSetCollectAggregates(uint32_t tagReference, const bool* collectAggregates,
                                  uint64_t* instanceId, uint32_t* requestId, uint32_t* timeoutMs,
                                  uint32_t* signal, WBStrHandle* error) {
    if (collectAggregates == nullptr) return 1;
    return SetOnHostTag(tagReference, instanceId, requestId, timeoutMs, signal, error,
                        [&](Client& client, const std::shared_ptr<TagData>& tag,
                            const HostRequest& request, uint32_t& id, uint32_t& timeout,
                            std::string& text) {
                            return client.SetCollectAggregates(tag, HostBool(collectAggregates),
                                                               request, id, timeout, text);
                        });
}

int32_t TagWBResetAggregates(uint64_t instanceId, WBReferenceArrayHandle tagReferences,
                             uint32_t* requestId, uint32_t* timeoutMs, uint32_t* signal,
                             WBStrHandle* error) {
    return OnHostReferences(instanceId, tagReferences, requestId, timeoutMs, signal, error,
                            &Client::ResetAggregates);
}

int32_t TagWBDelete(uint64_t instanceId, WBReferenceArrayHandle tagReferences,
                    uint32_t* requestId, uint32_t* timeoutMs, uint32_t* signal,
                    WBStrHandle* error) {
    return OnHostReferences(instanceId, tagReferences, requestId, timeoutMs, signal, error,
                            &Client::DeleteTags);
}

int32_t TagWBDeleteAll(uint64_t instanceId, WBStrHandle* error) {
    return FinishOnHostInstance(instanceId, error, [&](Client& client, std::string& text) {
        return client.DeleteAllTags(text);
    });
}

int32_t TagWBFinishRequest(uint64_t instanceId, uint32_t requestId, WBStrHandle* error) {
    return FinishOnHostInstance(instanceId, error, [&](Client& client, std::string& text) {
        return client.FinishRequest(requestId, text);
    });
}

int32_t TagWBFinishRequestSession(uint32_t tagReference, uint32_t requestId, WBStrHandle* error) {
    return FinishOnHostTag(tagReference, "Tag.InvalidTagReference", error,
                           [&](Client& client, const std::shared_ptr<TagData>&, std::string& text) {
                               return client.FinishRequest(requestId, text);
                           });
}
