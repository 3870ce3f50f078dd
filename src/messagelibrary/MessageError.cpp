#include "messagelibrary/MessageError.h"

#include <utility>

namespace Korvane::Veldra::MessageBus {

MessageError MessageError::Named(const std::string& fullName, std::vector<std::string> args,
                                 std::string info) {
    return MessageError{ErrorCode::FromFullName(fullName), std::move(info), std::move(args)};
}

}  // namespace Korvane::Veldra::MessageBus
