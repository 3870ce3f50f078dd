#include "messagelibrary/ErrorRecord.h"

namespace Korvane::Veldra::VeldraMessageLibrary {

void WriteJsonFields(JsonObjectWriter& out, const ErrorRecord& record) {
    out.Field("name", record.name)
        .Field("message", record.message)
        .Field("args", record.args)
        .Field("innerErrors", record.innerErrors)
        .Field("resourceId", record.resourceId)
        .Field("resourceType", record.resourceType);
}

bool ReadJsonFields(ErrorRecord& out, const JsonVariant& object) {
    return ReadField(out.name, object, "name") && ReadField(out.message, object, "message") &&
           ReadField(out.args, object, "args") &&
           ReadField(out.innerErrors, object, "innerErrors") &&
           ReadField(out.resourceId, object, "resourceId") &&
           ReadField(out.resourceType, object, "resourceType");
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary
