#pragma once

#include <cstddef>
#include <cstdint>

// The scanning layer of the JSON text library: steps over values of a
// zero-terminated text and classifies them without building or allocating
// anything. It never reads past the terminator and never throws.
namespace Korvane::Veldra::VeldraMessageLibrary::Jsonz {

enum JsonErrorCode : int32_t {
    kErrorValueExpected = 1,
    kErrorDoubleQuoteExpected = 2,
    kErrorCurlyBracketExpected = 3,
    kErrorSquareBracketExpected = 4,
    kErrorColonExpected = 5,
    kErrorCommaExpected = 6,
    kErrorInvalidStringSequence = 7,
    kErrorTrailingComma = 8,
    kErrorTrailingChar = 9,
};

// Nesting deeper than this many arrays and objects is refused (with the
// error of the bracket that would open the next level), so that hostile text
// cannot exhaust the stack.
constexpr int kJsonMaxDepth = 512;

// kind is 0 for an error; position points at the offending character.
struct JsonError {
    int32_t kind = 0;
    const char* position = nullptr;
    int32_t code = 0;
};

// Token kinds are those of JsonKind: 1 null, 2 boolean, 3 number, 4 string,
// 5 array, 6 object. A string token spans the characters between the quotes,
// escapes unresolved; other tokens span the whole value. isFloat is set for a
// number with a fraction or an exponent.
struct JsonToken {
    int32_t kind = 0;
    const char* start = nullptr;
    std::size_t length = 0;
    bool isFloat = false;
    bool boolean = false;    // the value of a boolean token
    bool hasEscape = false;  // a string token holds a backslash
};

// True for space, tab, carriage return and line feed, and nothing else.
inline bool IsJsonSpace(char c) noexcept {
    return c == ' ' || c == '\t' || c == '\r' || c == '\n';
}
inline const char* SkipJsonSpace(const char* text) noexcept {
    while (IsJsonSpace(*text)) ++text;
    return text;
}

// Skips white space and one value. Returns the position just behind it and
// fills token, or returns null and fills error. The scanners are tried in the
// order string, number, object, array, boolean, null; when all fail, the
// error that got furthest into the text is reported (the first among equals).
const char* ScanValue(const char* text, JsonToken& token, JsonError& error) noexcept;

// One value and nothing behind it but white space (else kErrorTrailingChar).
bool ValidateDocument(const char* text, JsonError& error) noexcept;

// "jsonz_errorValueExpected" and the like; "unknown" for other codes.
const char* ErrorName(int32_t code) noexcept;

}  // namespace Korvane::Veldra::VeldraMessageLibrary::Jsonz
