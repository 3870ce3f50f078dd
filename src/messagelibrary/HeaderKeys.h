#pragma once

#include <string_view>

namespace Korvane::Veldra::MessageBus::HeaderKeys {

// The well-known keys of the message header table.
inline constexpr std::string_view kUser = "User";
inline constexpr std::string_view kOrigin = "Origin";
inline constexpr std::string_view kReplyTo = "ReplyTo";
inline constexpr std::string_view kIgnoreResponse = "IgnoreResponse";
inline constexpr std::string_view kMessageId = "MessageId";
inline constexpr std::string_view kDeliveryTag = "DeliveryTag";
inline constexpr std::string_view kConsumerTag = "ConsumerTag";
inline constexpr std::string_view kPersistent = "Persistent";
inline constexpr std::string_view kContentEncoding = "ContentEncoding";
inline constexpr std::string_view kErrorCode = "ErrorCode";
inline constexpr std::string_view kErrorInfo = "ErrorInfo";
// Followed by the decimal index of the argument: "ErrorArgs0", "ErrorArgs1", ...
inline constexpr std::string_view kErrorArgs = "ErrorArgs";

}  // namespace Korvane::Veldra::MessageBus::HeaderKeys
