#pragma once

#include <string>

#include "utilities/tracelogging/TracePoint.h"

namespace Korvane::Veldra::MessageBus {
struct MessageError;
}

namespace Korvane::Veldra::MessageBus::Interfaces {

// Where components write their trace entries. The operations with a body
// here are written in terms of the others, so that a logger that only needs
// points and errors implements three.
class ITraceLogger {
public:
    // Empty unless the logger has a name.
    virtual const std::string& GetName() const;
    // The point of that name under this logger's name; a point the logger has
    // not seen yet comes back disabled.
    virtual TracePoint GetTracePoint(const std::string& name) = 0;
    // An entry of type LOG at the point, written only when the point is enabled.
    virtual void Log(const TracePoint& tracePoint, const std::string& text) = 0;
    // An entry of type INFO; dropped unless the logger keeps them.
    virtual void Info(const std::string& text);
    // An entry of type ERROR.
    virtual void Error(const std::string& text) = 0;
    // An entry of type ERROR with the error's full name and its info; null
    // writes nothing.
    virtual void Error(const MessageError* error);
    // An entry of type ERROR when the condition is false.
    virtual void Assert(bool condition, const std::string& text);
    virtual ~ITraceLogger() = default;
};

}  // namespace Korvane::Veldra::MessageBus::Interfaces
