#include "ConsoleSession.h"

#include <kvveldra/TagConsole.h>

#include <algorithm>
#include <chrono>
#include <cstdio>

#include "BrokerProbe.h"
#include "ConfigurationFiles.h"
#include "LibraryText.h"
#include "SetupAdvice.h"
#include "StatusCodes.h"

namespace kvtag {
namespace {

// How long the knock on the broker's port after a failed connect may take.
constexpr std::chrono::milliseconds kProbeTimeout{2000};

std::string Operation(const GlobalOptions& options) {
    // The library's text does not name the configuration; this does.
    return options.config ? "connect with configuration '" + *options.config + "'"
                          : std::string("connect with the default configuration");
}

}  // namespace

Reservation::Reservation() {
    const int32_t status = TagConsoleReserve(&reserved_);
    if (status != 0) {
        // A failed reservation stays counted: it is released all the same.
        TagConsoleUnreserve(&reserved_);
        throw LibraryError("reserve", status, "");
    }
}

Reservation::~Reservation() {
    TagConsoleUnreserve(&reserved_);
}

ConsoleInstance::ConsoleInstance(const GlobalOptions& options, uint64_t instanceId)
    : id_(instanceId), verbose_(options.verbose), config_(options.config) {
    const uint32_t timeoutMs = options.timeoutMs.value_or(kDefaultTimeoutMs);
    // A configuration named on the command line is that one or none.
    const bool allowFallback = !options.config.has_value();
    std::string error;
    const int32_t status = TagConsoleInitialize(id_, options.config ? &*options.config : nullptr,
                                                &timeoutMs, &allowFallback, &error);
    if (status != 0) {
        // A failed initialize may leave an empty entry behind; removing it
        // is harmless when there is none.
        std::string ignored;
        TagConsoleCloseInstance(id_, &ignored);
        const Prober probe = [](const std::string& host, int port) {
            return ProbeBroker(host, port, kProbeTimeout);
        };
        throw LibraryError(Operation(options), status, error,
                           ConnectAdvice(status, options.config, ReadConfigurations(), probe));
    }
}

ConsoleInstance::~ConsoleInstance() {
    std::string error;
    const int32_t status = TagConsoleCloseInstance(id_, &error);
    if (status != 0 && verbose_) {
        std::fprintf(stderr, "kvtag: closing the instance: status %d: %s\n", status, error.c_str());
    }
}

void ConsoleInstance::Request(const std::string& operation, const std::vector<std::string>& inserts,
                              const std::function<int32_t(std::string& error)>& call) const {
    std::string error;
    const int32_t status = call(error);
    if (status == 0) return;
    const std::string advice =
        status == status::kRequestTimedOut
            ? ServiceTimeoutAdvice(config_, ReadConfigurations(), kLibraryRequestTimeoutMs)
            : "";
    throw LibraryError(operation, status, FilledLibraryText(error, inserts), advice);
}

OpenedTags::~OpenedTags() {
    for (auto it = references_.rbegin(); it != references_.rend(); ++it) {
        std::string error;
        const int32_t status = TagConsoleClose(*it, verbose_, &error);
        if (status != 0 && verbose_) {
            std::fprintf(stderr, "kvtag: closing reference %u: status %d: %s\n", *it, status,
                         error.c_str());
        }
    }
}

Listing ListTags(const ConsoleInstance& instance, const std::string& operation,
                 const std::string& pattern, const TagConsoleProperties& properties,
                 const std::vector<std::string>& keywords, uint32_t skip, uint32_t take,
                 OpenedTags& opened) {
    const std::vector<std::string> search{pattern};
    Listing listing;
    std::vector<uint32_t> references;
    // Every listed tag is open now, whatever happens next.
    const auto keepOpened = [&] {
        for (const uint32_t reference : references) opened.Add(reference);
    };
    try {
        instance.Request(operation, {pattern}, [&](std::string& error) {
            return TagConsoleListTag(instance.Id(), &search, &properties, &keywords, skip, take,
                                     true, instance.Verbose(), &listing.types, &listing.paths,
                                     &references, &listing.total, &error);
        });
    } catch (const LibraryError&) {
        keepOpened();
        throw;
    }
    keepOpened();
    // A record needs its path, type and reference alike.
    const std::size_t complete =
        std::min({listing.paths.size(), listing.types.size(), references.size()});
    listing.paths.resize(complete);
    listing.types.resize(complete);
    listing.references = std::move(references);
    listing.references.resize(complete);
    return listing;
}

std::optional<FoundTag> FindTag(const ConsoleInstance& instance, const std::string& path,
                                OpenedTags& opened) {
    const Listing listing = ListTags(instance, "look up " + path, path, {}, {}, 0, 0, opened);
    std::optional<FoundTag> found;
    for (std::size_t i = 0; i < listing.paths.size(); ++i) {
        if (listing.paths[i] == path) {
            found = FoundTag{listing.paths[i], listing.types[i], listing.references[i]};
        }
    }
    return found;
}

FoundTag CreateTag(const ConsoleInstance& instance, const std::string& path, int32_t type,
                   OpenedTags& opened) {
    uint32_t reference = 0;
    instance.Request("create " + path, {path}, [&](std::string& error) {
        return TagConsoleOpen(instance.Id(), &path, type, instance.Verbose(), &reference, &error);
    });
    opened.Add(reference);
    return FoundTag{path, type, reference};
}

}  // namespace kvtag
