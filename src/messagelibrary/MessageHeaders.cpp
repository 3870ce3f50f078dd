#include "messagelibrary/MessageHeaders.h"

#include <charconv>
#include <ctime>
#include <sstream>

#include "errors/ErrorCodeRegistry.h"
#include "messagelibrary/HeaderKeys.h"
#include "messagelibrary/MessageIdentity.h"

namespace Korvane::Veldra::MessageBus {
namespace {

const std::string kEmpty;

std::string ErrorArgKey(std::size_t index) {
    return std::string(HeaderKeys::kErrorArgs) + std::to_string(index);
}

}  // namespace

void MessageHeaders::SetHeader(std::string_view key, const std::string& value) {
    const auto found = headers.find(key);
    if (found != headers.end()) {
        found->second = value;
    } else {
        headers.emplace(std::string(key), value);
    }
}

void MessageHeaders::SetHeader(std::string_view key, const char* value) {
    SetHeader(key, std::string(value != nullptr ? value : ""));
}

void MessageHeaders::SetHeader(std::string_view key, const std::optional<std::string>& value) {
    if (value) {
        SetHeader(key, *value);
    } else {
        EraseHeader(key);
    }
}

void MessageHeaders::SetHeader(std::string_view key, bool value) {
    SetHeader(key, std::string(value ? "True" : "False"));
}

void MessageHeaders::EraseHeader(std::string_view key) {
    const auto found = headers.find(key);
    if (found != headers.end()) headers.erase(found);
}

const std::string* MessageHeaders::GetHeader(std::string_view key) const {
    const auto found = headers.find(key);
    return found == headers.end() ? nullptr : &found->second;
}

std::optional<std::string> MessageHeaders::GetOptionalHeader(std::string_view key) const {
    const std::string* value = GetHeader(key);
    if (value == nullptr) return std::nullopt;
    return *value;
}

bool MessageHeaders::GetHeaderAsBool(std::string_view key) const {
    const std::string* value = GetHeader(key);
    if (value == nullptr) return false;
    return *value == "true" || *value == "True" || *value == "TRUE" || *value == "1";
}

const std::string& MessageHeaders::HeaderOrEmpty(std::string_view key) const {
    const std::string* value = GetHeader(key);
    return value != nullptr ? *value : kEmpty;
}

void MessageHeaders::SetPersistent(bool persistent) {
    std::ostringstream text;
    text << persistent;
    SetHeader(HeaderKeys::kPersistent, text.str());
}

bool MessageHeaders::Persistent() const {
    return GetHeaderAsBool(HeaderKeys::kPersistent);
}

void MessageHeaders::SetIgnoreResponse(bool ignore) {
    if (ignore) {
        SetHeader(HeaderKeys::kIgnoreResponse, std::string("true"));
    } else {
        EraseHeader(HeaderKeys::kIgnoreResponse);
    }
}

bool MessageHeaders::IgnoreResponse() const {
    return GetHeaderAsBool(HeaderKeys::kIgnoreResponse);
}

void MessageHeaders::SetReplyTo(const std::string& queue) {
    SetHeader(HeaderKeys::kReplyTo, queue);
}

const std::string& MessageHeaders::ReplyTo() const {
    return HeaderOrEmpty(HeaderKeys::kReplyTo);
}

void MessageHeaders::SetOrigin(const std::string& origin) {
    SetHeader(HeaderKeys::kOrigin, origin);
}

const std::string& MessageHeaders::Origin() const {
    return HeaderOrEmpty(HeaderKeys::kOrigin);
}

const std::string& MessageHeaders::MessageId() const {
    return HeaderOrEmpty(HeaderKeys::kMessageId);
}

const std::string& MessageHeaders::ConsumerTag() const {
    return HeaderOrEmpty(HeaderKeys::kConsumerTag);
}

uint32_t MessageHeaders::DeliveryTag() const {
    const std::string& text = HeaderOrEmpty(HeaderKeys::kDeliveryTag);
    uint32_t value = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), value);
    if (error != std::errc() || end != text.data() + text.size()) return 0;
    return value;
}

void MessageHeaders::SetDeliveryTag(uint64_t deliveryTag) {
    SetHeader(HeaderKeys::kDeliveryTag, std::to_string(static_cast<uint32_t>(deliveryTag)));
}

void MessageHeaders::SetError(const std::optional<MessageError>& error) {
    if (!error) {
        EraseHeader(HeaderKeys::kErrorCode);
        return;
    }
    SetHeader(HeaderKeys::kErrorCode, error->FullName());
    if (!error->info.empty()) SetHeader(HeaderKeys::kErrorInfo, error->info);
    for (std::size_t i = 0; i < error->args.size(); ++i) {
        SetHeader(ErrorArgKey(i), error->args[i]);
    }
}

MessageError MessageHeaders::GetError() const {
    MessageError error;
    const std::string& fullName = HeaderOrEmpty(HeaderKeys::kErrorCode);
    error.code = ErrorCodeRegistry::Instance().lookup(fullName.empty() ? "Unknown" : fullName);
    error.info = HeaderOrEmpty(HeaderKeys::kErrorInfo);
    for (std::size_t i = 0;; ++i) {
        const std::string& arg = HeaderOrEmpty(ErrorArgKey(i));
        if (arg.empty()) break;
        error.args.push_back(arg);
    }
    return error;
}

bool MessageHeaders::HasError() const {
    return !HeaderOrEmpty(HeaderKeys::kErrorCode).empty();
}

void MessageHeaders::EnsureIdentity() {
    if (MessageId().empty()) SetHeader(HeaderKeys::kMessageId, NewMessageId());
    if (correlationId.empty()) correlationId = MessageId();
    timestamp = VeldraMessageLibrary::TimestampFromUnixSeconds(std::time(nullptr));
}

std::string MessageHeaders::DebugText() const {
    std::string text;
    text.append("Id=").append(MessageId().substr(0, 8)).append(" | ");
    text.append("Type=").append(messageType).append(" | ");
    text.append("Routing=").append(routingKey).append(" | ");
    text.append("Origin=").append(Origin()).append(" | ");
    text.append("Corr=").append(correlationId.substr(0, 8)).append(" | ");
    return text;
}

}  // namespace Korvane::Veldra::MessageBus
