#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace kvtag {

// Builds one compact JSON text. The caller keeps the nesting right; commas
// are placed here.
class JsonWriter {
public:
    JsonWriter& BeginObject();
    JsonWriter& EndObject();
    JsonWriter& BeginArray();
    JsonWriter& EndArray();
    JsonWriter& Key(std::string_view key);
    JsonWriter& String(std::string_view text);
    JsonWriter& Integer(int64_t value);
    JsonWriter& Number(double value);  // null when not finite
    JsonWriter& Bool(bool value);
    JsonWriter& Null();
    // A text already in JSON form, such as one this class wrote.
    JsonWriter& Raw(std::string_view json);

    const std::string& Text() const { return text_; }

private:
    void BeforeValue();
    // A value in its JSON form, after the comma it needs.
    JsonWriter& Value(std::string_view json);
    JsonWriter& Open(char bracket);
    JsonWriter& Close(char bracket);

    std::string text_;
    std::vector<bool> first_;  // per open container: no member yet
    bool afterKey_ = false;
};

// The shortest of %.15g, %.16g and %.17g that reads back as the value.
std::string NumberText(double value);

// The text in double quotes with JSON escapes.
std::string JsonQuote(std::string_view text);

}  // namespace kvtag
