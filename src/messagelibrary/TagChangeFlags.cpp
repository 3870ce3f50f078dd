#include "messagelibrary/TagChangeFlags.h"

#include <vector>

#include "messagelibrary/json/JsonReaders.h"

namespace Korvane::Veldra::VeldraMessageLibrary {

std::string TagChangeFlagsJson(const std::optional<TagChangeFlags>& flags) {
    if (!flags.has_value()) return "null";
    if (*flags == TagChangeFlags::None) return "[]";
    std::string text = "[";
    for (const JsonEnumText& bit : kTagChangeFlagTexts) {
        if ((*flags & static_cast<TagChangeFlags>(bit.value)) == TagChangeFlags::None) continue;
        if (text.size() > 1) text.append(", ");
        text.append("\"").append(bit.text).append("\"");
    }
    if (text.size() == 1) return "null";
    text.push_back(']');
    return text;
}

bool ReadTagChangeFlags(std::optional<TagChangeFlags>& out, const JsonVariant& object,
                        std::string_view key) {
    std::optional<std::vector<TagChangeFlags>> bits;
    if (!ReadField(bits, object, key)) return false;
    out.reset();
    if (!bits.has_value()) return true;
    out = TagChangeFlags::None;
    for (const TagChangeFlags bit : *bits) *out = *out | bit;
    return true;
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary
