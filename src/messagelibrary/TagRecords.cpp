#include "messagelibrary/TagRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary {

void WriteJsonFields(JsonObjectWriter& out, const TagChange& record) {
    const std::string changes = TagChangeFlagsJson(record.changes);
    out.Field("tag", record.tag).Field("changes", JsonRaw{changes});
}

bool ReadJsonFields(TagChange& out, const JsonVariant& object) {
    return ReadField(out.tag, object, "tag") && ReadTagChangeFlags(out.changes, object, "changes");
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary
