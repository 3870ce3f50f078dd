#pragma once

#include <cstdint>

#include "messagelibrary/json/JsonEnum.h"

// The enumerations of the workflow messages.

namespace Korvane::Veldra::VeldraMessageLibrary::WorkflowMessages {

// How a work step ended.
enum class WorkflowWorkResult : int32_t {
    Unknown = 0,
    Success = 1,
    Failure = 2,
    Timeout = 3,
};

inline constexpr JsonEnumText kWorkflowWorkResultTexts[] = {
    {0, "UNKNOWN"}, {1, "SUCCESS"}, {2, "FAILURE"}, {3, "TIMEOUT"}};
inline JsonEnumTexts JsonEnumTextsOf(WorkflowWorkResult) {
    return kWorkflowWorkResultTexts;
}

// The kind of a workflow step. No message field carries it.
enum class WorkflowStepKind : int32_t {
    Unknown = 0,
    Work = 1,
    Decide = 2,
};

inline constexpr JsonEnumText kWorkflowStepKindTexts[] = {
    {0, "UNKNOWN"}, {1, "WORK"}, {2, "DECIDE"}};
inline JsonEnumTexts JsonEnumTextsOf(WorkflowStepKind) {
    return kWorkflowStepKindTexts;
}

// Where a job stands.
enum class WorkflowJobStatus : int32_t {
    Unknown = 0,
    JustSubmitted = 1,
    NeedsDecision = 2,
    OutForDecision = 3,
    NeedsWork = 4,
    OutForWork = 5,
    StepTimedOut = 6,
    DecisionTimedOut = 7,
    WorkTimedOut = 8,
    JobCanceled = 9,
    JobCompleted = 10,
    JobTimedOut = 11,
    JobFailed = 12,
};

inline constexpr JsonEnumText kWorkflowJobStatusTexts[] = {
    {0, "UNKNOWN"},        {1, "JUST_SUBMITTED"}, {2, "NEEDS_DECISION"}, {3, "OUT_FOR_DECISION"},
    {4, "NEEDS_WORK"},     {5, "OUT_FOR_WORK"},   {6, "STEP_TIMED_OUT"}, {7, "DECISION_TIMED_OUT"},
    {8, "WORK_TIMED_OUT"}, {9, "JOB_CANCELED"},   {10, "JOB_COMPLETED"}, {11, "JOB_TIMED_OUT"},
    {12, "JOB_FAILED"}};
inline JsonEnumTexts JsonEnumTextsOf(WorkflowJobStatus) {
    return kWorkflowJobStatusTexts;
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::WorkflowMessages
