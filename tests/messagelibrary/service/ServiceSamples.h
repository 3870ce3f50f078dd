#pragma once

#include <boost/date_time/posix_time/posix_time.hpp>
#include <string>
#include <vector>

#include "messagelibrary/ServiceRecords.h"

// Records with every field set, and their written forms, for the service
// control tests.

namespace Korvane::Veldra::VeldraMessageLibrary::Testing {

inline Timestamp ServiceTime(int64_t milliseconds) {
    using namespace boost::posix_time;
    return ptime(boost::gregorian::date(2024, 2, 29), millisec(milliseconds));
}

inline ServiceGroup SampleGroup() {
    return {std::string("g1"), true, 3, ServiceStartMode::Auto, JsonStringMap{{"PATH", "/bin"}},
            JsonStringMap{}};
}
inline const std::string kGroupJson =
    R"({"name":"g1","singleton":true,"defaultInstanceCount":3,"startMode":"AUTO",)"
    R"("environmentVariables":{"PATH":"/bin"},"properties":{}})";

inline ServiceManagerNode SampleNode() {
    return {std::string("node1"), ServiceManagerStatus::MissedHeartbeat, ServiceTime(1000)};
}
inline const std::string kNodeJson =
    R"({"nodeName":"node1","status":"MISSED_HEARTBEAT","lastHeartbeatTime":"2024-02-29T00:00:01Z"})";

// A stopped instance, and one that runs: its stop time is unset.
inline std::vector<ServiceInfo> SampleInfos() {
    const ServiceDescriptor descriptor{
        std::string("Historian"), std::string("1.2"), ServiceStartType::Executable,
        std::vector<ServiceDependency>{{std::string("TagInfo"), std::nullopt, true}},
        std::vector<ServiceGroup>{SampleGroup()}};
    ServiceInfo stopped{std::string("6f1c"),
                        std::string("Historian"),
                        std::string("1.2"),
                        std::string("node1"),
                        std::string("g1"),
                        ServiceState::Stopped,
                        std::string("hist_q"),
                        descriptor,
                        ServiceTime(1000),
                        ServiceTime(2500),
                        4242};
    ServiceInfo running;
    running.serviceState = ServiceState::Live;
    running.launchTime = ServiceTime(1000);
    running.processId = -1;
    return {stopped, running};
}
inline const std::string kInfosJson =
    R"([{"serviceGuid":"6f1c","name":"Historian","version":"1.2","nodeName":"node1",)"
    R"("serviceGroupName":"g1","serviceState":"STOPPED","replyToQueue":"hist_q",)"
    R"("serviceDescriptor":{"name":"Historian","version":"1.2","startType":"EXECUTABLE",)"
    R"("dependsOn":[{"name":"TagInfo","version":null,"onSameNode":true}],"serviceGroups":[)" +
    kGroupJson +
    R"(]},"launchTime":"2024-02-29T00:00:01Z","stopTime":"2024-02-29T00:00:02.500000Z",)"
    R"("processId":4242},{"serviceGuid":null,"name":null,"version":null,"nodeName":null,)"
    R"("serviceGroupName":null,"serviceState":"LIVE","replyToQueue":null,)"
    R"("serviceDescriptor":null,"launchTime":"2024-02-29T00:00:01Z",)"
    R"("stopTime":"0001-01-01T00:00:00","processId":-1}])";

}  // namespace Korvane::Veldra::VeldraMessageLibrary::Testing
