#include "messagelibrary/MessageBody.h"

#include <cstring>

namespace Korvane::Veldra::MessageBus {

MessageBody::MessageBody(const std::string& text) : MessageBody(text.data(), text.size()) {}

MessageBody::MessageBody(const char* data, std::size_t length) {
    if (data == nullptr || length == 0) return;
    char* copy = new char[length];
    std::memcpy(copy, data, length);
    bytes_ = std::shared_ptr<const char>(copy, array_deleter<const char>());
    length_ = length;
}

std::string MessageBody::ToString() const {
    if (length_ == 0) return std::string();
    return std::string(bytes_.get(), length_);
}

}  // namespace Korvane::Veldra::MessageBus
