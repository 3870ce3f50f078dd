#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

namespace kvtag {

// The broker configurations as the library finds them, read again by kvtag
// to say what is wrong with them: the data root is $VELDRA_DATA_DIR when set
// and not empty, else /etc/korvane/kvveldra; the configurations are the
// regular files of its folder VeldraConfigurations whose names end in
// ".json" (in any case) after at least one more character.
inline constexpr const char* kDefaultDataRoot = "/etc/korvane/kvveldra";
inline constexpr const char* kDataRootVariable = "VELDRA_DATA_DIR";
inline constexpr const char* kConfigurationsFolder = "VeldraConfigurations";
// The default configuration: the library's first load needs one of them.
inline constexpr const char* kLocalhostId = "veldra_localhost";
inline constexpr const char* kMasterId = "veldra_master";

// One configuration file and what kvtag read of it.
struct ConfigurationFile {
    std::string path;
    std::string name;  // the file name alone
    // Why the library cannot parse it: it cannot be read, or it is not JSON
    // ("it is not JSON: line 3, column 12: ..."). Empty when it can.
    std::string unparsable;
    // Why the library refuses the record: an array in place of the object,
    // a key of the wrong kind ("Port" as a text that is no number).
    std::vector<std::string> refused;
    // Keys that the library does not know but that differ from one of its
    // keys only in case ("port" for "Port"): the library ignores them.
    std::vector<std::string> miscasedKeys;

    std::optional<std::string> id;
    std::optional<std::string> exchange;
    std::optional<std::string> host;
    std::optional<int32_t> port;
    std::optional<std::string> user;
    std::optional<bool> useTls;
    std::optional<std::string> certPath;

    // A file the library takes.
    bool Usable() const { return unparsable.empty() && refused.empty(); }
};

struct ConfigurationFolder {
    std::string dataRoot;
    bool rootFromEnvironment = false;
    std::string directory;  // the data root joined with VeldraConfigurations
    // Why the directory cannot be listed; empty when it can.
    std::string unreadable;
    std::vector<ConfigurationFile> files;  // sorted by name
};

// Reads the folder of a data root; without arguments, of the root the
// library uses, from the environment.
ConfigurationFolder ReadConfigurations();
ConfigurationFolder ReadConfigurations(const std::string& dataRoot, bool rootFromEnvironment);

// Reads one file's text as the library reads its records.
ConfigurationFile ReadConfigurationText(const std::string& path, const std::string& text);

// The id the library files a configuration under: its Id in lower case
// (ASCII letters only), "" when it has none.
std::string IdKey(const std::optional<std::string>& id);

// The readable file whose Id matches `id` as the library matches it, without
// regard to case; nothing when none does.
const ConfigurationFile* FindConfiguration(const ConfigurationFolder& folder,
                                           const std::string& id);

// The configuration kvtag's connection uses: the one of `id`, or without an
// id veldra_master, else veldra_localhost.
const ConfigurationFile* UsedConfiguration(const ConfigurationFolder& folder,
                                           const std::optional<std::string>& id);

}  // namespace kvtag
