#pragma once

#include <string>

namespace Korvane::Veldra::VeldraMessageLibrary {

// The tag services, the targets of the tag requests and routed messages.
inline const std::string kTagIngestionService = "TagIngestion";
inline const std::string kTagCurrentValueService = "TagCurrentValue";
inline const std::string kTagInfoService = "TagInfo";
inline const std::string kTagHistorianService = "TagHistorian";
inline const std::string kTagSubscriptionCommunicatorService = "TagSubscriptionCommunicator";
inline const std::string kTagHttpService = "TagHttp";

}  // namespace Korvane::Veldra::VeldraMessageLibrary
