#pragma once

#include <string>

namespace Korvane::Veldra::VeldraMessageLibrary::WorkflowMessages {

// The service that hands out workflow decisions and work steps.
inline const std::string kWorkflowService = "Workflow";

}  // namespace Korvane::Veldra::VeldraMessageLibrary::WorkflowMessages
