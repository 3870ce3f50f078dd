#include "JsonCheck.h"

#include <stdexcept>

namespace kvtag {
namespace {

constexpr int kMaxDepth = 512;

struct SyntaxError : std::runtime_error {
    SyntaxError(std::size_t at, const std::string& what) : std::runtime_error(what), position(at) {}
    std::size_t position;
};

void AppendUtf8(std::string& out, unsigned code) {
    if (code < 0x80) {
        out += static_cast<char>(code);
    } else if (code < 0x800) {
        out += static_cast<char>(0xc0 | (code >> 6));
        out += static_cast<char>(0x80 | (code & 0x3f));
    } else if (code < 0x10000) {
        out += static_cast<char>(0xe0 | (code >> 12));
        out += static_cast<char>(0x80 | ((code >> 6) & 0x3f));
        out += static_cast<char>(0x80 | (code & 0x3f));
    } else {
        out += static_cast<char>(0xf0 | (code >> 18));
        out += static_cast<char>(0x80 | ((code >> 12) & 0x3f));
        out += static_cast<char>(0x80 | ((code >> 6) & 0x3f));
        out += static_cast<char>(0x80 | (code & 0x3f));
    }
}

class Reader {
public:
    explicit Reader(std::string_view text) : text_(text) {}

    void Document(JsonDocument& document) {
        document.rootKind = Value(0, &document.members).kind;
        Blanks();
        if (pos_ < text_.size()) Fail("text after the end of the document");
    }

private:
    [[noreturn]] void Fail(const std::string& what) const { throw SyntaxError(pos_, what); }

    char Peek() const { return pos_ < text_.size() ? text_[pos_] : '\0'; }

    void Blanks() {
        while (pos_ < text_.size() &&
               (Peek() == ' ' || Peek() == '\t' || Peek() == '\r' || Peek() == '\n')) {
            ++pos_;
        }
    }

    void Expect(char wanted, const char* what) {
        Blanks();
        if (Peek() != wanted) Fail(std::string("expected ") + what);
        ++pos_;
    }

    // A value; the members of an object at depth 0 go to `members`, and
    // with `keepItems` the items of an array into the value.
    JsonScalar Value(int depth, std::vector<std::pair<std::string, JsonScalar>>* members,
                     bool keepItems = false) {
        Blanks();
        JsonScalar value;
        const char c = Peek();
        if (c == '{' || c == '[') {
            if (depth >= kMaxDepth) Fail("nested too deep");
            value.kind = c == '{' ? JsonKind::Object : JsonKind::Array;
            Container(c == '{', depth, members, keepItems ? &value.items : nullptr);
        } else if (c == '"') {
            value.kind = JsonKind::String;
            value.text = String();
        } else if (c == '-' || (c >= '0' && c <= '9')) {
            value.kind = JsonKind::Number;
            value.text = Number();
        } else if (Word("true") || Word("false")) {
            value.kind = JsonKind::Bool;
            value.truth = c == 't';
        } else if (Word("null")) {
            value.kind = JsonKind::Null;
        } else {
            Fail(pos_ >= text_.size() ? "the file ends where a value should be"
                                      : "expected a value (a text in double quotes, a number, "
                                        "true, false, null, an object or an array)");
        }
        return value;
    }

    bool Word(std::string_view word) {
        if (text_.substr(pos_, word.size()) != word) return false;
        pos_ += word.size();
        return true;
    }

    void Container(bool object, int depth, std::vector<std::pair<std::string, JsonScalar>>* members,
                   std::vector<JsonScalar>* items) {
        const char close = object ? '}' : ']';
        const char* separator = object ? "',' or '}'" : "',' or ']'";
        ++pos_;
        Blanks();
        if (Peek() == close) {
            ++pos_;
            return;
        }
        for (;;) {
            if (object) {
                Blanks();
                if (Peek() != '"') Fail("expected a key in double quotes");
                std::string key = String();
                Expect(':', "':' after the key");
                JsonScalar member = Value(depth + 1, nullptr, members != nullptr);
                if (members != nullptr) members->emplace_back(std::move(key), std::move(member));
            } else {
                JsonScalar item = Value(depth + 1, nullptr);
                if (items != nullptr) items->push_back(std::move(item));
            }
            Blanks();
            if (Peek() == close) break;
            Expect(',', separator);
            Blanks();
            if (Peek() == close) Fail(std::string("a comma before '") + close + "'");
        }
        ++pos_;
    }

