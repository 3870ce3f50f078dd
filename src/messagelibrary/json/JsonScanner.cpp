#include "messagelibrary/json/JsonScanner.h"

#include "messagelibrary/json/JsonGrammar.h"

namespace Korvane::Veldra::VeldraMessageLibrary::Jsonz {
namespace {

// Scanning alone: every event is ignored.
struct IgnoreEvents {
    void Null() noexcept {}
    void Bool(bool) noexcept {}
    void Number(const JsonToken&) noexcept {}
    void String(const JsonToken&) noexcept {}
    void Key(const JsonToken&) noexcept {}
    void BeginObject() noexcept {}
    void EndObject() noexcept {}
    void BeginArray() noexcept {}
    void EndArray() noexcept {}
};

}  // namespace

const char* ScanValue(const char* text, JsonToken& token, JsonError& error) noexcept {
    error = JsonError();
    if (text == nullptr) {
        error.code = kErrorValueExpected;
        return nullptr;
    }
    IgnoreEvents events;
    return JsonGrammar<IgnoreEvents>(events).Value(text, token, error, 0);
}

bool ValidateDocument(const char* text, JsonError& error) noexcept {
    IgnoreEvents events;
    return ScanDocument(text, events, error);
}

const char* ErrorName(int32_t code) noexcept {
    switch (code) {
        case kErrorValueExpected:
            return "jsonz_errorValueExpected";
        case kErrorDoubleQuoteExpected:
            return "jsonz_errorDoubleQuoteExpected";
        case kErrorCurlyBracketExpected:
            return "jsonz_errorCurlyBracketExpected";
        case kErrorSquareBracketExpected:
            return "jsonz_errorSquareBracketExpected";
        case kErrorColonExpected:
            return "jsonz_errorColonExpected";
        case kErrorCommaExpected:
            return "jsonz_errorCommaExpected";
        case kErrorInvalidStringSequence:
            return "jsonz_errorInvalidStringSequence";
        case kErrorTrailingComma:
            return "jsonz_errorTrailingComma";
        case kErrorTrailingChar:
            return "jsonz_errorTrailingChar";
        default:
            return "unknown";
    }
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::Jsonz
