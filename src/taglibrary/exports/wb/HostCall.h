#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

#include "errors/VeldraException.h"
#include "kvveldra/WBTypes.h"
#include "taglibrary/Client.h"
#include "taglibrary/exports/ErrorOut.h"
#include "taglibrary/exports/Frame.h"
#include "taglibrary/exports/wb/HostArrays.h"
#include "taglibrary/requests/AsyncRequestFactories.h"

// The frames that the host functions share. None of them waits: a request
// function files a request with a host signal and returns, and the host
// calls the finish once the signal fired or its wait ran out.
namespace Korvane::Veldra::TagLibrary {

using HostRequest = std::shared_ptr<AsyncRequest>;
using HostTags = std::vector<std::shared_ptr<TagData>>;

// Runs `operation(text)` as a host function. A failure that comes with a text
// is reported into the host's error string; a status without one (1 for a
// missing out-pointer, the host's own status of an allocation or variant
// call) goes back as it is, and the error string stays untouched. Any
// exception, the library's own included, is unexpected here, as in the
// console family: -251037 with its text as the insert.
template <typename Operation>
int32_t RunHost(WBStrHandle* error, Operation&& operation) {
    HostErrorOut out(error);
    return RunInFrame(out, [&] {
        std::string text;
        const int32_t status = operation(text);
        return status == 0 || text.empty() ? status : out.Report(status, text);
    });
}

// The look-ups of the frame with the failure's text going to `text`.
inline int32_t FindHostClient(uint64_t instanceId, std::shared_ptr<Client>& client,
                              std::string& text) {
    ConsoleErrorOut out(&text);
    return FindClient(instanceId, client, out);
}

inline int32_t FindHostTag(uint32_t tagReference, std::shared_ptr<Client>& client,
                           std::shared_ptr<TagData>& tag, std::string& text) {
    ConsoleErrorOut out(&text);
    return FindTag(tagReference, client, tag, out);
}

// The text and code of a registered error, with inserts.
inline int32_t HostError(const std::string& name, std::string& text,
                         const std::vector<std::string>& inserts = {}) {
    return FormatNamedError(name, inserts, text);
}

// A bool of the host is a byte, and any non-zero byte is true.
inline bool HostBool(const bool* value) {
    return *reinterpret_cast<const unsigned char*>(value) != 0;
}

inline bool AnyNull() { return false; }
template <typename First, typename... Rest>
bool AnyNull(const First* first, const Rest*... rest) {
    return first == nullptr || AnyNull(rest...);
}

// Makes the request of a host function when the call is about to send: the
// signal is allocated and its number written to *signal only then, so that a
// call refused by its checks leaves the host no signal number at all.
class HostRequestMaker {
public:
    explicit HostRequestMaker(uint32_t* signal) : signal_(signal) {}
    HostRequest operator()() const { return MakeWBAsyncRequest(*signal_); }

private:
    uint32_t* const signal_;
};

// A request function on one tag: `start(client, tag, makeRequest,
// requestId, timeoutMs, text)`; it calls makeRequest() once its checks pass.
template <typename Start>
int32_t RequestOnHostTag(uint32_t tagReference, uint32_t* requestId, uint32_t* timeoutMs,
                         uint32_t* signal, WBStrHandle* error, Start&& start) {
    if (AnyNull(requestId, timeoutMs, signal, error)) return 1;
    return RunHost(error, [&](std::string& text) {
        std::shared_ptr<Client> client;
        std::shared_ptr<TagData> tag;
        if (const int32_t status = FindHostTag(tagReference, client, tag, text)) return status;
        return start(*client, tag, HostRequestMaker(signal), *requestId, *timeoutMs, text);
    });
}

// A request function on an instance: `start(client, makeRequest, requestId,
// timeoutMs, text)`.
template <typename Start>
int32_t RequestOnHostInstance(uint64_t instanceId, uint32_t* requestId, uint32_t* timeoutMs,
                              uint32_t* signal, WBStrHandle* error, Start&& start) {
    if (AnyNull(requestId, timeoutMs, signal, error)) return 1;
    return RunHost(error, [&](std::string& text) {
        std::shared_ptr<Client> client;
        if (const int32_t status = FindHostClient(instanceId, client, text)) return status;
        return start(*client, HostRequestMaker(signal), *requestId, *timeoutMs, text);
    });
}

// The references of a host array that the table holds, in order; `missing`
// tells whether any was left out. A null array is empty.
inline HostTags ResolveHostReferences(WBReferenceArrayHandle references, bool& missing) {
    return LookupTags(ReadHostReferences(references), missing);
}

// A request function on a batch of references: `start(client, tags, request,
// requestId, timeoutMs, text)` runs for the valid ones; none valid is
// "Tag.InvalidTagReference". With `anyInvalid` the flag goes to the caller,
// who reports it at the finish; without it, the request itself carries the
// error, so that the finish reports it after the work on the others is done.
template <typename Start>
int32_t RequestOnHostReferences(uint64_t instanceId, WBReferenceArrayHandle references,
                                bool* anyInvalid, uint32_t* requestId, uint32_t* timeoutMs,
                                uint32_t* signal, WBStrHandle* error, Start&& start) {
    return RequestOnHostInstance(
        instanceId, requestId, timeoutMs, signal, error,
        [&](Client& client, const HostRequestMaker& makeRequest, uint32_t& id, uint32_t& timeout,
            std::string& text) {
            bool missing = false;
            const HostTags tags = ResolveHostReferences(references, missing);
            if (tags.empty()) return HostError("Tag.InvalidTagReference", text);
            const HostRequest request = makeRequest();
            HostRequest filed = request;
            if (anyInvalid != nullptr) {
                *anyInvalid = missing;
            } else if (missing) {
                std::string invalid;
                const int32_t code = HostError("Tag.InvalidTagReference", invalid);
                filed = MakeAsyncRequestWithError(request, code, invalid);
            }
            return start(client, tags, filed, id, timeout, text);
        });
}

// A finish on one tag. The gets' finishes report reference 0 as
// "Tag.InvalidTagDataType" (`zeroName`); the others as an invalid reference.
template <typename Finish>
int32_t FinishOnHostTag(uint32_t tagReference, const char* zeroName, WBStrHandle* error,
                        Finish&& finish) {
    return RunHost(error, [&](std::string& text) {
        if (tagReference == 0) return HostError(zeroName, text);
        std::shared_ptr<Client> client;
        std::shared_ptr<TagData> tag;
        if (const int32_t status = FindHostTag(tagReference, client, tag, text)) return status;
        return finish(*client, tag, text);
    });
}

// A finish on an instance: `finish(client, text)`.
template <typename Finish>
int32_t FinishOnHostInstance(uint64_t instanceId, WBStrHandle* error, Finish&& finish) {
    return RunHost(error, [&](std::string& text) {
        std::shared_ptr<Client> client;
        if (const int32_t status = FindHostClient(instanceId, client, text)) return status;
        return finish(*client, text);
    });
}

}  // namespace Korvane::Veldra::TagLibrary
