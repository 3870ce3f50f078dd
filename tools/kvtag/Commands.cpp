#include "Commands.h"

#include <kvveldra/TagConsole.h>

#include <cstdio>

#include "Failures.h"
#include "TagTypes.h"
#include "TimeText.h"
#include "ValueRules.h"

namespace kvtag {
namespace {

// Hands out times of samples that came without one: now, but always later
// than the last one handed out, so that the samples of one tag keep their
// order.
class SampleClock {
public:
    TagConsoleTime Next() {
        TagConsoleTime now = NowTime();
        if (now <= last_) now = last_ + std::chrono::microseconds(1);
        last_ = now;
        return now;
    }

private:
    TagConsoleTime last_ = TagConsoleTime::min();
};

std::string Quoted(const std::string& text) {
    return "'" + text + "'";
}

FoundTag RequireTag(const ConsoleInstance& instance, const std::string& path, OpenedTags& opened) {
    auto found = FindTag(instance, path, opened);
    if (!found) throw ToolError("no tag " + Quoted(path));
    return *found;
}

std::vector<FoundTag> RequireTags(const ConsoleInstance& instance,
                                  const std::vector<std::string>& paths, OpenedTags& opened) {
    std::vector<FoundTag> tags;
    for (const auto& path : paths) tags.push_back(RequireTag(instance, path, opened));
    return tags;
}

// The insert a refusal of the tags may lack: the path, when there is one tag.
std::vector<std::string> OnePath(const std::vector<FoundTag>& tags) {
    if (tags.size() != 1) return {};
    return {tags.front().path};
}

std::vector<uint32_t> References(const std::vector<FoundTag>& tags) {
    std::vector<uint32_t> references;
    for (const auto& tag : tags) references.push_back(tag.reference);
    return references;
}

// The tag a write goes to: found, or created with --type; --type must agree.
// `where` tells the line of --stdin in messages.
std::optional<FoundTag> WriteTarget(const ConsoleInstance& instance, const std::string& path,
                                    std::optional<int32_t> type, const std::string& where,
                                    OpenedTags& opened) {
    auto found = FindTag(instance, path, opened);
    if (!found && !type) {
        throw ToolError("no tag " + Quoted(path) + where + "; give --type to create it");
    }
    if (found && type && found->type != *type) {
        throw ToolError(Quoted(path) + where + " is a " + TypeName(found->type) + " tag, not " +
                        TypeName(*type));
    }
    return found;
}

std::string NormalizeOrThrow(int32_t type, const std::string& value, const std::string& where,
                             Command command) {
    auto text = NormalizeValue(type, value);
    if (!text) throw UsageError(where + ValueRefusal(type, value), command);
    return *text;
}

Rendered Write(const Invocation& call, const ConsoleInstance& instance, OpenedTags& opened) {
    const std::string& path = call.paths.front();
    auto target = WriteTarget(instance, path, call.type, "", opened);
    const int32_t type = target ? target->type : *call.type;
    const std::string value = NormalizeOrThrow(type, call.value, "", call.command);
    if (!target) target = CreateTag(instance, path, type, opened);
    const TagConsoleSamples samples{{value, call.time.value_or(NowTime())}};
    instance.Request("write " + path, {path}, [&](std::string& error) {
        return TagConsoleWriteTag(target->reference, type, &samples, instance.Verbose(), &error);
    });
    return RenderWrites({{path, type, 1}});
}

Rendered WriteBatches(const Invocation& call, const ConsoleInstance& instance,
                      const std::vector<TagBatch>& batches, OpenedTags& opened) {
    // Everything is looked up and checked before the first write.
    std::vector<std::optional<FoundTag>> targets;
    std::vector<TagConsoleSamples> samples(batches.size());
    SampleClock clock;
    for (std::size_t i = 0; i < batches.size(); ++i) {
        const TagBatch& batch = batches[i];
        const std::string where = " (line " + std::to_string(batch.lines.front().lineNumber) + ")";
        targets.push_back(WriteTarget(instance, batch.path, call.type, where, opened));
        const int32_t type = targets.back() ? targets.back()->type : *call.type;
        for (const auto& line : batch.lines) {
            const std::string prefix = "line " + std::to_string(line.lineNumber) + ": ";
            samples[i].push_back({NormalizeOrThrow(type, line.value, prefix, call.command),
                                  line.time ? *line.time : clock.Next()});
        }
    }
    for (std::size_t i = 0; i < batches.size(); ++i) {
        if (!targets[i]) targets[i] = CreateTag(instance, batches[i].path, *call.type, opened);
    }
    std::vector<WriteEntry> written;
    for (std::size_t i = 0; i < batches.size(); ++i) {
        const FoundTag& tag = *targets[i];
        const std::string operation = "write " + tag.path + " (" + std::to_string(written.size()) +
                                      " of " + std::to_string(batches.size()) +
                                      " tags written before)";
        instance.Request(operation, {tag.path}, [&](std::string& error) {
            return TagConsoleWriteTag(tag.reference, tag.type, &samples[i], instance.Verbose(),
                                      &error);
        });
        written.push_back({tag.path, tag.type, samples[i].size()});
    }
    return RenderWrites(written);
}

Rendered List(const Invocation& call, const ConsoleInstance& instance, OpenedTags& opened) {
    TagConsoleProperties properties;
    for (const auto& [key, value] : call.properties) properties[key] = value;
    const Listing listing = ListTags(instance, "list " + call.paths.front(), call.paths.front(),
                                     properties, call.keywords, call.skip, call.take, opened);
    ListReport report;
    report.total = listing.total;
    report.skip = call.skip;
    report.take = call.take;
    for (std::size_t i = 0; i < listing.paths.size(); ++i) {
        report.tags.push_back({listing.paths[i], listing.types[i]});
    }
    if (!call.global.json && report.tags.size() < listing.total) {
        std::fprintf(stderr, "kvtag: %zu of %u matching tags shown\n", report.tags.size(),
                     listing.total);
    }
    return RenderList(report);
}

// The service answers a read in its own order, possibly with fewer records,
// and gives no type for a tag never written: the records are put in the
// order of the tags asked for, one each, with the type the lookup gave when
// the record has none, and an empty record for a tag the answer left out.
std::vector<TagConsoleValue> InRequestOrder(const std::vector<FoundTag>& tags,
                                            std::vector<TagConsoleValue> records) {
    std::vector<bool> used(records.size(), false);
    std::vector<TagConsoleValue> ordered;
    for (const auto& tag : tags) {
        TagConsoleValue value;
        value.path = tag.path;
        value.timestamp = TagConsoleTime::min();
        for (std::size_t i = 0; i < records.size(); ++i) {
            if (!used[i] && records[i].path == tag.path) {
                used[i] = true;
                value = std::move(records[i]);
                break;
            }
        }
        if (value.dataType < 0 || value.dataType > 5) value.dataType = tag.type;
        ordered.push_back(std::move(value));
    }
    return ordered;
}

}  // namespace

std::vector<TagConsoleValue> ReadValues(const ConsoleInstance& instance,
                                        const std::vector<FoundTag>& tags) {
    const auto references = References(tags);
    std::vector<TagConsoleValue> values;
    instance.Request("read", OnePath(tags), [&](std::string& error) {
        return TagConsoleReadValues(instance.Id(), &references, instance.Verbose(), 0, &values,
                                    &error);
    });
    return InRequestOrder(tags, std::move(values));
}

namespace {

Rendered Keywords(const Invocation& call, const ConsoleInstance& instance, OpenedTags& opened) {
    const FoundTag tag = RequireTag(instance, call.paths.front(), opened);
    if (call.set) {
        instance.Request("set keywords of " + tag.path, {tag.path}, [&](std::string& error) {
            return TagConsoleSetKeywords(tag.reference, &call.keywords, instance.Verbose(), &error);
        });
    }
    std::vector<std::string> keywords;
    instance.Request("get keywords of " + tag.path, {tag.path}, [&](std::string& error) {
        return TagConsoleGetKeywords(tag.reference, instance.Verbose(), &keywords, &error);
    });
    return RenderKeywords(tag.path, keywords);
}

Rendered Properties(const Invocation& call, const ConsoleInstance& instance, OpenedTags& opened) {
    const FoundTag tag = RequireTag(instance, call.paths.front(), opened);
    if (call.set) {
        TagConsoleProperties properties;
        for (const auto& [key, value] : call.properties) properties[key] = value;
        instance.Request("set properties of " + tag.path, {tag.path}, [&](std::string& error) {
            return TagConsoleSetProperties(tag.reference, &properties, instance.Verbose(), &error);
        });
    }
    TagConsoleProperties properties;
    instance.Request("get properties of " + tag.path, {tag.path}, [&](std::string& error) {
        return TagConsoleGetProperties(tag.reference, instance.Verbose(), &properties, &error);
    });
    return RenderProperties(tag.path, {properties.begin(), properties.end()});
}

Rendered Aggregates(const Invocation& call, const ConsoleInstance& instance, OpenedTags& opened) {
    const FoundTag tag = RequireTag(instance, call.paths.front(), opened);
    if (call.collect) {
        instance.Request("switch aggregates of " + tag.path, {tag.path}, [&](std::string& error) {
            return TagConsoleSetCollectAggregates(tag.reference, *call.collect, instance.Verbose(),
                                                  &error);
        });
    }
    if (call.reset) {
        const std::vector<uint32_t> references{tag.reference};
        instance.Request("reset aggregates of " + tag.path, {tag.path}, [&](std::string& error) {
            return TagConsoleResetAggregates(instance.Id(), &references, instance.Verbose(),
                                             &error);
        });
    }
    AggregatesReport report;
    report.path = tag.path;
    report.type = tag.type;
    instance.Request("get aggregates of " + tag.path, {tag.path}, [&](std::string& error) {
        return TagConsoleGetCollectAggregates(tag.reference, instance.Verbose(), &report.collect,
                                              &error);
    });
    const auto values = ReadValues(instance, {tag});
    if (!values.empty()) report.value = values.front();
    return RenderAggregates(report);
}

Rendered Create(const Invocation& call, const ConsoleInstance& instance, OpenedTags& opened) {
    const std::string& path = call.paths.front();
    if (const auto found = FindTag(instance, path, opened)) {
        throw ToolError(Quoted(path) + " exists already (" + TypeName(found->type) + ")");
    }
    const FoundTag tag = CreateTag(instance, path, *call.type, opened);
    return RenderCreated({tag.path, tag.type});
}

Rendered Delete(const Invocation& call, const ConsoleInstance& instance, OpenedTags& opened) {
    const auto tags = RequireTags(instance, call.paths, opened);
    const auto references = References(tags);
    instance.Request("delete", OnePath(tags), [&](std::string& error) {
        return TagConsoleDeleteTag(instance.Id(), &references, instance.Verbose(), &error);
    });
    return RenderDeleted(call.paths);
}

}  // namespace

void CheckBeforeSending(const Invocation& call, const std::vector<TagBatch>& batches) {
    if (call.command != Command::Write || !call.type) return;
    if (!call.fromStdin) {
        NormalizeOrThrow(*call.type, call.value, "", call.command);
        return;
    }
    // --type must agree with every tag, so every line can be checked now.
    for (const auto& batch : batches) {
        for (const auto& line : batch.lines) {
            NormalizeOrThrow(*call.type, line.value,
                             "line " + std::to_string(line.lineNumber) + ": ", call.command);
        }
    }
}

Rendered RunCommand(const Invocation& call, const ConsoleInstance& instance,
                    const std::vector<TagBatch>& batches) {
    OpenedTags opened(instance.Verbose());
    switch (call.command) {
        case Command::List:
            return List(call, instance, opened);
        case Command::Read: {
            const auto tags = RequireTags(instance, call.paths, opened);
            return RenderValues(ReadValues(instance, tags));
        }
        case Command::Write:
            return call.fromStdin ? WriteBatches(call, instance, batches, opened)
                                  : Write(call, instance, opened);
        case Command::Create:
            return Create(call, instance, opened);
        case Command::Keywords:
            return Keywords(call, instance, opened);
        case Command::Properties:
            return Properties(call, instance, opened);
        case Command::Aggregates:
            return Aggregates(call, instance, opened);
        case Command::Delete:
            return Delete(call, instance, opened);
        case Command::Help:
        case Command::Serve:
            break;
    }
    return {};
}

}  // namespace kvtag
