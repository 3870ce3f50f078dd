// The variant-to-text round trip: whatever parses is written, parsed again
// and must come back equal, and writing it again gives the same bytes.

#include <cmath>
#include <cstddef>
#include <cstdint>
#include <string>

#include "messagelibrary/json/JsonParser.h"
#include "messagelibrary/json/JsonVariantText.h"

using namespace Korvane::Veldra::VeldraMessageLibrary;

namespace {

void Check(bool condition) {
    if (!condition) __builtin_trap();
}

// A number beyond the double's range parses as an infinity, which has no JSON
// text; such trees cannot come back.
bool AllFinite(const JsonVariant& json) {
    if (json.IsNumber()) return std::isfinite(json.AsNumber());
    for (const JsonVariant& element : json.Elements()) {
        if (!AllFinite(element)) return false;
    }
    for (const JsonMember& member : json.Members()) {
        if (!AllFinite(member.value)) return false;
    }
    return true;
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, std::size_t size) {
    const std::string text(reinterpret_cast<const char*>(data), size);
    JsonVariant first;
    if (!Parse(first, text) || !AllFinite(first)) return 0;

    const std::string written = ToJsonText(first);
    JsonVariant second;
    Check(Parse(second, written));
    Check(first == second);
    Check(ToJsonText(second) == written);
    return 0;
}
