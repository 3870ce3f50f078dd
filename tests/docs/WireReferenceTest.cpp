// Keeps docs/wire-reference.md honest: each message and record section there
// ("### Name", then a table whose first column is the key in backticks) must
// list exactly the keys that the class writes for an instance with every
// field set, and a message's "Routing key:" line must be the key the class
// gives itself. A section the test does not know, or a known class the
// reference leaves out, fails as well.
#include <gtest/gtest.h>

#include <fstream>
#include <functional>
#include <map>
#include <set>
#include <sstream>
#include <string>
#include <vector>

#include "messagebus/interfaces/IRoutingSource.h"
#include "messagelibrary/GenericResponse.h"
#include "messagelibrary/RequestMessage.h"
#include "messagelibrary/json/JsonParser.h"
#include "messagelibrary/json/JsonVariant.h"
#include "messagelibrary/tagcurrentvalue/TagCvAggregatesResetBroadcast.h"
#include "messagelibrary/tagcurrentvalue/TagCvQueryCurrentValuesByPathRequest.h"
#include "messagelibrary/tagcurrentvalue/TagCvQueryCurrentValuesByPathResponse.h"
#include "messagelibrary/tagcurrentvalue/TagCvResetAggregatesRoutedMessage.h"
#include "messagelibrary/taginfo/TagInfoCreateOrUpdateTagsRequest.h"
#include "messagelibrary/taginfo/TagInfoCreateOrUpdateTagsResponse.h"
#include "messagelibrary/taginfo/TagInfoCreateTagRoutedMessage.h"
#include "messagelibrary/taginfo/TagInfoDeleteTagsRoutedMessage.h"
#include "messagelibrary/taginfo/TagInfoDeletedTagsBroadcast.h"
#include "messagelibrary/taginfo/TagInfoQueryTagsRequest.h"
#include "messagelibrary/taginfo/TagInfoQueryTagsResponse.h"
#include "messagelibrary/taginfo/TagInfoTagMetadataUpdatedBroadcast.h"
#include "messagelibrary/taginfo/TagInfoUpdateTagRoutedMessage.h"
#include "messagelibrary/tagingestion/TagNewJournalsWrittenBroadcast.h"
#include "messagelibrary/tagingestion/TagNewTagsIngestedBroadcast.h"
#include "messagelibrary/tagingestion/TagUpdateValuesRoutedMessage.h"
#include "messagelibrary/tags/TagSamples.h"

#ifndef KVVELDRA_WIRE_REFERENCE
#error "KVVELDRA_WIRE_REFERENCE must name docs/wire-reference.md"
#endif

