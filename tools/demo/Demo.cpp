// The library's main job through its blocking console functions alone:
// open (creating) tags of several types, write values with their times, read
// them back with aggregates, list with a wildcard and a page, set and read
// keywords and properties, reset aggregates, delete, close. Each step prints
// its status; the program fails when a status is not the expected one.
#include <cstdio>
#include <ctime>
#include <string>
#include <vector>

#include "kvveldra/TagConsole.h"

namespace {

int gUnexpected = 0;

void Show(const std::string& step, int32_t status, const std::string& error,
          int32_t expected = 0) {
    std::printf("%-52s status %-8d %s\n", step.c_str(), status, status == 0 ? "" : error.c_str());
    if (status != expected) {
        ++gUnexpected;
        std::printf("  expected status %d\n", expected);
    }
}

// "YYYY-MM-DDThh:mm:ss.ffffffZ".
std::string TimeText(TagConsoleTime time) {
    if (time == TagConsoleTime::min() || time == TagConsoleTime::max()) return "(no time)";
    const long long micros = time.time_since_epoch().count();
    const long long fraction = ((micros % 1000000) + 1000000) % 1000000;
    const std::time_t seconds = static_cast<std::time_t>((micros - fraction) / 1000000);
    std::tm parts{};
    gmtime_r(&seconds, &parts);
    char text[96];
    std::snprintf(text, sizeof text, "%04d-%02d-%02dT%02d:%02d:%02d.%06lldZ", parts.tm_year + 1900,
                  parts.tm_mon + 1, parts.tm_mday, parts.tm_hour, parts.tm_min, parts.tm_sec,
                  fraction);
    return text;
}

TagConsoleTime Now() {
    return std::chrono::time_point_cast<std::chrono::microseconds>(
        std::chrono::system_clock::now());
}

struct DemoTag {
    const char* path;
    int32_t type;
    std::vector<std::string> values;
    uint32_t reference = 0;
};

std::string Join(const std::vector<std::string>& texts) {
    std::string joined;
    for (const auto& text : texts) joined += (joined.empty() ? "" : ", ") + text;
    return joined;
}

}  // namespace

