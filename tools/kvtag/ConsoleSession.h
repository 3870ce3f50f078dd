#pragma once

#include <kvveldra/TagConsole.h>

#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "CommandLine.h"
#include "Failures.h"

namespace kvtag {

// The process's reservation of the console family, released on
// destruction. Throws LibraryError when the reservation fails.
class Reservation {
public:
    Reservation();
    ~Reservation();
    Reservation(const Reservation&) = delete;
    Reservation& operator=(const Reservation&) = delete;

private:
    bool reserved_ = false;
};

// One initialized instance of the console family on the broker the
// options name, closed on destruction. It lives inside a Reservation.
class ConsoleInstance {
public:
    // The connect time-out when --timeout is not given.
    static constexpr uint32_t kDefaultTimeoutMs = 10000;
    // How long the library itself waits for each answer of the tag service.
    static constexpr uint32_t kLibraryRequestTimeoutMs = 10000;

    // The instance id when none is given. Not 0: the library's default
    // instance ignores the configuration and time-out.
    static constexpr uint64_t kDefaultInstanceId = 1;

    // Throws LibraryError, with what kvtag finds behind the library's status.
    explicit ConsoleInstance(const GlobalOptions& options,
                             uint64_t instanceId = kDefaultInstanceId);
    ~ConsoleInstance();
    ConsoleInstance(const ConsoleInstance&) = delete;
    ConsoleInstance& operator=(const ConsoleInstance&) = delete;

    uint64_t Id() const { return id_; }
    bool Verbose() const { return verbose_; }

    // Runs one call of the library that waits for the tag service (at most
    // the library's 10 s). A failed call throws LibraryError: a refusal that lost its inserts is filled with
    // `inserts` ({0} first), a time-out says what was waited for.
    void Request(const std::string& operation, const std::vector<std::string>& inserts,
                 const std::function<int32_t(std::string& error)>& call) const;

private:
    uint64_t id_;
    bool verbose_ = false;
    std::optional<std::string> config_;
};

// Tag references that this run opened; each is closed once per opening,
// on destruction, before the instance goes.
class OpenedTags {
public:
    explicit OpenedTags(bool verbose) : verbose_(verbose) {}
    ~OpenedTags();
    OpenedTags(const OpenedTags&) = delete;
    OpenedTags& operator=(const OpenedTags&) = delete;

    void Add(uint32_t reference) { references_.push_back(reference); }

private:
    bool verbose_;
    std::vector<uint32_t> references_;
};

// A tag found on the service and opened here.
struct FoundTag {
    std::string path;
    int32_t type = -1;
    uint32_t reference = 0;
};

// What a listing found: paths and types in the service's order, and the
// number of all matches.
struct Listing {
    std::vector<std::string> paths;
    std::vector<int32_t> types;
    std::vector<uint32_t> references;
    uint32_t total = 0;
};

// Lists a page of the tags that match `pattern`; every reference the
// library opened goes to `opened`, also on failure. Throws LibraryError.
Listing ListTags(const ConsoleInstance& instance, const std::string& operation,
                 const std::string& pattern, const TagConsoleProperties& properties,
                 const std::vector<std::string>& keywords, uint32_t skip, uint32_t take,
                 OpenedTags& opened);

// Looks up the tag of an exact path without creating it; nothing when the
// service has no such tag. Throws LibraryError.
std::optional<FoundTag> FindTag(const ConsoleInstance& instance, const std::string& path,
                                OpenedTags& opened);

// Creates the tag (or opens it when it has the type already). Throws
// LibraryError.
FoundTag CreateTag(const ConsoleInstance& instance, const std::string& path, int32_t type,
                   OpenedTags& opened);

}  // namespace kvtag
