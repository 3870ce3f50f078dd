#include "messagelibrary/json/JsonParser.h"

#include <algorithm>
#include <cstring>
#include <deque>
#include <memory>
#include <utility>
#include <vector>

#include "messagelibrary/json/JsonGrammar.h"
#include "messagelibrary/json/JsonNumberText.h"
#include "messagelibrary/json/JsonPool.h"
#include "messagelibrary/json/JsonPooledTree.h"
#include "messagelibrary/json/JsonUnescape.h"

namespace Korvane::Veldra::VeldraMessageLibrary {
namespace {

using Jsonz::JsonError;
using Jsonz::JsonToken;

// Builds the tree in the same pass as the grammar checks the text. Finished
// values wait on a stack until their container closes; the container then
// takes them over in one go, sized exactly.
class TreeBuilder {
public:
    explicit TreeBuilder(std::size_t textLength) : pool_(std::make_unique<JsonPool>(textLength)) {
        // About one value per 32 bytes of text: a large array is then built
        // without moving its finished elements from one buffer to the next.
        values_.reserve(std::max<std::size_t>(64, textLength / 32));
        keys_.reserve(32);
        frames_.reserve(16);
    }
    // Values left on the stack after a failure are nodes of the pool, which
    // goes with the builder.
    ~TreeBuilder() {
        for (JsonVariant& value : values_) JsonPooledTree::Forget(value);
    }
    TreeBuilder(const TreeBuilder&) = delete;
    TreeBuilder& operator=(const TreeBuilder&) = delete;

    void Null() { values_.emplace_back(JsonKind::Null); }
    void Bool(bool value) { values_.emplace_back(value); }
    void Number(const JsonToken& token) {
        double value = 0.0;
        // A number text the grammar lets through but that has no value ("-",
        // "1e+") fails the whole parse.
        if (!Jsonz::ConvertJsonDouble(token.start, token.length, value)) failed_ = true;
        values_.emplace_back(value);
    }
    void String(const JsonToken& token) {
        values_.push_back(JsonPooledTree::String(*pool_, Decode(token)));
    }
    // A key without escapes is kept as a view of the document; a decoded one
    // gets storage that stays put until the parse ends.
    void Key(const JsonToken& token) {
        if (!token.hasEscape) {
            keys_.emplace_back(token.start, token.length);
            return;
        }
        keys_.push_back(decodedKeys_.emplace_back(Decode(token)));
    }
    void BeginObject() { frames_.push_back({values_.size(), keys_.size()}); }
    void BeginArray() { frames_.push_back({values_.size(), keys_.size()}); }

    void EndObject() {
        const Frame frame = frames_.back();
        frames_.pop_back();
        members_.clear();
        for (std::size_t i = frame.firstValue, k = frame.firstKey; i < values_.size(); ++i, ++k) {
            members_.push_back({keys_[k], &values_[i]});
        }
        JsonVariant object = JsonPooledTree::Object(*pool_, members_.data(), members_.size());
        keys_.resize(frame.firstKey);
        values_.resize(frame.firstValue);
        values_.push_back(std::move(object));
    }

    void EndArray() {
        const Frame frame = frames_.back();
        frames_.pop_back();
        JsonVariant array = JsonPooledTree::Array(*pool_, values_.data() + frame.firstValue,
                                                  values_.size() - frame.firstValue);
        values_.resize(frame.firstValue);
        values_.push_back(std::move(array));
    }

    bool Failed() const noexcept { return failed_; }
    // The root, owning the pool in which the tree was built.
    JsonVariant TakeRoot() {
        JsonVariant root(std::move(values_.back()));
        JsonPooledTree::Adopt(root, std::move(pool_));
        return root;
    }

private:
    struct Frame {
        std::size_t firstValue;
        std::size_t firstKey;
    };

    // The text of a string token: as it stands when it has no backslash,
    // else decoded (an escape sequence that fails gives "").
    std::string_view Decode(const JsonToken& token) {
        if (!token.hasEscape) {
            return {token.start, token.length};
        }
        scratch_.resize(token.length);
        std::size_t count = 0;
        Jsonz::UnescapeJsonString(token.start, token.length, scratch_.data(), count);
        return {scratch_.data(), count};
    }

    std::unique_ptr<JsonPool> pool_;
    std::vector<JsonVariant> values_;
    std::vector<JsonPooledTree::Member> members_;
    std::vector<std::string_view> keys_;
    std::deque<std::string> decodedKeys_;
    std::vector<Frame> frames_;
    std::string scratch_;
    bool failed_ = false;
};

bool ParseText(JsonVariant& variant, const char* text, std::size_t length) {
    TreeBuilder builder(length);
    JsonError error;
    if (!Jsonz::ScanDocument(text, builder, error) || builder.Failed()) {
        variant.Reset();
        return false;
    }
    variant = builder.TakeRoot();
    return true;
}

}  // namespace

bool Parse(JsonVariant& variant, const char* text) {
    return ParseText(variant, text, text != nullptr ? std::strlen(text) : 0);
}

bool Parse(JsonVariant& variant, const std::string& text) {
    return ParseText(variant, text.c_str(), text.size());
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary
