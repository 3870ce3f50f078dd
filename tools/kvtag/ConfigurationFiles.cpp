#include "ConfigurationFiles.h"

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>

#include "JsonCheck.h"

namespace kvtag {
namespace {

namespace fs = std::filesystem;

std::string Lower(std::string text) {
    for (char& c : text) {
        if (c >= 'A' && c <= 'Z') c = static_cast<char>(c - 'A' + 'a');
    }
    return text;
}

bool HasJsonSuffix(const std::string& name) {
    return name.size() > 5 && Lower(name.substr(name.size() - 5)) == ".json";
}

// A port as the library reads it: a number cut to its whole part, or a text
// of decimal digits with an optional sign, within 32 bits.
std::optional<int32_t> PortValue(const JsonScalar& value) {
    double number = 0;
    if (value.kind == JsonKind::Number) {
        number = std::trunc(std::strtod(value.text.c_str(), nullptr));
    } else if (value.kind == JsonKind::String) {
        const std::string& text = value.text;
        const std::size_t from = !text.empty() && (text[0] == '+' || text[0] == '-') ? 1 : 0;
        if (from == text.size() ||
            text.find_first_not_of("0123456789", from) != std::string::npos || text.size() > 12) {
            return std::nullopt;
        }
        number = std::strtod(text.c_str(), nullptr);
    } else {
        return std::nullopt;
    }
    if (!(number >= -2147483648.0 && number <= 2147483647.0)) return std::nullopt;
    return static_cast<int32_t>(number);
}

bool IsText(const JsonScalar& value) {
    return value.kind == JsonKind::String;
}

bool IsBool(const JsonScalar& value) {
    return value.kind == JsonKind::Bool;
}

bool IsPort(const JsonScalar& value) {
    return PortValue(value).has_value();
}

bool IsConnectionType(const JsonScalar& value) {
    if (value.kind == JsonKind::Number) {
        return std::isfinite(std::strtod(value.text.c_str(), nullptr));
    }
    if (value.kind != JsonKind::String) return false;
    for (const char* name : {"Local", "Cluster", "Master", "Client"}) {
        if (value.text == name) return true;
    }
    return false;
}

// A key of the record, what the library accepts as its value (null aside),
// and how to say that.
struct KnownKey {
    const char* name;
    bool (*accepts)(const JsonScalar& value);
    const char* needs;
};

constexpr const char* kText = "a text";
constexpr KnownKey kKeys[] = {
    {"Id", IsText, kText},
    {"DisplayName", IsText, kText},
    {"ConnectionType", IsConnectionType,
     "\"Local\", \"Cluster\", \"Master\" or \"Client\", spelt so, or a number"},
    {"ExchangeName", IsText, kText},
    {"Host", IsText, kText},
    {"VirtualHost", IsText, kText},
    {"Port", IsPort, "a whole number (or a text of one) within 32 bits"},
    {"User", IsText, kText},
    {"Password", IsText, kText},
    {"UseTls", IsBool, "true or false"},
    {"TlsServerName", IsText, kText},
    {"CertPath", IsText, kText}};

std::string Shown(const JsonScalar& value) {
    if (value.kind == JsonKind::String) return "the text \"" + value.text + "\"";
    if (value.kind == JsonKind::Number) return "the number " + value.text;
    return JsonKindName(value.kind);
}

// Why the library refuses the value of a known key; empty when it takes it.
std::string Refusal(const KnownKey& key, const JsonScalar& value) {
    if (value.kind == JsonKind::Null || key.accepts(value)) return "";
    return "the key \"" + std::string(key.name) + "\" holds " + Shown(value) + "; it needs " +
           key.needs;
}

void Keep(ConfigurationFile& file, const KnownKey& key, const JsonScalar& value) {
    const std::string name = key.name;
    const bool text = value.kind == JsonKind::String;
    if (name == "Id" && text) file.id = value.text;
    if (name == "ExchangeName" && text) file.exchange = value.text;
    if (name == "Host" && text) file.host = value.text;
    if (name == "User" && text) file.user = value.text;
    if (name == "CertPath" && text) file.certPath = value.text;
    if (name == "Port") file.port = PortValue(value);
    if (name == "UseTls" && value.kind == JsonKind::Bool) file.useTls = value.truth;
}

void ReadMember(ConfigurationFile& file, const std::string& key, const JsonScalar& value) {
    for (const auto& known : kKeys) {
        if (key == known.name) {
            const std::string refusal = Refusal(known, value);
            if (!refusal.empty()) file.refused.push_back(refusal);
            Keep(file, known, value);
            return;
        }
    }
    for (const auto& known : kKeys) {
        if (Lower(key) == Lower(known.name)) {
            file.miscasedKeys.push_back("\"" + key + "\" (the library reads \"" + known.name +
                                        "\")");
        }
    }
}

}  // namespace

std::string IdKey(const std::optional<std::string>& id) {
    return Lower(id.value_or(""));
}

ConfigurationFile ReadConfigurationText(const std::string& path, const std::string& text) {
    ConfigurationFile file;
    file.path = path;
    file.name = fs::path(path).filename().string();
    const JsonDocument document = ReadJsonDocument(text);
    if (document.error) {
        file.unparsable = "it is not JSON: " + *document.error;
        return file;
    }
    if (document.rootKind != JsonKind::Object && document.rootKind != JsonKind::Null) {
        file.refused.push_back(std::string("it holds ") + JsonKindName(document.rootKind) +
                               " where an object was expected");
        return file;
    }
    for (const auto& [key, value] : document.members) {
        bool seen = false;
        for (const auto& [earlier, ignored] : document.members) {
            if (&earlier == &key) break;
            seen = seen || earlier == key;
        }
        if (!seen) ReadMember(file, key, value);
    }
    return file;
}

ConfigurationFolder ReadConfigurations(const std::string& dataRoot, bool rootFromEnvironment) {
    ConfigurationFolder folder;
    folder.dataRoot = dataRoot;
    folder.rootFromEnvironment = rootFromEnvironment;
    folder.directory = (fs::path(dataRoot) / kConfigurationsFolder).string();
    std::error_code error;
    const auto status = fs::status(folder.directory, error);
    if (!error && !fs::is_directory(status))
        error = std::make_error_code(std::errc::not_a_directory);
    fs::directory_iterator entries;
    if (!error) entries = fs::directory_iterator(folder.directory, error);
    if (error) {
        folder.unreadable = error.message();
        return folder;
    }
    for (; entries != fs::directory_iterator(); entries.increment(error)) {
        std::error_code fileError;
        const std::string name = entries->path().filename().string();
        if (!HasJsonSuffix(name) || !entries->is_regular_file(fileError)) continue;
        std::ifstream in(entries->path(), std::ios::binary);
        if (!in) {
            ConfigurationFile unreadable;
            unreadable.path = entries->path().string();
            unreadable.name = name;
            unreadable.unparsable = "it cannot be read";
            folder.files.push_back(std::move(unreadable));
            continue;
        }
        const std::string text{std::istreambuf_iterator<char>(in),
                               std::istreambuf_iterator<char>()};
        folder.files.push_back(ReadConfigurationText(entries->path().string(), text));
        if (error) break;
    }
    std::sort(
        folder.files.begin(), folder.files.end(),
        [](const ConfigurationFile& a, const ConfigurationFile& b) { return a.name < b.name; });
    return folder;
}

ConfigurationFolder ReadConfigurations() {
    // As the library reads it: a set-user-ID program does not let its caller
    // move the data root.
    const char* root = secure_getenv(kDataRootVariable);
    const bool fromEnvironment = root != nullptr && *root != '\0';
    return ReadConfigurations(fromEnvironment ? root : kDefaultDataRoot, fromEnvironment);
}

const ConfigurationFile* FindConfiguration(const ConfigurationFolder& folder,
                                           const std::string& id) {
    for (const auto& file : folder.files) {
        if (file.Usable() && file.id && IdKey(file.id) == Lower(id)) return &file;
    }
    return nullptr;
}

const ConfigurationFile* UsedConfiguration(const ConfigurationFolder& folder,
                                           const std::optional<std::string>& id) {
    if (id) return FindConfiguration(folder, *id);
    if (const auto* master = FindConfiguration(folder, kMasterId)) return master;
    return FindConfiguration(folder, kLocalhostId);
}

}  // namespace kvtag
