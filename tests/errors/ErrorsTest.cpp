#include <gtest/gtest.h>

#include <memory>
#include <set>

#include "errors/ErrorCodeRegistry.h"
#include "errors/ErrorTable.h"
#include "errors/Errors.h"
#include "errors/MessageInserts.h"
#include "errors/VeldraException.h"

using Korvane::Veldra::MessageBus::ApplyInserts;
using Korvane::Veldra::MessageBus::ErrorCode;
using Korvane::Veldra::MessageBus::ErrorCodeRegistry;
using Korvane::Veldra::MessageBus::VeldraException;
using Korvane::Veldra::TagIngestion::Errors;

namespace {

std::unique_ptr<Errors> InitializedErrors() {
    auto errors = std::make_unique<Errors>();
    errors->initialize();
    return errors;
}

// Runs the call and returns the text of the VeldraException pointer it throws.
template <typename Call>
std::string ThrownPointerText(Call&& call, int32_t& code) {
    try {
        call();
    } catch (VeldraException* exception) {
        std::unique_ptr<VeldraException> owned(exception);
        code = owned->Code();
        return owned->what();
    }
    return "<nothing thrown>";
}

}  // namespace

TEST(ErrorTable, HasEveryCodeOnceInItsRanges) {
    std::size_t count = 0;
    const auto* rows = Korvane::Veldra::MessageBus::ErrorRows(count);
    ASSERT_EQ(count, 65u);
    std::set<int32_t> codes;
    for (std::size_t i = 0; i < count; ++i) {
        const int32_t code = rows[i].code;
        EXPECT_TRUE(codes.insert(code).second) << code;
        const std::string category = rows[i].category;
        if (category == "Veldra") {
            EXPECT_TRUE(code <= -251000 && code >= -251041) << code;
        } else {
            EXPECT_EQ(category, "Tag");
            EXPECT_TRUE((code <= -251900 && code >= -251917) ||
                        (code <= -251922 && code >= -251926))
                << code;
        }
    }
}

TEST(Errors, CodesNamesAndTexts) {
    const auto errors = InitializedErrors();
    EXPECT_EQ(errors->codeForName("Veldra.InternalServiceError"), -251000);
    EXPECT_EQ(errors->codeForName("Veldra.OneOrMoreErrorsOccurred"), -251041);
    EXPECT_EQ(errors->codeForName("Tag.InvalidTagReference"), -251900);
    EXPECT_EQ(errors->codeForName("Tag.TagsListCannotBeEmptyOrNull"), -251926);
    EXPECT_EQ(errors->codeForName("Tag.NoSuchThing"), -251000);
    EXPECT_EQ(errors->messageForName("Tag.NoSuchThing"), "");

    std::string name;
    EXPECT_TRUE(errors->nameForCode(-251034, name));
    EXPECT_EQ(name, "Veldra.AMQPErrorCertificateExpired");
    EXPECT_EQ(errors->messageForCode(-251034), "AMQP error: Cetificate expired.");
    for (const int32_t unassigned : {-251918, -251921, 0, 1, -251042}) {
        EXPECT_FALSE(errors->nameForCode(unassigned, name));
        EXPECT_EQ(name, "Unknown");
        EXPECT_EQ(errors->messageForCode(unassigned, {"ignored"}), "An unknown error occurred.");
    }
}

TEST(Errors, MessagesWithInserts) {
    const auto errors = InitializedErrors();
    EXPECT_EQ(errors->messageForName("Tag.NoSuchTag", {"a/b"}), "No such tag: 'a/b'.");
    EXPECT_EQ(errors->messageForName("Tag.NoSuchTag"),
              "Too few inserts passed to format the message: \"No such tag: '{0}'.\"");
    EXPECT_EQ(errors->messageForName("Tag.ConflictingTagTypes", {"p", "Double", "none"}),
              "Conflicting types for tag 'p': 'Double' != 'none'.");
    EXPECT_EQ(errors->messageForName("Veldra.UnexpectedException", {"boom"}),
              "An unexpected exception occurred: boom");
    EXPECT_EQ(errors->messageForCode(-251908, {"x"}),
              "Tag 'x' has type string and cannot collect aggregates.");
}

TEST(Errors, MisuseThrowsPointers) {
    Errors fresh;
    int32_t code = 0;
    EXPECT_EQ(ThrownPointerText([&] { fresh.codeForName("Tag.InvalidTagReference"); }, code),
              "Errors is not initialized");
    EXPECT_EQ(code, -251004);
    EXPECT_EQ(ThrownPointerText([&] { fresh.messageForCode(-251000); }, code),
              "Errors is not initialized");
    const auto errors = InitializedErrors();
    EXPECT_EQ(ThrownPointerText([&] { errors->initialize(); }, code),
              "Errors class is already initialized.");
}

TEST(ApplyInserts, PiecesAndFailures) {
    struct Case {
        const char* message;
        std::vector<std::string> inserts;
        const char* expected;
    };
    const Case cases[] = {
        {"plain text", {}, "plain text"},
        {"{1}-{0}-{1}", {"a", "b"}, "b-a-b"},
        {"{0}", {"a", "surplus"}, "a"},
        {"bare {} braces", {}, "bare {} braces"},
        {"lone } brace {", {}, "lone } brace {"},
        {"{+1}", {"a", "b"}, "b"},
        {"{x}", {"a"}, "Malformed message insert number in message: \"{x}\""},
        {"a {0 } b", {"a"}, "Malformed message insert number in message: \"a {0 } b\""},
        {"{99999999999}", {"a"}, "Malformed message insert number in message: \"{99999999999}\""},
        {"{2}", {"a", "b"}, "Too few inserts passed to format the message: \"{2}\""},
        {"{{0}}", {"a"}, "{a}"},
    };
    for (const auto& c : cases) {
        EXPECT_EQ(ApplyInserts(c.message, c.inserts), c.expected) << c.message;
    }
}

TEST(ErrorCodeRegistry, LookupAndNames) {
    InitializedErrors();
    auto& registry = ErrorCodeRegistry::Instance();
    const ErrorCode known = registry.lookup("Tag.InvalidTagPath");
    EXPECT_EQ(known.category, "Tag");
    EXPECT_EQ(known.name, "InvalidTagPath");
    EXPECT_EQ(known.message, "Invalid tag path.");

    const ErrorCode unknown = registry.lookup("Tag.DoesNotExist");
    EXPECT_EQ(unknown.category, "");
    EXPECT_EQ(unknown.name, "Unknown");
    EXPECT_EQ(unknown.message, "");
    EXPECT_EQ(registry.lookup("Unknown").message, "An unknown error occurred.");

    const ErrorCode split = registry.fromFullName("One.Two.Three");
    EXPECT_EQ(split.category, "One");
    EXPECT_EQ(split.name, "Two.Three");
    EXPECT_EQ(ErrorCodeRegistry::fullName(split), "One.Two.Three");
    EXPECT_EQ(ErrorCodeRegistry::fullName(registry.fromFullName("NoDot")), "NoDot");
}
