#include "taglibrary/requests/AsyncRequest.h"

namespace Korvane::Veldra::TagLibrary {

int32_t AsyncRequest::CheckResult(const TagIngestion::Errors& errors, std::string& error) {
    if (!response_) {
        error = errors.messageForName("Veldra.RequestTimedOut");
        return errors.codeForName("Veldra.RequestTimedOut");
    }
    if (!response_->HasError()) return 0;
    const MessageBus::MessageError replyError = response_->GetError();
    const std::string fullName = replyError.FullName();
    error = errors.messageForName(fullName, replyError.args);
    return errors.codeForName(fullName);
}

}  // namespace Korvane::Veldra::TagLibrary