    std::string String() {
        ++pos_;
        std::string out;
        for (;;) {
            if (pos_ >= text_.size()) Fail("a text in double quotes is not closed");
            const auto c = static_cast<unsigned char>(text_[pos_]);
            if (c == '"') break;
            if (c < 0x20 || c == 0x7f) Fail("a control character inside double quotes");
            ++pos_;
            if (c != '\\') {
                out += static_cast<char>(c);
                continue;
            }
            Escape(out);
        }
        ++pos_;
        return out;
    }

    void Escape(std::string& out) {
        const char c = Peek();
        static constexpr std::string_view kSimple = "\"\\/bfnrt";
        static constexpr std::string_view kMeaning = "\"\\/\b\f\n\r\t";
        if (const auto at = kSimple.find(c); c != '\0' && at != std::string_view::npos) {
            out += kMeaning[at];
            ++pos_;
            return;
        }
        if (c != 'u') Fail("a backslash inside double quotes goes before one of \"\\/bfnrtu");
        ++pos_;
        unsigned code = Hex4();
        if (code >= 0xd800 && code < 0xdc00 && Word("\\u")) {
            const unsigned low = Hex4();
            if (low >= 0xdc00 && low < 0xe000)
                code = 0x10000 + ((code - 0xd800) << 10) + (low - 0xdc00);
        }
        AppendUtf8(out, code);
    }

    unsigned Hex4() {
        unsigned code = 0;
        for (int i = 0; i < 4; ++i) {
            const char h = Peek();
            const int digit = h >= '0' && h <= '9'   ? h - '0'
                              : h >= 'a' && h <= 'f' ? h - 'a' + 10
                              : h >= 'A' && h <= 'F' ? h - 'A' + 10
                                                     : -1;
            if (digit < 0) Fail("\\u goes before four hexadecimal digits");
            code = code * 16 + static_cast<unsigned>(digit);
            ++pos_;
        }
        return code;
    }

    std::string Number() {
        const std::size_t start = pos_;
        auto digits = [this] {
            const std::size_t from = pos_;
            while (Peek() >= '0' && Peek() <= '9') ++pos_;
            return pos_ > from;
        };
        if (Peek() == '-') ++pos_;
        if (!digits()) Fail("a number needs a digit");
        if (Peek() == '.') {
            ++pos_;
            if (!digits()) Fail("a number needs a digit after '.'");
        }
        if (Peek() == 'e' || Peek() == 'E') {
            ++pos_;
            if (Peek() == '+' || Peek() == '-') ++pos_;
            if (!digits()) Fail("a number needs a digit in its exponent");
        }
        return std::string(text_.substr(start, pos_ - start));
    }

    std::string_view text_;
    std::size_t pos_ = 0;
};

// "line L, column C" of a byte position; columns count bytes from 1.
std::string Where(std::string_view text, std::size_t position) {
    std::size_t line = 1, column = 1;
    for (std::size_t i = 0; i < position && i < text.size(); ++i) {
        if (text[i] == '\n') {
            ++line;
            column = 1;
        } else {
            ++column;
        }
    }
    return "line " + std::to_string(line) + ", column " + std::to_string(column);
}

}  // namespace

JsonDocument ReadJsonDocument(std::string_view text) {
    text = text.substr(0, text.find('\0'));
    JsonDocument document;
    try {
        Reader(text).Document(document);
    } catch (const SyntaxError& error) {
        document = JsonDocument{};
        document.error = Where(text, error.position) + ": " + error.what();
    }
    return document;
}

const char* JsonKindName(JsonKind kind) {
    switch (kind) {
        case JsonKind::Null:
            return "null";
        case JsonKind::Bool:
            return "a boolean";
        case JsonKind::Number:
            return "a number";
        case JsonKind::String:
            return "a text";
        case JsonKind::Array:
            return "an array";
        case JsonKind::Object:
            return "an object";
    }
    return "?";
}

}  // namespace kvtag
