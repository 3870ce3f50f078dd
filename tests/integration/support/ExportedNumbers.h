#pragma once

#include <cstdint>

namespace Korvane::Veldra::Testing {

// The data type numbers that both exported families take and give.
enum ExportedType : int32_t { kDouble = 0, kInt = 1, kString = 2, kBoolean = 3, kUInt64 = 4, kDateTime = 5 };

// The status codes the broker tests of the exported families expect.
inline constexpr int32_t kRequestTimedOut = -251001;
inline constexpr int32_t kInvalidTagReference = -251900;
inline constexpr int32_t kInvalidTagDataType = -251902;
inline constexpr int32_t kConflictingTagTypes = -251907;
inline constexpr int32_t kStringTagCannotCollectAggregates = -251908;
inline constexpr int32_t kNoSuchTag = -251909;
inline constexpr int32_t kInvalidState = -251914;

}  // namespace Korvane::Veldra::Testing
