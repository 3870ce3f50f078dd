#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "messagelibrary/json/JsonEnum.h"
#include "messagelibrary/json/JsonVariant.h"

namespace Korvane::Veldra::MessageBus {

enum class ConnectionType : int32_t { Local = 0, Cluster = 1, Master = 2, Client = 3 };

inline constexpr VeldraMessageLibrary::JsonEnumText kConnectionTypeTexts[] = {
    {0, "Local"}, {1, "Cluster"}, {2, "Master"}, {3, "Client"}};
inline VeldraMessageLibrary::JsonEnumTexts JsonEnumTextsOf(ConnectionType) {
    return kConnectionTypeTexts;
}
// "Cluster", "Master", "Client"; any other value "Local"; unset "".
std::string ConnectionTypeText(const std::optional<ConnectionType>& type);

// One broker configuration file. Every field may be absent, which differs
// from present and empty.
struct VeldraConfiguration {
    std::optional<std::string> Id;
    std::optional<std::string> DisplayName;
    std::optional<MessageBus::ConnectionType> ConnectionType;
    std::optional<std::string> ExchangeName;
    std::optional<std::string> Host;
    std::optional<std::string> VirtualHost;
    std::optional<int32_t> Port;
    std::optional<std::string> User;
    std::optional<std::string> Password;
    std::optional<bool> UseTls;
    std::optional<std::string> TlsServerName;
    std::optional<std::string> CertPath;
    // True once the record came from a complete object.
    bool Loaded = false;

    // Reads the record from a parsed file. A null root gives an empty record;
    // a value of the wrong kind, or an unknown connection type name, throws
    // VeldraException(-251004, "Failed to parse: ").
    static VeldraConfiguration FromJson(const VeldraMessageLibrary::JsonVariant& root);
    // {"Id":...,"DisplayName":...,...} in field order; unset fields are null.
    std::string ToJson() const;
};

// The record of a certificate's subject alternative names.
struct SubjectAltNames {
    std::optional<std::vector<std::string>> Names;  // key "SubjectAltNames"

    static SubjectAltNames FromJson(const VeldraMessageLibrary::JsonVariant& root);
    std::string ToJson() const;
};

}  // namespace Korvane::Veldra::MessageBus
