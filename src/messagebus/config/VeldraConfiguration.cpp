#include "messagebus/config/VeldraConfiguration.h"

#include <boost/lexical_cast.hpp>

#include "errors/VeldraException.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"

namespace Korvane::Veldra::MessageBus {
namespace {

using VeldraMessageLibrary::JsonBodyWriter;
using VeldraMessageLibrary::JsonVariant;
using VeldraMessageLibrary::ReadField;

// Reads each field in turn; the first refusal ends the record with the one
// text that configuration files get.
class ConfigurationReader {
public:
    explicit ConfigurationReader(const JsonVariant& root) : root_(root) {}
    template <typename T>
    ConfigurationReader& Field(std::string_view key, std::optional<T>& out) {
        // A number written as a text that is no number ("Port": "abc") is as
        // bad a field as one of the wrong JSON type.
        bool read = false;
        try {
            read = ReadField(out, root_, key);
        } catch (const boost::bad_lexical_cast&) {
        }
        if (!read) throw VeldraException(-251004, "Failed to parse: ");
        return *this;
    }

private:
    const JsonVariant& root_;
};

void RequireObjectOrNull(const JsonVariant& root) {
    if (!root.IsObject() && !root.IsNull()) throw VeldraException(-251004, "Failed to parse: ");
}

}  // namespace

std::string ConnectionTypeText(const std::optional<ConnectionType>& type) {
    if (!type) return "";
    switch (*type) {
        case ConnectionType::Cluster:
            return "Cluster";
        case ConnectionType::Master:
            return "Master";
        case ConnectionType::Client:
            return "Client";
        default:
            return "Local";
    }
}

VeldraConfiguration VeldraConfiguration::FromJson(const JsonVariant& root) {
    RequireObjectOrNull(root);
    VeldraConfiguration record;
    if (root.IsNull()) return record;
    ConfigurationReader(root)
        .Field("Id", record.Id)
        .Field("DisplayName", record.DisplayName)
        .Field("ConnectionType", record.ConnectionType)
        .Field("ExchangeName", record.ExchangeName)
        .Field("Host", record.Host)
        .Field("VirtualHost", record.VirtualHost)
        .Field("Port", record.Port)
        .Field("User", record.User)
        .Field("Password", record.Password)
        .Field("UseTls", record.UseTls)
        .Field("TlsServerName", record.TlsServerName)
        .Field("CertPath", record.CertPath);
    record.Loaded = true;
    return record;
}

std::string VeldraConfiguration::ToJson() const {
    std::optional<std::string> connectionType;
    if (ConnectionType) connectionType = ConnectionTypeText(ConnectionType);
    return JsonBodyWriter()
        .Field("Id", Id)
        .Field("DisplayName", DisplayName)
        .Field("ConnectionType", connectionType)
        .Field("ExchangeName", ExchangeName)
        .Field("Host", Host)
        .Field("VirtualHost", VirtualHost)
        .Field("Port", Port)
        .Field("User", User)
        .Field("Password", Password)
        .Field("UseTls", UseTls)
        .Field("TlsServerName", TlsServerName)
        .Field("CertPath", CertPath)
        .Finish();
}

SubjectAltNames SubjectAltNames::FromJson(const JsonVariant& root) {
    RequireObjectOrNull(root);
    SubjectAltNames record;
    if (root.IsObject()) ConfigurationReader(root).Field("SubjectAltNames", record.Names);
    return record;
}

std::string SubjectAltNames::ToJson() const {
    return JsonBodyWriter().Field("SubjectAltNames", Names).Finish();
}

}  // namespace Korvane::Veldra::MessageBus
