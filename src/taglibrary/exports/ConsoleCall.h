#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "taglibrary/Client.h"
#include "taglibrary/exports/ErrorOut.h"
#include "taglibrary/exports/Frame.h"
#include "taglibrary/requests/ConsoleAsyncRequest.h"

// The frames that the blocking console functions share.
namespace Korvane::Veldra::TagLibrary {

// One blocking round trip: `start(request, requestId, timeoutMs, text)` sends
// with a fresh console request, the call waits for the reply or the
// time-out, and `finish(requestId, text)` evaluates what came, a missing
// reply included.
template <typename Start, typename Finish>
int32_t RunBlocking(Start&& start, Finish&& finish, std::string& text) {
    const auto request = std::make_shared<ConsoleAsyncRequest>();
    uint32_t requestId = 0;
    uint32_t timeoutMs = 0;
    if (const int32_t status = start(request, requestId, timeoutMs, text)) return status;
    request->Wait(timeoutMs);
    return finish(requestId, text);
}

// A blocking round trip whose finish has nothing to deliver.
template <typename Start>
int32_t RunBlockingToFinish(Client& client, Start&& start, std::string& text) {
    return RunBlocking(
        std::forward<Start>(start),
        [&](uint32_t requestId, std::string& out) { return client.FinishRequest(requestId, out); },
        text);
}

// A console function on one tag reference: resolves the reference, sets the
// Client's verbose flag, and runs `operation(client, tag, text)`.
template <typename Operation>
int32_t RunOnConsoleTag(uint32_t tagReference, bool verbose, std::string* error,
                        Operation&& operation) {
    ConsoleErrorOut out(error);
    return RunInFrame(out, [&] {
        if (tagReference == 0) return ReportNamedError("Tag.InvalidTagReference", out);
        std::shared_ptr<Client> client;
        std::shared_ptr<TagData> tag;
        if (const int32_t status = FindTag(tagReference, client, tag, out)) return status;
        client->SetVerbose(verbose);
        std::string text;
        const int32_t status = operation(*client, tag, text);
        return status == 0 ? status : out.Report(status, text);
    });
}

// A console function on an instance: `operation(client, text)`.
template <typename Operation>
int32_t RunOnConsoleInstance(uint64_t instanceId, bool verbose, std::string* error,
                             Operation&& operation) {
    ConsoleErrorOut out(error);
    return RunInFrame(out, [&] {
        std::shared_ptr<Client> client;
        if (const int32_t status = FindClient(instanceId, client, out)) return status;
        client->SetVerbose(verbose);
        std::string text;
        const int32_t status = operation(*client, text);
        return status == 0 ? status : out.Report(status, text);
    });
}

// A console function on a list of references of one instance:
// `operation(client, tags, text)` runs for the valid ones. When some were
// not valid, a successful operation still reports "Tag.InvalidTagReference".
template <typename Operation>
int32_t RunOnConsoleReferences(uint64_t instanceId, const std::vector<uint32_t>* references,
                               bool verbose, std::string* error, Operation&& operation) {
    ConsoleErrorOut out(error);
    return RunInFrame(out, [&] {
        if (references == nullptr) return 1;
        std::shared_ptr<Client> client;
        if (const int32_t status = FindClient(instanceId, client, out)) return status;
        client->SetVerbose(verbose);
        bool missing = false;
        const auto tags = LookupTags(*references, missing);
        if (tags.empty()) return ReportNamedError("Tag.InvalidTagReference", out);
        std::string text;
        if (const int32_t status = operation(*client, tags, text)) return out.Report(status, text);
        return missing ? ReportNamedError("Tag.InvalidTagReference", out) : 0;
    });
}

}  // namespace Korvane::Veldra::TagLibrary
