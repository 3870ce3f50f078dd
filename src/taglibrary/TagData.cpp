#include "taglibrary/TagData.h"

#include "taglibrary/TagReferences.h"

namespace Korvane::Veldra::TagLibrary {

TagData::TagData(uint64_t instanceId_, std::string path_, std::optional<TagDataType> dataType_)
    : instanceId(instanceId_),
      path(std::move(path_)),
      dataType(dataType_),
      reference_(TagReferences::Acquire()) {}

TagData::~TagData() {
    TagReferences::Release(reference_);
}

}  // namespace Korvane::Veldra::TagLibrary
