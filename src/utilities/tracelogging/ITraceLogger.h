#pragma once

#include <string>

#include "utilities/tracelogging/TracePoint.h"

namespace Korvane::Veldra::MessageBus::Interfaces {

// Where components write their trace entries.
class ITraceLogger {
public:
    // The point of that name under this logger's name; a point the logger has
    // not seen yet comes back disabled.
    virtual TracePoint GetTracePoint(const std::string& name) = 0;
    // An entry of type LOG at the point, written only when the point is enabled.
    virtual void Log(const TracePoint& tracePoint, const std::string& text) = 0;
    // An entry of type ERROR.
    virtual void Error(const std::string& text) = 0;
    virtual ~ITraceLogger() = default;
};

}  // namespace Korvane::Veldra::MessageBus::Interfaces