int main() {
    bool reserved = false;
    std::string error;
    Show("TagConsoleReserve", TagConsoleReserve(&reserved), "");
    Show("TagConsoleInitialize(0)", TagConsoleInitialize(0, nullptr, nullptr, nullptr, &error),
         error);

    std::vector<DemoTag> tags{
        {"demo.line1.flow", 0, {"12.5", "13.25", "11.75"}},
        {"demo.line1.batches", 1, {"41", "42"}},
        {"demo.line1.operator", 2, {"Ana \"night shift\""}},
        {"demo.line1.running", 3, {"True"}},
        {"demo.line1.bytes", 4, {"18446744073709551615"}},
        {"demo.line1.serviced", 5, {"2026-03-01T08:30:00.250000Z"}},
    };
    for (auto& tag : tags) {
        const std::string path = tag.path;
        Show("TagConsoleOpen(" + path + ")",
             TagConsoleOpen(0, &path, tag.type, false, &tag.reference, &error), error);
    }
    DemoTag& flow = tags[0];
    Show("TagConsoleSetCollectAggregates(flow, true)",
         TagConsoleSetCollectAggregates(flow.reference, true, false, &error), error);
    Show("TagConsoleSetCollectAggregates(operator, true)",
         TagConsoleSetCollectAggregates(tags[2].reference, true, false, &error), error, -251908);
    std::printf("  %s\n", error.c_str());

    // One write per tag, its samples a millisecond apart.
    for (const auto& tag : tags) {
        TagConsoleSamples samples;
        const TagConsoleTime start = Now();
        for (std::size_t i = 0; i < tag.values.size(); ++i) {
            samples.push_back({tag.values[i], start + std::chrono::milliseconds(i)});
        }
        Show(std::string("TagConsoleWriteTag(") + tag.path + ", " + Join(tag.values) + ")",
             TagConsoleWriteTag(tag.reference, tag.type, &samples, false, &error), error);
    }

    std::vector<uint32_t> references;
    for (const auto& tag : tags) references.push_back(tag.reference);
    std::vector<TagConsoleValue> values;
    Show("TagConsoleReadValues(all six)",
         TagConsoleReadValues(0, &references, false, 0, &values, &error), error);
    for (const auto& value : values) {
        std::printf("  %-22s type %d  %-24s at %s", value.path.c_str(), value.dataType,
                    value.value.c_str(), TimeText(value.timestamp).c_str());
        if (value.aggregateCount > 0) {
            std::printf("  (count %d, average %g, min %s, max %s)", value.aggregateCount,
                        value.aggregateAverage, value.aggregateMinimum.c_str(),
                        value.aggregateMaximum.c_str());
        }
        std::printf("\n");
    }

    // A page of four: each listed tag is open once more and is closed here.
    const std::vector<std::string> search{"demo.line1.*"};
    const TagConsoleProperties noProperties;
    const std::vector<std::string> noKeywords;
    std::vector<int32_t> types;
    std::vector<std::string> paths;
    std::vector<uint32_t> listed;
    uint32_t total = 0;
    Show("TagConsoleListTag(demo.line1.*, skip 0, take 4)",
         TagConsoleListTag(0, &search, &noProperties, &noKeywords, 0, 4, true, false, &types,
                           &paths, &listed, &total, &error),
         error);
    std::printf("  %zu of %u: ", paths.size(), total);
    for (std::size_t i = 0; i < paths.size(); ++i) std::printf("%s(type %d) ", paths[i].c_str(), types[i]);
    std::printf("\n");
    for (const uint32_t reference : listed) TagConsoleClose(reference, false, &error);

    const std::vector<std::string> keywords{"line1", "flow", "metered"};
    const TagConsoleProperties properties{{"unit", "m3/h"}, {"site", "North"}};
    Show("TagConsoleSetKeywords(flow)",
         TagConsoleSetKeywords(flow.reference, &keywords, false, &error), error);
    Show("TagConsoleSetProperties(flow)",
         TagConsoleSetProperties(flow.reference, &properties, false, &error), error);
    std::vector<std::string> readKeywords;
    TagConsoleProperties readProperties;
    Show("TagConsoleGetKeywords(flow)",
         TagConsoleGetKeywords(flow.reference, false, &readKeywords, &error), error);
    std::printf("  %s\n", Join(readKeywords).c_str());
    Show("TagConsoleGetProperties(flow)",
         TagConsoleGetProperties(flow.reference, false, &readProperties, &error), error);
    for (const auto& [key, value] : readProperties) std::printf("  %s = %s\n", key.c_str(), value.c_str());

    const std::vector<uint32_t> flowOnly{flow.reference};
    Show("TagConsoleResetAggregates(flow)",
         TagConsoleResetAggregates(0, &flowOnly, false, &error), error);
    values.clear();
    Show("TagConsoleReadValues(flow)", TagConsoleReadValues(0, &flowOnly, false, 0, &values, &error),
         error);
    if (!values.empty()) std::printf("  aggregate count after reset: %d\n", values.front().aggregateCount);

    const std::vector<uint32_t> serviced{tags[5].reference};
    Show("TagConsoleDeleteTag(serviced)", TagConsoleDeleteTag(0, &serviced, false, &error), error);
    readKeywords.clear();
    Show("TagConsoleGetKeywords(serviced) after delete",
         TagConsoleGetKeywords(tags[5].reference, false, &readKeywords, &error), error, -251909);
    std::printf("  %s\n", error.c_str());
    std::string path;
    Show("TagConsoleGetPath(serviced) still answers",
         TagConsoleGetPath(tags[5].reference, false, &path, &error), error);

    for (const auto& tag : tags) {
        Show(std::string("TagConsoleClose(") + tag.path + ")",
             TagConsoleClose(tag.reference, false, &error), error);
    }
    Show("TagConsoleUnreserve", TagConsoleUnreserve(&reserved), "");

    std::printf(gUnexpected == 0 ? "demo finished as expected\n" : "demo: %d unexpected\n",
                gUnexpected);
    return gUnexpected == 0 ? 0 : 1;
}
