#pragma once

#include <chrono>
#include <string>

namespace kvtag {

// What a broker's port answers when kvtag knocks on it itself, after the
// library could not connect: a TCP connection, then the AMQP 0-9-1 protocol
// header. A plain AMQP listener answers with a method frame (first byte 1,
// connection.start); a TLS listener with an alert record (first byte 0x15),
// or it closes.
enum class ProbeOutcome {
    Unresolved,    // the host name does not resolve
    Refused,       // nothing listens there
    Silent,        // no connection within the time-out (a wrong host, a filter)
    PlainAmqp,     // answers plain AMQP
    NotPlainAmqp,  // accepts the connection but does not answer plain AMQP
};

// Each step waits at most `timeout`.
ProbeOutcome ProbeBroker(const std::string& host, int port, std::chrono::milliseconds timeout);

}  // namespace kvtag
