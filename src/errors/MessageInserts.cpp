#include "errors/MessageInserts.h"

#include <boost/lexical_cast.hpp>
#include <cstdint>

namespace Korvane::Veldra::MessageBus {
namespace {

// Cuts the text into pieces: a "{" starts a new piece, a "}" ends one.
std::vector<std::string> SplitPieces(const std::string& message) {
    std::vector<std::string> pieces;
    std::string piece;
    for (const char c : message) {
        if (c == '{' && !piece.empty()) {
            pieces.push_back(std::move(piece));
            piece.clear();
        }
        piece.push_back(c);
        if (c == '}') {
            pieces.push_back(std::move(piece));
            piece.clear();
        }
    }
    if (!piece.empty()) pieces.push_back(std::move(piece));
    return pieces;
}

}  // namespace

std::string ApplyInserts(const std::string& message, const std::vector<std::string>& inserts) {
    std::string output;
    output.reserve(message.size());
    for (const auto& piece : SplitPieces(message)) {
        if (piece.size() < 3 || piece.front() != '{' || piece.back() != '}') {
            output += piece;
            continue;
        }
        int32_t number = 0;
        if (!boost::conversion::try_lexical_convert(piece.substr(1, piece.size() - 2), number)) {
            return "Malformed message insert number in message: \"" + message + "\"";
        }
        if (number >= static_cast<int32_t>(inserts.size())) {
            return "Too few inserts passed to format the message: \"" + message + "\"";
        }
        if (number < 0) {
            // Out of contract: no registered text has a negative insert.
            output += piece;
            continue;
        }
        output += inserts[static_cast<std::size_t>(number)];
    }
    return output;
}

}  // namespace Korvane::Veldra::MessageBus
