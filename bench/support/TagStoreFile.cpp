#include "support/TagStoreFile.h"

#include <stdexcept>

#include "SqliteTagStore.h"
#include "TagMetadataRules.h"

namespace Korvane::Veldra::Bench {

void WriteTagStore(const std::string& file, const std::vector<std::string>& paths) {
    TagService::StoreBatch batch;
    batch.put.reserve(paths.size());
    for (const std::string& path : paths) {
        const VeldraMessageLibrary::TagRecord record{
            path, VeldraMessageLibrary::TagDataType::Double, std::nullopt, std::nullopt, false};
        TagService::StoredTag tag;
        if (const auto error = TagService::NewTag(record, tag)) {
            throw std::runtime_error("'" + path + "' cannot be a tag: " + *error);
        }
        batch.put.push_back(std::move(tag));
    }
    TagService::SqliteTagStore(file).Apply(batch);
}

}  // namespace Korvane::Veldra::Bench
