#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "messagelibrary/ServiceEnums.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"
#include "messagelibrary/json/Timestamp.h"

// The records that the service control messages share. Every field is
// optional on the wire: an unset optional is written null, and a missing key
// reads back as unset or as the field's default. An unset time is
// not-a-date-time, written "0001-01-01T00:00:00".

namespace Korvane::Veldra::VeldraMessageLibrary {

// A node's service manager and when it was last heard.
struct ServiceManagerNode {
    std::optional<std::string> nodeName;
    std::optional<ServiceManagerStatus> status;
    Timestamp lastHeartbeatTime;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("nodeName", self.nodeName)
            .Field("status", self.status)
            .Field("lastHeartbeatTime", self.lastHeartbeatTime);
    }
};

// A group of instances of one service and how they are started.
struct ServiceGroup {
    std::optional<std::string> name;
    bool singleton = false;
    int32_t defaultInstanceCount = 0;
    std::optional<ServiceStartMode> startMode;
    std::optional<JsonStringMap> environmentVariables;
    std::optional<JsonStringMap> properties;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("name", self.name)
            .Field("singleton", self.singleton)
            .Field("defaultInstanceCount", self.defaultInstanceCount)
            .Field("startMode", self.startMode)
            .Field("environmentVariables", self.environmentVariables)
            .Field("properties", self.properties);
    }
};

// A service that another one needs before it can start.
struct ServiceDependency {
    std::optional<std::string> name;
    std::optional<std::string> version;
    bool onSameNode = false;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("name", self.name)
            .Field("version", self.version)
            .Field("onSameNode", self.onSameNode);
    }
};

// What a service is, what it needs and the groups it runs in.
struct ServiceDescriptor {
    std::optional<std::string> name;
    std::optional<std::string> version;
    std::optional<ServiceStartType> startType;
    std::optional<std::vector<ServiceDependency>> dependsOn;
    std::optional<std::vector<ServiceGroup>> serviceGroups;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("name", self.name)
            .Field("version", self.version)
            .Field("startType", self.startType)
            .Field("dependsOn", self.dependsOn)
            .Field("serviceGroups", self.serviceGroups);
    }
};

// One instance of a service on a node. A running service has no stop time.
struct ServiceInfo {
    std::optional<std::string> serviceGuid;
    std::optional<std::string> name;
    std::optional<std::string> version;
    std::optional<std::string> nodeName;
    std::optional<std::string> serviceGroupName;
    std::optional<ServiceState> serviceState;
    std::optional<std::string> replyToQueue;
    std::optional<ServiceDescriptor> serviceDescriptor;
    Timestamp launchTime;
    Timestamp stopTime;
    int32_t processId = 0;

    bool HasStopped() const { return !stopTime.is_special(); }

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("serviceGuid", self.serviceGuid)
            .Field("name", self.name)
            .Field("version", self.version)
            .Field("nodeName", self.nodeName)
            .Field("serviceGroupName", self.serviceGroupName)
            .Field("serviceState", self.serviceState)
            .Field("replyToQueue", self.replyToQueue)
            .Field("serviceDescriptor", self.serviceDescriptor)
            .Field("launchTime", self.launchTime)
            .Field("stopTime", self.stopTime)
            .Field("processId", self.processId);
    }
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary
