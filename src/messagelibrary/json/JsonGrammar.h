#pragma once

#include <array>
#include <cstring>

#include "messagelibrary/json/JsonScanner.h"

// The one implementation of the JSON grammar, shared by the validator (with a
// handler that does nothing) and the tree builder (with one that builds).
//
// A value is tried with six scanners in a fixed order: string, number,
// object, array, boolean, null. The first to succeed wins; when all fail, the
// kept error is the one that got furthest (strictly larger position; the
// first among equals). Only the scanner whose first character matches can get
// past that character, so a handler sees the events of one scanner only.
//
// Handler events:
//   void Null(); void Bool(bool); void Number(const JsonToken&);
//   void String(const JsonToken&); void Key(const JsonToken&);
//   void BeginObject(); void EndObject(); void BeginArray(); void EndArray();
namespace Korvane::Veldra::VeldraMessageLibrary::Jsonz {

template <typename Handler>
class JsonGrammar {
public:
    explicit JsonGrammar(Handler& handler) noexcept : handler_(handler) {}

    const char* Value(const char* p, JsonToken& token, JsonError& error, int depth) {
        p = SkipJsonSpace(p);
        JsonError attempt;
        const char* end = String(p, token, error);
        if (end != nullptr) {
            handler_.String(token);
            return end;
        }
        if ((end = Number(p, token, attempt)) != nullptr) return end;
        Keep(error, attempt);
        if ((end = Object(p, token, attempt, depth)) != nullptr) return end;
        Keep(error, attempt);
        if ((end = Array(p, token, attempt, depth)) != nullptr) return end;
        Keep(error, attempt);
        if ((end = Boolean(p, token, attempt)) != nullptr) return end;
        Keep(error, attempt);
        if ((end = Null(p, token, attempt)) != nullptr) return end;
        Keep(error, attempt);
        return nullptr;
    }

private:
    static void Keep(JsonError& kept, const JsonError& attempt) noexcept {
        if (attempt.position > kept.position) kept = attempt;
    }

    static const char* Fail(JsonError& error, const char* at, int32_t code) noexcept {
        error.kind = 0;
        error.position = at;
        error.code = code;
        return nullptr;
    }

    static bool IsDigit(char c) noexcept { return c >= '0' && c <= '9'; }
    // Bytes a string scan must stop at: the quote, the backslash, control
    // characters and 127 (the terminator among them).
    static bool StopsString(unsigned char c) noexcept {
        static constexpr auto kStops = [] {
            std::array<bool, 256> stops{};
            for (int i = 0; i < 32; ++i) stops[i] = true;
            stops['"'] = stops['\\'] = stops[127] = true;
            return stops;
        }();
        return kStops[c];
    }
    static bool IsHex(char c) noexcept {
        return IsDigit(c) || (c >= 'a' && c <= 'f') || (c >= 'A' && c <= 'F');
    }

    // The string scanner; the token spans the characters between the quotes.
    static const char* String(const char* p, JsonToken& token, JsonError& error) noexcept {
        if (*p != '"') return Fail(error, p, kErrorDoubleQuoteExpected);
        const char* q = p + 1;
        bool hasEscape = false;
        for (;;) {
            while (!StopsString(static_cast<unsigned char>(*q))) ++q;
            const unsigned char c = static_cast<unsigned char>(*q);
            if (c == '"') break;
            if (c < 32 || c == 127) return Fail(error, q, kErrorDoubleQuoteExpected);
            if (c == '\\') {
                hasEscape = true;
                ++q;
                switch (*q) {
                    case '"':
                    case '/':
                    case '\\':
                    case 'b':
                    case 'f':
                    case 'n':
                    case 'r':
                    case 't':
                        break;
                    case 'u':
                        for (int i = 0; i < 4; ++i) {
                            if (!IsHex(*++q)) return Fail(error, q, kErrorInvalidStringSequence);
                        }
                        break;
                    default:
                        return Fail(error, q, kErrorInvalidStringSequence);
                }
            }
            ++q;
        }
        token.kind = 4;
        token.start = p + 1;
        token.length = static_cast<std::size_t>(q - (p + 1));
        token.isFloat = false;
        token.hasEscape = hasEscape;
        return q + 1;
    }

    const char* Number(const char* p, JsonToken& token, JsonError& error) {
        const char* q = p;
        if (*q == '-') {
            ++q;
        } else if (!IsDigit(*q)) {
            return Fail(error, p, kErrorValueExpected);
        }
        bool isFloat = false;
        while (IsDigit(*q)) ++q;
        if (*q == '.') {
            isFloat = true;
            ++q;
            while (IsDigit(*q)) ++q;
        }
        if ((*q == 'e' || *q == 'E') && (q[1] == '+' || q[1] == '-' || IsDigit(q[1]))) {
            isFloat = true;
            q += 2;
            while (IsDigit(*q)) ++q;
        }
        token.kind = 3;
        token.start = p;
        token.length = static_cast<std::size_t>(q - p);
        token.isFloat = isFloat;
        handler_.Number(token);
        return q;
    }

    const char* Object(const char* p, JsonToken& token, JsonError& error, int depth) {
        if (*p != '{') return Fail(error, p, kErrorCurlyBracketExpected);
        if (depth >= kJsonMaxDepth) return Fail(error, p + 1, kErrorCurlyBracketExpected);
        handler_.BeginObject();
        const char* q = SkipJsonSpace(p + 1);
        if (*q == '\0') return Fail(error, q, kErrorCurlyBracketExpected);
        if (*q != '}') {
            for (;;) {
                JsonToken key;
                q = String(q, key, error);
                if (q == nullptr) return nullptr;
                handler_.Key(key);
                q = SkipJsonSpace(q);
                if (*q != ':') return Fail(error, q, kErrorColonExpected);
                JsonToken member;
                q = Value(q + 1, member, error, depth + 1);
                if (q == nullptr) return nullptr;
                q = SkipJsonSpace(q);
                if (*q == ',') {
                    q = SkipJsonSpace(q + 1);
                    if (*q == '}') return Fail(error, q, kErrorTrailingComma);
                    continue;
                }
                if (*q == '}') break;
                return Fail(error, q,
                            *q == '\0' ? kErrorCurlyBracketExpected : kErrorCommaExpected);
            }
        }
        handler_.EndObject();
        return Container(p, q + 1, 6, token);
    }

    const char* Array(const char* p, JsonToken& token, JsonError& error, int depth) {
        if (*p != '[') return Fail(error, p, kErrorSquareBracketExpected);
        if (depth >= kJsonMaxDepth) return Fail(error, p + 1, kErrorSquareBracketExpected);
        handler_.BeginArray();
        const char* q = SkipJsonSpace(p + 1);
        if (*q == '\0') return Fail(error, q, kErrorSquareBracketExpected);
        if (*q != ']') {
            for (;;) {
                JsonToken element;
                q = Value(q, element, error, depth + 1);
                if (q == nullptr) return nullptr;
                q = SkipJsonSpace(q);
                if (*q == ',') {
                    q = SkipJsonSpace(q + 1);
                    if (*q == ']') return Fail(error, q, kErrorTrailingComma);
                    continue;
                }
                if (*q == ']') break;
                return Fail(error, q,
                            *q == '\0' ? kErrorSquareBracketExpected : kErrorCommaExpected);
            }
        }
        handler_.EndArray();
        return Container(p, q + 1, 5, token);
    }

    static const char* Container(const char* start, const char* end, int32_t kind,
                                 JsonToken& token) noexcept {
        token.kind = kind;
        token.start = start;
        token.length = static_cast<std::size_t>(end - start);
        token.isFloat = false;
        return end;
    }

    const char* Boolean(const char* p, JsonToken& token, JsonError& error) {
        bool value;
        std::size_t length;
        if (std::strncmp(p, "true", 4) == 0) {
            value = true;
            length = 4;
        } else if (std::strncmp(p, "false", 5) == 0) {
            value = false;
            length = 5;
        } else {
            return Fail(error, p, kErrorValueExpected);
        }
        token.kind = 2;
        token.start = p;
        token.length = length;
        token.isFloat = false;
        token.boolean = value;
        handler_.Bool(value);
        return p + length;
    }

    const char* Null(const char* p, JsonToken& token, JsonError& error) {
        if (std::strncmp(p, "null", 4) != 0) return Fail(error, p, kErrorValueExpected);
        token.kind = 1;
        token.start = p;
        token.length = 4;
        token.isFloat = false;
        handler_.Null();
        return p + 4;
    }

    Handler& handler_;
};

// Runs the grammar over a whole document: one value, then only white space.
template <typename Handler>
bool ScanDocument(const char* text, Handler& handler, JsonError& error) {
    error = JsonError();
    if (text == nullptr) {
        error.code = kErrorValueExpected;
        return false;
    }
    JsonToken token;
    const char* end = JsonGrammar<Handler>(handler).Value(text, token, error, 0);
    if (end == nullptr) return false;
    end = SkipJsonSpace(end);
    if (*end != '\0') {
        error.kind = 0;
        error.position = end;
        error.code = kErrorTrailingChar;
        return false;
    }
    return true;
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::Jsonz
