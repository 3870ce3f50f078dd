#include "support/BrokerSettings.h"

#include <fstream>
#include <map>
#include <sstream>

namespace Korvane::Veldra::Testing {
namespace {

bool ParsePort(const std::string& text, int& port) {
    if (text.empty() || text.size() > 5 ||
        text.find_first_not_of("0123456789") != std::string::npos) {
        return false;
    }
    port = std::stoi(text);
    return port > 0 && port < 65536;
}

}  // namespace

bool ParseEnvLines(const std::string& text, std::map<std::string, std::string>& values,
                   std::string& error) {
    std::istringstream lines(text);
    std::string line;
    int number = 0;
    while (std::getline(lines, line)) {
        ++number;
        if (line.empty() || line[0] == '#') {
            continue;
        }
        const auto equals = line.find('=');
        if (equals == std::string::npos || equals == 0) {
            error = "line " + std::to_string(number) + " is not KEY=value: " + line;
            return false;
        }
        std::string value = line.substr(equals + 1);
        if (value.size() >= 2 && value.front() == '\'' && value.back() == '\'') {
            value = value.substr(1, value.size() - 2);
        }
        values[line.substr(0, equals)] = value;
    }
    return true;
}

bool ParseBrokerSettings(const std::string& text, BrokerSettings& out, std::string& error) {
    std::map<std::string, std::string> values;
    if (!ParseEnvLines(text, values, error)) {
        return false;
    }
    BrokerSettings settings;
    const std::pair<const char*, std::string*> strings[] = {
        {"BROKER_DIR", &settings.Directory},
        {"BROKER_HOST", &settings.Host},
        {"BROKER_HOSTNAME", &settings.HostName},
        {"BROKER_USER", &settings.User},
        {"BROKER_PASSWORD", &settings.Password},
        {"BROKER_VHOST", &settings.VirtualHost},
        {"BROKER_CA_CERT", &settings.CaCertPath},
        {"BROKER_OTHER_CA_CERT", &settings.OtherCaCertPath},
        {"BROKER_SERVER_CERT", &settings.ServerCertPath},
        {"BROKER_NODE", &settings.NodeName},
        {"BROKER_CTL", &settings.CtlPath},
        {"BROKER_LOG", &settings.LogPath},
    };
    for (const auto& [key, field] : strings) {
        const auto found = values.find(key);
        if (found == values.end() || found->second.empty()) {
            error = std::string("missing ") + key;
            return false;
        }
        *field = found->second;
    }
    const std::pair<const char*, int*> ports[] = {
        {"BROKER_AMQP_PORT", &settings.AmqpPort},
        {"BROKER_AMQPS_PORT", &settings.AmqpsPort},
    };
    for (const auto& [key, field] : ports) {
        const auto found = values.find(key);
        if (found == values.end() || !ParsePort(found->second, *field)) {
            error = std::string("missing or bad ") + key;
            return false;
        }
    }
    out = settings;
    return true;
}

bool LoadBrokerSettings(const std::string& path, BrokerSettings& out, std::string& error) {
    std::ifstream file(path);
    if (!file) {
        error = "cannot read " + path;
        return false;
    }
    std::ostringstream text;
    text << file.rdbuf();
    if (!ParseBrokerSettings(text.str(), out, error)) {
        error = path + ": " + error;
        return false;
    }
    return true;
}

}  // namespace Korvane::Veldra::Testing
