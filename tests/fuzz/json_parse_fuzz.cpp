// Parse and everything that reads text: the validator and the builder must
// agree, errors must point into the text, and neither the raw accessors nor
// the field readers may crash on what the parser gives them.

#include <boost/lexical_cast.hpp>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <optional>
#include <string>
#include <vector>

#include "errors/VeldraException.h"
#include "messagelibrary/json/JsonParser.h"
#include "messagelibrary/json/JsonRawAccess.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonScanner.h"
#include "messagelibrary/json/JsonUnescape.h"

using namespace Korvane::Veldra::VeldraMessageLibrary;

namespace {

void Check(bool condition) {
    if (!condition) __builtin_trap();
}

// Every reader over every member: refusals and conversion failures are
// fine, anything else is not.
void ReadAllFields(const JsonVariant& json) {
    for (const JsonMember& member : json.Members()) {
        try {
            bool b;
            int32_t i;
            double d;
            Timestamp t;
            std::optional<std::string> s;
            std::optional<JsonStringList> l;
            std::optional<JsonStringMap> m;
            std::optional<std::vector<std::vector<int32_t>>> nested;
            ReadField(b, json, member.key);
            ReadField(s, json, member.key);
            ReadField(l, json, member.key);
            ReadField(m, json, member.key);
            ReadField(t, json, member.key);
            ReadField(nested, json, member.key);
            ReadField(d, json, member.key);
            ReadField(i, json, member.key);
        } catch (const boost::bad_lexical_cast&) {
        }
    }
}

void WalkRawText(const char* text) {
    for (const char* m = Jsonz::RawFirstMember(text); m != nullptr; m = Jsonz::RawNextMember(m)) {
        std::size_t length = 0;
        const char* key = Jsonz::RawMemberKey(m, length);
        if (key != nullptr) {
            std::string decoded;
            Jsonz::UnescapeJsonString(key, length, decoded);
        }
        Jsonz::RawDouble(Jsonz::RawMemberValue(m), 0);
    }
    const std::size_t count = Jsonz::RawElementCount(text);
    Jsonz::RawUInt64(Jsonz::RawElementAt(text, count / 2), 0);
    Jsonz::RawUInt32(text, 0);
    Jsonz::RawBool(text, false);
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, std::size_t size) {
    const std::string text(reinterpret_cast<const char*>(data), size);
    const char* begin = text.c_str();
    const std::size_t length = std::strlen(begin);

    Jsonz::JsonError error;
    const bool valid = Jsonz::ValidateDocument(begin, error);
    if (!valid) {
        Check(error.code >= Jsonz::kErrorDoubleQuoteExpected &&
              error.code <= Jsonz::kErrorTrailingChar);
        Check(error.position >= begin && error.position <= begin + length);
    }

    JsonVariant json;
    const bool parsed = Parse(json, text);
    Check(!parsed || valid);
    Check(parsed || json.IsNone());
    if (parsed) ReadAllFields(json);
    WalkRawText(begin);
    return 0;
}
