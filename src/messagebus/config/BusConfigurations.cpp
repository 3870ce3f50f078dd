#include "messagebus/config/BusConfigurations.h"

#include <algorithm>
#include <fstream>
#include <iterator>
#include <mutex>

#include "errors/ErrorCodes.h"
#include "errors/VeldraException.h"
#include "messagelibrary/json/JsonParser.h"
#include "utilities/NoDestructor.h"
#include "utilities/Paths.h"

namespace Korvane::Veldra::MessageBus {
namespace {

using ErrorCodes::kFailedToParse;
constexpr int32_t kNoConfigurations = ErrorCodes::kNoVeldraConfigurations;
constexpr int32_t kDirectoryNotFound = ErrorCodes::kConfigDirectoryNotFound;
constexpr int32_t kDuplicateId = ErrorCodes::kDuplicateConfigurationId;
constexpr auto kRefreshInterval = std::chrono::seconds(5);

std::string ToLower(std::string text) {
    std::transform(text.begin(), text.end(), text.begin(),
                   [](unsigned char c) { return static_cast<char>(std::tolower(c)); });
    return text;
}

bool HasJsonSuffix(const std::string& name) {
    return name.size() > 5 && ToLower(name.substr(name.size() - 5)) == ".json";
}

std::string ReadWholeFile(const std::filesystem::path& path) {
    std::ifstream file(path, std::ios::binary);
    if (!file) {
        throw VeldraException(kFailedToParse,
                              "Malformed Veldra configuration file '" + path.string() + "'.");
    }
    return std::string(std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>());
}

// The process-wide store and the lock around it.
struct ProcessStore {
    std::recursive_mutex mutex;
    std::unique_ptr<BusConfigurations> instance;
};

ProcessStore& Store() {
    static VeldraUtilities::NoDestructor<ProcessStore> store;  // outlives static destruction
    return store.Get();
}

std::filesystem::path ProcessDirectory() {
    return std::filesystem::path(VeldraUtilities::GetDataDirectory()) / "VeldraConfigurations";
}

}  // namespace

BusConfigurations::BusConfigurations(std::filesystem::path directory, std::string configurationId,
                                     bool allowFallback, Clock clock)
    : directory_(std::move(directory)),
      configurationId_(std::move(configurationId)),
      allowFallback_(allowFallback),
      clock_(std::move(clock)) {}

BusConfigurations::ScannedFiles BusConfigurations::ScanDirectory() const {
    std::error_code error;
    const auto status = std::filesystem::status(directory_, error);
    if (!error && !std::filesystem::is_directory(status)) {
        error = std::make_error_code(std::errc::not_a_directory);
    }
    std::filesystem::directory_iterator entry;
    if (!error) entry = std::filesystem::directory_iterator(directory_, error);
    if (error) {
        throw VeldraException(kDirectoryNotFound,
                              "Veldra configurations directory not found: " + directory_.string() +
                                  ". Error: " + error.message());
    }
    ScannedFiles files;
    for (; entry != std::filesystem::directory_iterator(); entry.increment(error)) {
        const std::string name = entry->path().filename().string();
        std::error_code fileError;
        if (!HasJsonSuffix(name) || !entry->is_regular_file(fileError)) continue;
        files.emplace_back(entry->path().string(), entry->last_write_time(fileError));
        if (error) break;
    }
    return files;
}

BusConfigurations::FileTimes BusConfigurations::TimesOf(const ScannedFiles& files) {
    return FileTimes(files.begin(), files.end());
}

void BusConfigurations::Load() {
    const ScannedFiles files = ScanDirectory();
    Entries loaded;
    for (const auto& file : files) {
        VeldraMessageLibrary::JsonVariant root;
        if (!VeldraMessageLibrary::Parse(root, ReadWholeFile(file.first))) {
            throw VeldraException(kFailedToParse,
                                  "Malformed Veldra configuration file '" + file.first + "'.");
        }
        BusConfigurationEntry entry{file.first, VeldraConfiguration::FromJson(root)};
        const std::string id = ToLower(entry.Configuration.Id.value_or(""));
        if (entry.Configuration.Id) entry.Configuration.Id = id;
        if (!loaded.emplace(id, std::move(entry)).second) {
            throw VeldraException(
                kDuplicateId,
                "Duplicate id '" + id + "' in Veldra configuration file '" + file.first + "'.");
        }
    }
    if (loaded.empty()) {
        throw VeldraException(kNoConfigurations, "No Veldra configurations found in directory: " +
                                                     directory_.string());
    }
    entries_.swap(loaded);
    fileTimes_ = TimesOf(files);
    lastCheck_ = clock_();
    selected_ = Select(configurationId_, allowFallback_);
}

void BusConfigurations::Refresh() {
    if (clock_() - lastCheck_ < kRefreshInterval) return;
    if (TimesOf(ScanDirectory()) != fileTimes_) {
        fileTimes_.clear();
        Load();
    }
    lastCheck_ = clock_();
}

const BusConfigurationEntry* BusConfigurations::Fallback() const {
    for (const char* id : {kLocalhostId, kMasterId}) {
        const auto found = entries_.find(id);
        if (found != entries_.end()) return &found->second;
    }
    return nullptr;
}

BusConfigurationEntry BusConfigurations::Select(const std::string& configurationId,
                                                bool allowFallback) const {
    if (configurationId.empty()) {
        if (const auto* fallback = Fallback()) return *fallback;
        throw VeldraException(kNoConfigurations, "No Veldra configurations available.");
    }
    const auto found = entries_.find(ToLower(configurationId));
    if (found != entries_.end()) return found->second;
    if (!allowFallback) {
        throw VeldraException(kNoConfigurations,
                              "No Veldra configuration '" + configurationId +
                                  "' found, and fallback configurations were not enabled.");
    }
    if (const auto* fallback = Fallback()) return *fallback;
    throw VeldraException(kNoConfigurations,
                          "No Veldra configuration '" + configurationId +
                              "' found, and no fallback configurations available.");
}

void BusConfigurations::Initialize(const std::string& configurationId, bool allowFallback) {
    auto& store = Store();
    std::lock_guard<std::recursive_mutex> lock(store.mutex);
    if (store.instance) {
        throw new VeldraException(
            ErrorCodes::kMultipleInitializations,
            "Attempt to reinitialize Message Bus with multiple configurations.");
    }
    auto instance =
        std::make_unique<BusConfigurations>(ProcessDirectory(), configurationId, allowFallback);
    instance->Load();  // a throw leaves no store, so the next call tries again
    store.instance = std::move(instance);
}

BusConfigurations* BusConfigurations::GetInstance() {
    auto& store = Store();
    std::lock_guard<std::recursive_mutex> lock(store.mutex);
    if (!store.instance) Initialize("", true);
    return store.instance.get();
}

BusConfigurationEntry BusConfigurations::GetSelected() {
    auto& store = Store();
    std::lock_guard<std::recursive_mutex> lock(store.mutex);
    auto* instance = GetInstance();
    instance->Refresh();
    return instance->Selected();
}

BusConfigurationEntry BusConfigurations::GetNamed(const std::string& configurationId,
                                                  bool allowFallback) {
    auto& store = Store();
    std::lock_guard<std::recursive_mutex> lock(store.mutex);
    auto* instance = GetInstance();
    instance->Refresh();
    return instance->Select(configurationId, allowFallback);
}

void BusConfigurations::Discard() {
    auto& store = Store();
    std::lock_guard<std::recursive_mutex> lock(store.mutex);
    store.instance.reset();
}

}  // namespace Korvane::Veldra::MessageBus