namespace Korvane::Veldra::MessageBus::Testing {
namespace {

using namespace VeldraMessageLibrary;
using namespace VeldraMessageLibrary::Testing;
using namespace VeldraMessageLibrary::TagIngestionMessages;
using namespace VeldraMessageLibrary::TagCurrentValueMessages;
using namespace VeldraMessageLibrary::TagInfoMessages;

using KeySet = std::set<std::string>;

// ---- The reference as written ----

struct Section {
    KeySet keys;
    std::string routingKey;  // between the backticks of "Routing key: `...`"
    std::string example;     // the first ```json block
};

std::string Trim(const std::string& text) {
    const auto first = text.find_first_not_of(" \t\r");
    if (first == std::string::npos) return std::string();
    const auto last = text.find_last_not_of(" \t\r");
    return text.substr(first, last - first + 1);
}

std::string FirstBackticked(const std::string& text, std::size_t from) {
    const auto open = text.find('`', from);
    if (open == std::string::npos) return std::string();
    const auto close = text.find('`', open + 1);
    if (close == std::string::npos) return std::string();
    return text.substr(open + 1, close - open - 1);
}

// Every "### Name" section with at least one key row, or a routing key line.
std::map<std::string, Section> ReadReference() {
    std::ifstream file(KVVELDRA_WIRE_REFERENCE);
    EXPECT_TRUE(file) << "cannot read " << KVVELDRA_WIRE_REFERENCE;
    std::map<std::string, Section> sections;
    std::string line;
    std::string current;
    Section section;
    const auto flush = [&] {
        if (!current.empty() && (!section.keys.empty() || !section.routingKey.empty())) {
            EXPECT_EQ(sections.count(current), 0u) << "section documented twice: " << current;
            sections[current] = section;
        }
        current.clear();
        section = Section();
    };
    bool inExample = false;
    bool exampleDone = false;
    while (std::getline(file, line)) {
        if (inExample) {
            if (line.rfind("```", 0) == 0) {
                inExample = false;
                exampleDone = true;
            } else {
                section.example += line;
            }
            continue;
        }
        if (line.rfind("```json", 0) == 0 && !current.empty() && !exampleDone) {
            inExample = true;
            continue;
        }
        if (line.rfind("#", 0) == 0) {
            exampleDone = false;
            flush();
            if (line.rfind("### ", 0) == 0) current = Trim(line.substr(4));
            continue;
        }
        if (current.empty()) continue;
        if (line.rfind("| `", 0) == 0) {
            const std::string key = FirstBackticked(line, 0);
            EXPECT_TRUE(section.keys.insert(key).second)
                << "key listed twice in " << current << ": " << key;
        } else if (line.rfind("Routing key: ", 0) == 0) {
            section.routingKey = FirstBackticked(line, 0);
        }
    }
    flush();
    return sections;
}

// ---- The classes as they write ----

// The request that the responses answer; its reply queue stands for the
// caller's own, as the reference writes it.
class AnyRequest : public RequestMessage {
public:
    AnyRequest() : RequestMessage("AnyRequest", "application/json", "Somewhere") {
        SetReplyTo("{ReplyTo}");
    }
    MessageBody Serialize() const override { return MessageBody("{}"); }
};

struct Written {
    std::string body;
    std::string routingKey;
};

template <typename Message>
Written WrittenOf(const Message& message) {
    return {message.Serialize().ToString(), message.RoutingKey()};
}

// One step into a parsed body: a member of an object, or the first element
// of an array.
const JsonVariant* Step(const JsonVariant* at, const std::string& key) {
    if (at == nullptr) return nullptr;
    if (key == "[0]") return at->IsArray() && at->Size() > 0 ? &at->Elements()[0] : nullptr;
    return at->IsObject() ? at->Find(key) : nullptr;
}

// The keys of the object at `path` in the body.
KeySet KeysAt(const std::string& body, const std::vector<std::string>& path) {
    JsonVariant root;
    EXPECT_TRUE(Parse(root, body)) << body;
    const JsonVariant* at = &root;
    for (const auto& key : path) at = Step(at, key);
    EXPECT_TRUE(at != nullptr && at->IsObject()) << "no object along the path in " << body;
    KeySet keys;
    if (at != nullptr && at->IsObject()) {
        for (const auto& member : at->Members()) keys.insert(std::string(member.key.View()));
    }
    return keys;
}

struct Documented {
    std::function<Written()> write;
    std::vector<std::string> path;  // empty for a message; into its body for a record
    bool isMessage;
};

std::map<std::string, Documented> KnownSections() {
    static const AnyRequest request;
    const TagPathUpdates pathUpdates{std::string("a.b"), std::vector<TagValueSample>{SampleSample()}};
    const TagAggregatedUpdates aggregated{std::string("a.b"),
                                          std::vector<TagValueUpdate>{SampleUpdate()}};
    const TagUpdateSet updateSet{SampleRecord(), std::vector<TagValueUpdate>{SampleUpdate()}};
    const TagCurrentValue current{std::string("a.b"), SampleSample(), SampleAggregates()};
    const TagChange change{SampleRecord(), TagChangeFlags::Keywords | TagChangeFlags::Properties};
    const JsonStringList paths{"a.b"};

    const auto message = [](std::function<Written()> write) {
        return Documented{std::move(write), {}, true};
    };
    const auto record = [](std::function<Written()> write, std::vector<std::string> path) {
        return Documented{std::move(write), std::move(path), false};
    };
    const auto updateValues = [=] {
        return WrittenOf(TagUpdateValuesRoutedMessage(std::vector<TagPathUpdates>{pathUpdates}));
    };
    const auto ingested = [=] {
        return WrittenOf(TagNewTagsIngestedBroadcast(std::vector<TagUpdateSet>{updateSet}));
    };
    const auto currentValues = [=] {
        return WrittenOf(
            TagCvQueryCurrentValuesByPathResponse(request, std::vector<TagCurrentValue>{current}));
    };
    const auto createOrUpdate = [=] {
        return WrittenOf(TagInfoCreateOrUpdateTagsRequest(std::vector<TagChange>{change}, true));
    };
    const auto createOrUpdateResponse = [] {
        return WrittenOf(TagInfoCreateOrUpdateTagsResponse(request, SampleError()));
    };
    const auto createTag = [] { return WrittenOf(TagInfoCreateTagRoutedMessage(SampleRecord())); };

    return {
        // TagIngestion
        {"TagUpdateValuesRoutedMessage", message(updateValues)},
        {"TagNewTagsIngestedBroadcast", message(ingested)},
        {"TagNewJournalsWrittenBroadcast",
         message([=] { return WrittenOf(TagNewJournalsWrittenBroadcast(paths)); })},
        // TagCurrentValue
        {"TagCvQueryCurrentValuesByPathRequest",
         message([=] { return WrittenOf(TagCvQueryCurrentValuesByPathRequest(paths, true)); })},
        {"TagCvQueryCurrentValuesByPathResponse", message(currentValues)},
        {"TagCvResetAggregatesRoutedMessage",
         message([=] { return WrittenOf(TagCvResetAggregatesRoutedMessage(paths)); })},
        {"TagCvAggregatesResetBroadcast", message([=] {
             return WrittenOf(
                 TagCvAggregatesResetBroadcast(std::vector<TagAggregatedUpdates>{aggregated}));
         })},
        // TagInfo
        {"TagInfoQueryTagsRequest", message([] {
             return WrittenOf(TagInfoQueryTagsRequest(JsonStringList{"a.*"},
                                                      JsonStringMap{{"k", "v"}},
                                                      JsonStringList{"k1"}, 0, 100, true));
         })},
        {"TagInfoQueryTagsResponse", message([] {
             return WrittenOf(TagInfoQueryTagsResponse(request, std::vector{SampleRecord()}, 1));
         })},
        {"TagInfoCreateOrUpdateTagsRequest", message(createOrUpdate)},
        {"TagInfoCreateOrUpdateTagsResponse", message(createOrUpdateResponse)},
        {"TagInfoCreateTagRoutedMessage", message(createTag)},
        {"TagInfoUpdateTagRoutedMessage", message([] {
             return WrittenOf(TagInfoUpdateTagRoutedMessage(
                 std::string("a.b"), JsonStringList{"k"}, JsonStringMap{{"unit", "m/s"}},
                 CollectAggregatesChange::Enable, true));
         })},
        {"TagInfoDeleteTagsRoutedMessage",
         message([=] { return WrittenOf(TagInfoDeleteTagsRoutedMessage(paths)); })},
        {"TagInfoDeletedTagsBroadcast",
         message([=] { return WrittenOf(TagInfoDeletedTagsBroadcast(paths)); })},
        {"TagInfoTagMetadataUpdatedBroadcast",
         message([] { return WrittenOf(TagInfoTagMetadataUpdatedBroadcast(SampleRecord())); })},
        // The reply to a routed message that asks for one.
        {"GenericResponse", message([] { return WrittenOf(GenericResponse(request)); })},
        // The records, each found inside a message that carries it.
        {"TagRecord", record(createTag, {"newTag"})},
        {"TagValue", record(updateValues, {"updates", "[0]", "updates", "[0]", "value"})},
        {"TagValueSample", record(updateValues, {"updates", "[0]", "updates", "[0]"})},
        {"TagPathUpdates", record(updateValues, {"updates", "[0]"})},
        {"TagAggregates", record(currentValues, {"values", "[0]", "aggregates"})},
        {"TagCurrentValue", record(currentValues, {"values", "[0]"})},
        {"TagValueUpdate", record(ingested, {"updates", "[0]", "updates", "[0]"})},
        {"TagUpdateSet", record(ingested, {"updates", "[0]"})},
        {"TagAggregatedUpdates", record([=] {
             return WrittenOf(
                 TagCvAggregatesResetBroadcast(std::vector<TagAggregatedUpdates>{aggregated}));
         }, {"updates", "[0]"})},
        {"TagChange", record(createOrUpdate, {"tags", "[0]"})},
        {"ErrorRecord", record(createOrUpdateResponse, {"errors"})},
    };
}

TEST(WireReference, EveryDocumentedKeySetIsTheOneTheClassWrites) {
    const auto sections = ReadReference();
    for (const auto& [name, documented] : KnownSections()) {
        SCOPED_TRACE(name);
        const auto found = sections.find(name);
        if (found == sections.end()) {
            ADD_FAILURE() << "docs/wire-reference.md has no key table under \"### " << name
                          << "\"";
            continue;
        }
        const Written written = documented.write();
        EXPECT_EQ(found->second.keys, KeysAt(written.body, documented.path))
            << "written body: " << written.body;
    }
}

TEST(WireReference, EveryDocumentedRoutingKeyIsTheOneTheClassUses) {
    const auto sections = ReadReference();
    for (const auto& [name, documented] : KnownSections()) {
        SCOPED_TRACE(name);
        if (!documented.isMessage) continue;
        const auto found = sections.find(name);
        if (found == sections.end()) continue;  // reported by the key test
        EXPECT_EQ(found->second.routingKey, documented.write().routingKey);
    }
}

TEST(WireReference, EveryExampleBodyHasTheKeysOfItsTable) {
    for (const auto& [name, section] : ReadReference()) {
        SCOPED_TRACE(name);
        if (section.keys.empty()) continue;
        EXPECT_FALSE(section.example.empty()) << "no ```json example";
        if (!section.example.empty()) {
            EXPECT_EQ(section.keys, KeysAt(section.example, {}));
        }
    }
}

TEST(WireReference, EveryDocumentedSectionIsChecked) {
    const auto known = KnownSections();
    for (const auto& [name, section] : ReadReference()) {
        EXPECT_EQ(known.count(name), 1u)
            << "\"### " << name << "\" has a key table that no class here checks";
    }
}

}  // namespace
}  // namespace Korvane::Veldra::MessageBus::Testing
