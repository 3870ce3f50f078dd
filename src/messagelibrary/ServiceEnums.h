#pragma once

#include <cstdint>

#include "messagelibrary/json/JsonEnum.h"

// The enumerations of the service control messages.

namespace Korvane::Veldra::VeldraMessageLibrary {

// How a node's service manager stands, as its peers see it.
enum class ServiceManagerStatus : int32_t {
    UpNormal = 0,
    MissedHeartbeat = 1,
    Dead = 2,
};

inline constexpr JsonEnumText kServiceManagerStatusTexts[] = {
    {0, "UP_NORMAL"}, {1, "MISSED_HEARTBEAT"}, {2, "DEAD"}};
inline JsonEnumTexts JsonEnumTextsOf(ServiceManagerStatus) {
    return kServiceManagerStatusTexts;
}

// Where a managed service is in its life.
enum class ServiceState : int32_t {
    Unknown = 0,
    Disabled = 1,
    Manual = 2,
    AwaitingDeps = 3,
    Starting = 4,
    Registered = 5,
    Idle = 6,
    Live = 7,
    Error = 8,
    Unresponsive = 9,
    Dead = 10,
    ShuttingDown = 11,
    Stopped = 12,
};

inline constexpr JsonEnumText kServiceStateTexts[] = {
    {0, "UNKNOWN"},  {1, "DISABLED"},     {2, "MANUAL"}, {3, "AWAITING_DEPS"},
    {4, "STARTING"}, {5, "REGISTERED"},   {6, "IDLE"},   {7, "LIVE"},
    {8, "ERROR"},    {9, "UNRESPONSIVE"}, {10, "DEAD"},  {11, "SHUTTING_DOWN"},
    {12, "STOPPED"}};
inline JsonEnumTexts JsonEnumTextsOf(ServiceState) {
    return kServiceStateTexts;
}

// The manager's own view of a service it launches; no message carries it.
enum class ServiceLaunchState : int32_t {
    Disabled = 0,
    AwaitRegistration = 1,
    AwaitingDependencies = 2,
    ReadyToLaunch = 3,
    Registered = 4,
    Launching = 5,
    Attaching = 6,
    Running = 7,
    Failed = 8,
};

inline constexpr JsonEnumText kServiceLaunchStateTexts[] = {{0, "DISABLED"},
                                                            {1, "AWAIT_REGISTRATION"},
                                                            {2, "AWAITING_DEPENDENCIES"},
                                                            {3, "READY_TO_LAUNCH"},
                                                            {4, "REGISTERED"},
                                                            {5, "LAUNCHING"},
                                                            {6, "ATTACHING"},
                                                            {7, "RUNNING"},
                                                            {8, "FAILED"}};
inline JsonEnumTexts JsonEnumTextsOf(ServiceLaunchState) {
    return kServiceLaunchStateTexts;
}

// What a launch input of the manager names; no message carries it.
enum class ServiceLaunchInput : int32_t {
    Path = 0,
    Arguments = 1,
};

inline constexpr JsonEnumText kServiceLaunchInputTexts[] = {{0, "PATH"}, {1, "ARGUMENTS"}};
inline JsonEnumTexts JsonEnumTextsOf(ServiceLaunchInput) {
    return kServiceLaunchInputTexts;
}

// Whether the manager starts a service group by itself.
enum class ServiceStartMode : int32_t {
    Unknown = 0,
    Disabled = 1,
    Auto = 2,
    Manual = 3,
};

inline constexpr JsonEnumText kServiceStartModeTexts[] = {
    {0, "UNKNOWN"}, {1, "DISABLED"}, {2, "AUTO"}, {3, "MANUAL"}};
inline JsonEnumTexts JsonEnumTextsOf(ServiceStartMode) {
    return kServiceStartModeTexts;
}

// Whether a service is built on the managed service base or is a plain
// executable.
enum class ServiceStartType : int32_t {
    VeldraService = 0,
    Executable = 1,
};

inline constexpr JsonEnumText kServiceStartTypeTexts[] = {{0, "VELDRA_SERVICE"}, {1, "EXECUTABLE"}};
inline JsonEnumTexts JsonEnumTextsOf(ServiceStartType) {
    return kServiceStartTypeTexts;
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary
