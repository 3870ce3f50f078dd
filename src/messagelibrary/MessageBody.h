#pragma once

#include <cstddef>
#include <memory>
#include <string>

namespace Korvane::Veldra::MessageBus {

// Releases a block allocated with new[].
template <typename T>
struct array_deleter {
    void operator()(T* block) const { delete[] block; }
};

// The bytes of a message body: shared between holders and never changed after
// construction, so copies are cheap and may cross threads. Built from text it
// copies the bytes, with no terminating zero.
class MessageBody {
public:
    MessageBody() = default;
    explicit MessageBody(const std::string& text);
    MessageBody(const char* data, std::size_t length);

    // Null for an empty body.
    const char* Data() const { return bytes_.get(); }
    std::size_t Length() const { return length_; }
    bool Empty() const { return length_ == 0; }
    std::string ToString() const;

private:
    std::shared_ptr<const char> bytes_;
    std::size_t length_ = 0;
};

}  // namespace Korvane::Veldra::MessageBus
