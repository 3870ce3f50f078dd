#pragma once

#include <chrono>
#include <cstdint>
#include <filesystem>
#include <functional>
#include <memory>
#include <string>
#include <unordered_map>
#include <utility>
#include <vector>

#include "messagebus/config/VeldraConfiguration.h"

namespace Korvane::Veldra::MessageBus {

struct BusConfigurationEntry {
    std::string Path;  // the file the configuration came from
    VeldraConfiguration Configuration;
};

// The broker configurations of this node: every ".json" file of the
// "VeldraConfigurations" directory under the data root, keyed by lower-case
// id. The directory is checked again at most every 5 seconds, and reloaded
// when a file was added, removed or written.
class BusConfigurations {
public:
    using Clock = std::function<std::chrono::steady_clock::time_point()>;

    static constexpr const char* kLocalhostId = "veldra_localhost";
    static constexpr const char* kMasterId = "veldra_master";

    // ---- The process-wide store ----
    // Builds and loads the store. When one exists already, throws a pointer to
    // a VeldraException (-251010) that the catcher owns.
    static void Initialize(const std::string& configurationId, bool allowFallback);
    // The store, built with ("", true) on first use.
    static BusConfigurations* GetInstance();
    // The configuration selected at initialization, after a refresh.
    static BusConfigurationEntry GetSelected();
    // The configuration of an id, with the fallback rule, after a refresh.
    static BusConfigurationEntry GetNamed(const std::string& configurationId, bool allowFallback);
    // Drops the process-wide store; the next use loads the directory anew.
    static void Discard();

    // ---- One store over a given directory ----
    BusConfigurations(std::filesystem::path directory, std::string configurationId,
                      bool allowFallback, Clock clock = std::chrono::steady_clock::now);

    // Reads every file; on any failure the entries loaded before stay.
    void Load();
    // Reloads when 5 seconds have passed and the directory changed.
    void Refresh();
    // The entry of an id; an empty or unknown id (with fallback allowed) takes
    // "veldra_localhost", then "veldra_master".
    BusConfigurationEntry Select(const std::string& configurationId, bool allowFallback) const;

    const BusConfigurationEntry& Selected() const { return selected_; }
    std::size_t Count() const { return entries_.size(); }

private:
    using Entries = std::unordered_map<std::string, BusConfigurationEntry>;
    using FileTimes = std::unordered_map<std::string, std::filesystem::file_time_type>;

    using ScannedFiles = std::vector<std::pair<std::string, std::filesystem::file_time_type>>;

    // The matching files of the directory in its own order, with their write
    // times; throws when the directory cannot be read.
    ScannedFiles ScanDirectory() const;
    static FileTimes TimesOf(const ScannedFiles& files);
    const BusConfigurationEntry* Fallback() const;

    std::filesystem::path directory_;
    std::string configurationId_;
    bool allowFallback_;
    Clock clock_;
    Entries entries_;
    FileTimes fileTimes_;
    std::chrono::steady_clock::time_point lastCheck_;
    BusConfigurationEntry selected_;
};

}  // namespace Korvane::Veldra::MessageBus
