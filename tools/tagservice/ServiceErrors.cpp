#include "ServiceErrors.h"

#include <utility>

#include "errors/ErrorTable.h"
#include "errors/MessageInserts.h"

namespace Korvane::Veldra::TagService {

std::string ErrorText(const std::string& fullName, const std::vector<std::string>& args) {
    const MessageBus::ErrorRow* row = MessageBus::FindErrorRow(fullName.c_str());
    return row == nullptr ? fullName : MessageBus::ApplyInserts(row->message, args);
}

MessageBus::MessageError ServiceError(const std::string& fullName, std::vector<std::string> args) {
    std::string text = ErrorText(fullName, args);
    return MessageBus::MessageError::Named(fullName, std::move(args), std::move(text));
}

ErrorRecord TagErrorRecord(const std::string& fullName, const std::string& path) {
    ErrorRecord record;
    record.name = fullName;
    record.message = ErrorText(fullName, {path});
    record.args = VeldraMessageLibrary::JsonStringList{path};
    record.resourceId = path;
    record.resourceType = "Tag";
    return record;
}

ErrorRecord AggregateErrorRecord(std::vector<ErrorRecord> failures) {
    ErrorRecord record;
    record.name = "Veldra.OneOrMoreErrorsOccurred";
    record.message = ErrorText(*record.name, {});
    record.args.emplace();
    record.innerErrors = std::move(failures);
    return record;
}

}  // namespace Korvane::Veldra::TagService
