#pragma once

#include <gtest/gtest.h>

#include <optional>
#include <string>
#include <utility>

#include "errors/VeldraException.h"

namespace Korvane::Veldra::MessageBus::Testing {

// Runs the call and returns the VeldraException it threw, or nothing.
template <typename Call>
std::optional<VeldraException> CatchVeldra(Call&& call) {
    try {
        std::forward<Call>(call)();
    } catch (const VeldraException& e) {
        return e;
    }
    return std::nullopt;
}

#define EXPECT_THROWS_VELDRA(call, expectedCode, expectedText)                          \
    do {                                                                                \
        const auto caught_ =                                                            \
            ::Korvane::Veldra::MessageBus::Testing::CatchVeldra([&] { (void)(call); }); \
        ASSERT_TRUE(caught_.has_value()) << "no VeldraException from " #call;           \
        EXPECT_EQ(caught_->Code(), (expectedCode));                                     \
        EXPECT_EQ(std::string(caught_->what()), (expectedText));                        \
    } while (0)

}  // namespace Korvane::Veldra::MessageBus::Testing
