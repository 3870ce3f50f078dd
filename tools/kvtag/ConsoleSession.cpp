#include "ConsoleSession.h"

#include <kvveldra/TagConsole.h>

#include <algorithm>
#include <cstdio>

#include "Failures.h"

namespace kvtag {

void Check(const std::string& operation, int32_t status, const std::string& error) {
    if (status != 0) throw LibraryError(operation, status, error);
}

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

ConsoleInstance::ConsoleInstance(const GlobalOptions& options) : verbose_(options.verbose) {
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
        // The library's text does not name the configuration; this does.
        throw LibraryError(options.config ? "connect with configuration '" + *options.config + "'"
                                          : std::string("connect with the default configuration"),
                           status, error);
    }
}

ConsoleInstance::~ConsoleInstance() {
    std::string error;
    const int32_t status = TagConsoleCloseInstance(id_, &error);
    if (status != 0 && verbose_) {
        std::fprintf(stderr, "kvtag: closing the instance: status %d: %s\n", status, error.c_str());
    }
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
    std::string error;
    const int32_t status = TagConsoleListTag(instance.Id(), &search, &properties, &keywords, skip,
                                             take, true, instance.Verbose(), &listing.types,
                                             &listing.paths, &references, &listing.total, &error);
    // Every listed tag is open now, whatever happens next.
    for (const uint32_t reference : references) opened.Add(reference);
    Check(operation, status, error);
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
    std::string error;
    const int32_t status =
        TagConsoleOpen(instance.Id(), &path, type, instance.Verbose(), &reference, &error);
    Check("create " + path, status, error);
    opened.Add(reference);
    return FoundTag{path, type, reference};
}

}  // namespace kvtag
