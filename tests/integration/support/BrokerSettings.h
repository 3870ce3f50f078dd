#pragma once

#include <map>
#include <string>

namespace Korvane::Veldra::Testing {

// Where and how to reach the private test broker, as broker.sh writes it.
struct BrokerSettings {
    std::string Directory;        // the node's temporary directory
    std::string Host;             // "127.0.0.1"
    std::string HostName;         // "localhost": the name in the server certificate
    int AmqpPort = 0;             // plain AMQP on Host
    int AmqpsPort = 0;            // AMQP over TLS on Host
    std::string User;             // "guest"
    std::string Password;         // "guest"
    std::string VirtualHost;      // "/"
    std::string CaCertPath;       // the CA that signed the server certificate
    std::string OtherCaCertPath;  // an unrelated CA: verifying the server with it fails
    std::string ServerCertPath;   // the server's certificate
    std::string NodeName;         // e.g. "kvveldra-test-1234@localhost"
    std::string CtlPath;          // rabbitmqctl bound to this node and no other
    std::string LogPath;          // the node's log
};

// Splits the KEY='value' (or KEY=value) lines of an environment file into
// values; blank lines and lines starting with '#' are skipped. False, with the
// line in error, on a line without a key.
bool ParseEnvLines(const std::string& text, std::map<std::string, std::string>& values,
                   std::string& error);

// Parses the KEY='value' lines of an environment file; blank lines and lines
// starting with '#' are skipped, unknown keys ignored. False, with the reason
// in error, on a malformed line, a bad port or a missing key.
bool ParseBrokerSettings(const std::string& text, BrokerSettings& out, std::string& error);

// Reads and parses the file at path.
bool LoadBrokerSettings(const std::string& path, BrokerSettings& out, std::string& error);

}  // namespace Korvane::Veldra::Testing
