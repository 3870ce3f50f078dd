#include "ConsoleSession.h"

#include <kvveldra/TagConsole.h>

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

std::optional<FoundTag> FindTag(const ConsoleInstance& instance, const std::string& path,
                                OpenedTags& opened) {
    const std::vector<std::string> search{path};
    const TagConsoleProperties noProperties;
    const std::vector<std::string> noKeywords;
    std::vector<int32_t> types;
    std::vector<std::string> paths;
    std::vector<uint32_t> references;
    uint32_t total = 0;
    std::string error;
    const int32_t status =
        TagConsoleListTag(instance.Id(), &search, &noProperties, &noKeywords, 0, 0, true,
                          instance.Verbose(), &types, &paths, &references, &total, &error);
    // Every listed tag is open now, whatever happens next.
    for (const uint32_t reference : references) opened.Add(reference);
    Check("look up " + path, status, error);
    std::optional<FoundTag> found;
    for (std::size_t i = 0; i < paths.size() && i < references.size() && i < types.size(); ++i) {
        if (paths[i] == path) found = FoundTag{paths[i], types[i], references[i]};
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
