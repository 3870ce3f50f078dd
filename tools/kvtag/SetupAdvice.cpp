#include "SetupAdvice.h"

#include <filesystem>
#include <map>
#include <vector>

#include "StatusCodes.h"

namespace kvtag {
namespace {

std::string Quoted(const std::string& text) {
    return "'" + text + "'";
}

std::string Join(const std::vector<std::string>& items, const char* separator) {
    std::string joined;
    for (const auto& item : items) joined += (joined.empty() ? "" : separator) + item;
    return joined;
}

// Where the configurations are and what moves them.
std::string RootSentence(const ConfigurationFolder& folder) {
    const std::string root =
        folder.rootFromEnvironment
            ? "The data root is " + folder.dataRoot + ", from " + kDataRootVariable
            : "The data root is the default " + folder.dataRoot + "; " + kDataRootVariable +
                  " moves it";
    return root + ". The configurations are the .json files in its folder " +
           kConfigurationsFolder + ".";
}

// "In DIR, a.json: its problem; b.json: ..." for the files that have the
// problems `of` picks; empty when none has.
std::string FileProblems(
    const ConfigurationFolder& folder,
    const std::function<std::vector<std::string>(const ConfigurationFile&)>& of) {
    std::vector<std::string> found;
    for (const auto& file : folder.files) {
        const std::vector<std::string> problems = of(file);
        if (!problems.empty()) found.push_back(file.name + ": " + Join(problems, "; "));
    }
    if (found.empty()) return "";
    return "In " + folder.directory + ", " + Join(found, "; ") + ".";
}

std::vector<std::string> Unparsable(const ConfigurationFile& file) {
    if (file.unparsable.empty()) return {};
    return {file.unparsable};
}

std::vector<std::string> Refused(const ConfigurationFile& file) {
    return file.refused;
}

// The Ids the files give, "'site' (site.json)", and keys the library skips.
std::string IdsFound(const ConfigurationFolder& folder) {
    std::vector<std::string> ids;
    std::vector<std::string> miscased;
    for (const auto& file : folder.files) {
        if (!file.Usable()) continue;
        ids.push_back((file.id ? Quoted(*file.id) : std::string("no Id")) + " (" + file.name + ")");
        for (const auto& key : file.miscasedKeys)
            miscased.push_back(file.name + " has the key " + key);
    }
    std::string text =
        "The Ids found: " + (ids.empty() ? std::string("none") : Join(ids, ", ")) + ".";
    if (!miscased.empty()) text += " Keys are matched exactly: " + Join(miscased, ", ") + ".";
    return text;
}

std::string Duplicates(const ConfigurationFolder& folder) {
    std::map<std::string, std::vector<std::string>> byId;
    for (const auto& file : folder.files) {
        if (file.Usable()) byId[IdKey(file.id)].push_back(file.name);
    }
    std::vector<std::string> found;
    for (const auto& [id, names] : byId) {
        if (names.size() > 1)
            found.push_back(Join(names, " and ") + " have the same Id " + Quoted(id));
    }
    if (found.empty()) return "";
    return "In " + folder.directory + ", " + Join(found, "; ") +
           " (Ids are compared without regard to case).";
}

std::string NoConfiguration(const std::optional<std::string>& id,
                            const ConfigurationFolder& folder) {
    if (folder.files.empty()) {
        return folder.directory + " holds no configuration files (*.json). " + RootSentence(folder);
    }
    if (!FindConfiguration(folder, kLocalhostId) && !FindConfiguration(folder, kMasterId)) {
        return std::string(
                   "The library first loads the default configuration, so a file with "
                   "the Id \"") +
               kLocalhostId + "\" or \"" + kMasterId + "\" must be in " + folder.directory +
               " beside the named ones. " + IdsFound(folder);
    }
    if (id && !FindConfiguration(folder, *id)) {
        return "No file in " + folder.directory + " has the Id " + Quoted(*id) +
               "; --config names the Id inside a file, matched without regard to case, not "
               "the file's name. " +
               IdsFound(folder);
    }
    return "";
}

// The CA certificate as the library finds it: a bare file name under the
// data root's Certificates folder.
std::string CertificateText(const ConfigurationFile& used, const ConfigurationFolder& folder) {
    if (!used.certPath) return "the configuration gives no CertPath";
    const std::filesystem::path path(*used.certPath);
    const std::string read =
        path.has_parent_path()
            ? *used.certPath
            : (std::filesystem::path(folder.dataRoot) / "Certificates" / path).string();
    return "CertPath is " + Quoted(*used.certPath) + " (read as " + read +
           "); it must be the CA that signed the broker's certificate";
}

std::string Diagnosis(int32_t status, const ConfigurationFile& used,
                      const ConfigurationFolder& folder, ProbeOutcome outcome) {
    const std::string where = *used.host + ":" + std::to_string(*used.port);
    const bool tls = used.useTls.value_or(false);
    switch (outcome) {
        case ProbeOutcome::Unresolved:
            return "the host name " + Quoted(*used.host) + " does not resolve";
        case ProbeOutcome::Refused:
            return "nothing listens on " + where;
        case ProbeOutcome::Silent:
            return where + " does not answer (a wrong host or port, or a firewall?)";
        case ProbeOutcome::PlainAmqp:
            if (tls) {
                return "the port answers plain AMQP but UseTls is true; give the broker's TLS "
                       "port, or set UseTls to false";
            }
            break;
        case ProbeOutcome::NotPlainAmqp:
            if (!tls) {
                return "the port does not answer plain AMQP (a TLS port?) but UseTls is false; "
                       "give the broker's plain port, or set UseTls to true";
            }
            break;
    }
    if (status == status::kFailedToLogIn) {
        return "the broker refused the user name or password (User " +
               Quoted(used.user.value_or("")) + ")";
    }
    if (status == status::kSettingCaCertificate || status == status::kCertificateExpired ||
        status == status::kPeerVerifyFailed || status == status::kFailedToLoadCertificate) {
        return "the TLS connection failed on the certificate: " + CertificateText(used, folder);
    }
    return std::string("the broker answers ") + (tls ? "TLS" : "plain AMQP") +
           " there, so the failure came later; --verbose shows the library's steps";
}

std::string UnreachableBroker(int32_t status, const std::optional<std::string>& id,
                              const ConfigurationFolder& folder, const Prober& probe) {
    const ConfigurationFile* used = UsedConfiguration(folder, id);
    if (!used) return "kvtag cannot tell which file in " + folder.directory + " was used.";
    if (!used->host || !used->port) {
        return "The configuration " + used->path + " gives no " + (used->host ? "Port" : "Host") +
               ".";
    }
    const std::string where = *used->host + ":" + std::to_string(*used->port);
    return "Cannot reach the broker " + where + " (configuration " + used->path + ", UseTls " +
           (used->useTls.value_or(false) ? "true" : "false") +
           "): " + Diagnosis(status, *used, folder, probe(*used->host, *used->port)) + ".";
}

}  // namespace

std::string ConnectAdvice(int32_t status, const std::optional<std::string>& id,
                          const ConfigurationFolder& folder, const Prober& probe) {
    if (!folder.unreadable.empty()) {
        return "kvtag looked for the configurations in " + folder.directory + ": " +
               folder.unreadable + ". " + RootSentence(folder);
    }
    std::string advice;
    switch (status) {
        case status::kDirectoryNotFound:
            return "kvtag finds " + folder.directory + " readable now. " + RootSentence(folder);
        case status::kFailedToParse:
            advice = FileProblems(folder, Unparsable);
            return advice.empty()
                       ? "kvtag finds every .json file in " + folder.directory + " well formed now."
                       : advice;
        case status::kException:
            advice = FileProblems(folder, Refused);
            break;
        case status::kDuplicateId:
            advice = Duplicates(folder);
            break;
        case status::kNoConfigurations:
            advice = NoConfiguration(id, folder);
            break;
        default:
            return UnreachableBroker(status, id, folder, probe);
    }
    return advice;
}

std::string ServiceTimeoutAdvice(const std::optional<std::string>& id,
                                 const ConfigurationFolder& folder, uint32_t waitedMs) {
    const ConfigurationFile* used = UsedConfiguration(folder, id);
    const std::string exchange =
        used && used->exchange ? "the exchange " + Quoted(*used->exchange) : "the exchange";
    return "No tag service answered within " + std::to_string(waitedMs) + " ms on " + exchange +
           (used ? " (configuration " + used->path + ")" : std::string()) +
           "; is one running on that broker with the same ExchangeName?";
}

}  // namespace kvtag
