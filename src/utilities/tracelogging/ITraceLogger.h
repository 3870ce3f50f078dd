#pragma once

#include <string>

#include "utilities/tracelogging/TracePoint.h"

namespace Korvane::Veldra::MessageBus {
struct MessageError;
}

namespace Korvane::Veldra::MessageBus::Interfaces {

// Where components write their trace entries.
class ITraceLogger {
public:
    virtual const std::string& GetName() const = 0;
    // The point of that name under this logger's name; a point the logger has
    // not seen yet comes back disabled.
    virtual TracePoint GetTracePoint(const std::string& name) = 0;
    // An entry of type LOG at the point, written only when the point is enabled.
    virtual void Log(const TracePoint& tracePoint, const std::string& text) = 0;
    // An entry of type INFO.
    virtual void Info(const std::string& text) = 0;
    // An entry of type ERROR.
    virtual void Error(const std::string& text) = 0;
    // An entry of type ERROR with the error's full name and its info; null
    // writes nothing.
    virtual void Error(const MessageError* error) = 0;
    // An entry of type ERROR when the condition is false.
    virtual void Assert(bool condition, const std::string& text) = 0;
    virtual ~ITraceLogger() = default;
};

}  // namespace Korvane::Veldra::MessageBus::Interfaces
