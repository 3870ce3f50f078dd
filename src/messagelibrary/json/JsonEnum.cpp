#include "messagelibrary/json/JsonEnum.h"

namespace Korvane::Veldra::VeldraMessageLibrary {

const char* JsonEnumTexts::TextOf(int32_t value) const noexcept {
    for (std::size_t i = 0; i < count_; ++i) {
        if (entries_[i].value == value) return entries_[i].text;
    }
    return nullptr;
}

bool JsonEnumTexts::ValueOf(std::string_view text, int32_t& value) const noexcept {
    for (std::size_t i = 0; i < count_; ++i) {
        if (text == entries_[i].text) {
            value = entries_[i].value;
            return true;
        }
    }
    return false;
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary
