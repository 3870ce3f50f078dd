// Parsing and writing of realistic message bodies with the library's JSON code
// and, on the same bytes, with RapidJSON (DOM parse, Writer).
//
// simdjson's DOM parser, when Debian's libsimdjson-dev is there, gives context
// rows: where the library stands against the fastest parser people know.
//
// Bodies:
//   query  - a query response of 10,000 tag records: path, type, a value
//            record with its time, keywords, properties and aggregates.
//   update - an update of 10,000 samples: path, one sample with time, type
//            and value text.

#include <benchmark/benchmark.h>
#include <malloc.h>

#include <cstdio>
#include <cstdlib>
#include <optional>
#include <string>
#include <vector>

#include "messagelibrary/json/JsonParser.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonVariant.h"
#include "messagelibrary/json/JsonWriters.h"
#include "messagelibrary/json/Timestamp.h"
#include "rapidjson/document.h"
#include "rapidjson/stringbuffer.h"
#include "rapidjson/writer.h"
#include "support/PairedTiming.h"
#include "support/Ratios.h"

#ifdef KVVELDRA_HAVE_SIMDJSON
#include <simdjson.h>
#endif

namespace Korvane::Veldra::VeldraMessageLibrary::Bench {

// ---- The records, declared the way message families declare theirs ----------
// (each names its fields once, for the writer and the reader)

enum class DataType : int32_t { None = 0, Double = 1, Int = 2, String = 3, Boolean = 4 };
constexpr JsonEnumText kDataTypeTexts[] = {
    {0, "NONE"}, {1, "DOUBLE"}, {2, "INT"}, {3, "STRING"}, {4, "BOOLEAN"}};
inline JsonEnumTexts JsonEnumTextsOf(DataType) {
    return kDataTypeTexts;
}

struct Value {
    Timestamp timestamp;
    std::optional<DataType> type;
    std::optional<std::string> value;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("timestamp", self.timestamp)
            .Field("type", self.type)
            .Field("value", self.value);
    }
};

struct Aggregates {
    int32_t count = 0;
    double avg = 0.0;
    std::optional<std::string> min;
    std::optional<std::string> max;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("count", self.count)
            .Field("avg", self.avg)
            .Field("min", self.min)
            .Field("max", self.max);
    }
};

struct Tag {
    std::optional<std::string> path;
    std::optional<DataType> type;
    std::optional<Value> current;
    std::optional<JsonStringList> keywords;
    std::optional<JsonStringMap> properties;
    std::optional<Aggregates> aggregates;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("path", self.path)
            .Field("type", self.type)
            .Field("current", self.current)
            .Field("keywords", self.keywords)
            .Field("properties", self.properties)
            .Field("aggregates", self.aggregates);
    }
};

struct QueryResponse {
    std::optional<std::vector<Tag>> tags;
    int32_t totalCount = 0;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("tags", self.tags).Field("totalCount", self.totalCount);
    }
};

struct Sample {
    std::optional<std::string> path;
    std::optional<Value> value;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("path", self.path).Field("value", self.value);
    }
};

struct Update {
    std::optional<std::vector<Sample>> updates;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("updates", self.updates);
    }
};

// A message's Serialize() and parsing constructor, over the same field lists.
template <typename Message>
std::string Serialize(const Message& m) {
    JsonBodyWriter writer;
    Message::JsonFields(m, writer);
    return writer.Finish();
}
template <typename Message>
void Deserialize(const std::string& body, Message& m) {
    const JsonVariant json = ParseJsonBody(body, "BenchMessage");
    const JsonBodyReader reader(json);
    Message::JsonFields(m, reader);
}

// ---- Test data -----------------------------------------------------------------

constexpr int kRecords = 10000;

Timestamp TimeOf(int i) {
    return TimestampFromUnixSeconds(1456833600 + i) +
           boost::posix_time::microseconds(i * 37 % 1000000);
}

std::string PathOf(int i) {
    char path[64];
    std::snprintf(path, sizeof(path), "Plant%d.Area%d.Line%d.Sensor%05d", i % 3, i % 17, i % 5, i);
    return path;
}

QueryResponse MakeQuery() {
    QueryResponse m;
    m.tags.emplace();
    m.tags->reserve(kRecords);
    for (int i = 0; i < kRecords; ++i) {
        Tag t;
        t.path = PathOf(i);
        t.type = DataType::Double;
        t.current = Value{TimeOf(i), DataType::Double, std::to_string(i * 0.25)};
        t.keywords = JsonStringList{"temperature", i % 2 ? "critical" : "normal", "line \"A\""};
        t.properties =
            JsonStringMap{{"units", "degC"}, {"location", "Hall 7/North"}, {"owner", "ops\tteam"}};
        t.aggregates = Aggregates{i % 1000, i + 0.125, std::to_string(i), std::to_string(i + 10)};
        m.tags->push_back(std::move(t));
    }
    m.totalCount = kRecords;
    return m;
}

Update MakeUpdate() {
    Update m;
    m.updates.emplace();
    m.updates->reserve(kRecords);
    for (int i = 0; i < kRecords; ++i) {
        m.updates->push_back(
            Sample{PathOf(i), Value{TimeOf(i), DataType::Double, std::to_string(i * 1.5)}});
    }
    return m;
}

const QueryResponse& Query() {
    static const QueryResponse query = MakeQuery();
    return query;
}
const Update& Updates() {
    static const Update update = MakeUpdate();
    return update;
}
const std::string& QueryBody() {
    static const std::string body = Serialize(Query());
    return body;
}
const std::string& UpdateBody() {
    static const std::string body = Serialize(Updates());
    return body;
}

// ---- RapidJSON writers of the same records ---------------------------------------

using RapidWriter = rapidjson::Writer<rapidjson::StringBuffer>;

void RapidString(RapidWriter& w, const std::optional<std::string>& s) {
    if (s) {
        w.String(s->data(), static_cast<rapidjson::SizeType>(s->size()));
    } else {
        w.Null();
    }
}
void RapidType(RapidWriter& w, const std::optional<DataType>& t) {
    if (!t) {
        w.Null();
        return;
    }
    const char* text = JsonEnumTextsOf(*t).TextOf(static_cast<int32_t>(*t));
    w.String(text ? text : "");
}
void RapidValue(RapidWriter& w, const Value& v) {
    std::string time;
    AppendTimestampText(v.timestamp, time);
    w.StartObject();
    w.Key("timestamp");
    w.String(time.data(), static_cast<rapidjson::SizeType>(time.size()));
    w.Key("type");
    RapidType(w, v.type);
    w.Key("value");
    RapidString(w, v.value);
    w.EndObject();
}
void RapidTag(RapidWriter& w, const Tag& t) {
    w.StartObject();
    w.Key("path");
    RapidString(w, t.path);
    w.Key("type");
    RapidType(w, t.type);
    w.Key("current");
    RapidValue(w, *t.current);
    w.Key("keywords");
    w.StartArray();
    for (const std::string& k : *t.keywords)
        w.String(k.data(), static_cast<rapidjson::SizeType>(k.size()));
    w.EndArray();
    w.Key("properties");
    w.StartObject();
    for (const auto& [key, value] : *t.properties) {
        w.Key(key.data(), static_cast<rapidjson::SizeType>(key.size()));
        w.String(value.data(), static_cast<rapidjson::SizeType>(value.size()));
    }
    w.EndObject();
    w.Key("aggregates");
    w.StartObject();
    w.Key("count");
    w.Int(t.aggregates->count);
    w.Key("avg");
    w.Double(t.aggregates->avg);
    w.Key("min");
    RapidString(w, t.aggregates->min);
    w.Key("max");
    RapidString(w, t.aggregates->max);
    w.EndObject();
    w.EndObject();
}
std::string RapidSerialize(const QueryResponse& m) {
    rapidjson::StringBuffer buffer;
    RapidWriter w(buffer);
    w.StartObject();
    w.Key("tags");
    w.StartArray();
    for (const Tag& t : *m.tags) RapidTag(w, t);
    w.EndArray();
    w.Key("totalCount");
    w.Int(m.totalCount);
    w.EndObject();
    return std::string(buffer.GetString(), buffer.GetSize());
}
std::string RapidSerialize(const Update& m) {
    rapidjson::StringBuffer buffer;
    RapidWriter w(buffer);
    w.StartObject();
    w.Key("updates");
    w.StartArray();
    for (const Sample& s : *m.updates) {
        w.StartObject();
        w.Key("path");
        RapidString(w, s.path);
        w.Key("value");
        RapidValue(w, *s.value);
        w.EndObject();
    }
    w.EndArray();
    w.EndObject();
    return std::string(buffer.GetString(), buffer.GetSize());
}

// Both writers must give the same bytes, or the comparison means nothing.
void CheckSameBytes(benchmark::State& state, const std::string& ours, const std::string& theirs) {
    if (ours != theirs) state.SkipWithError("the two writers disagree on the bytes");
}

// ---- Benchmarks ------------------------------------------------------------------

template <const std::string& (*Body)()>
void ParseTree(benchmark::State& state) {
    const std::string& body = Body();
    for (auto _ : state) {
        JsonVariant json;
        if (!Parse(json, body)) state.SkipWithError("parse failed");
        benchmark::DoNotOptimize(json);
    }
    state.SetBytesProcessed(static_cast<int64_t>(state.iterations() * body.size()));
}

template <const std::string& (*Body)()>
void RapidParseTree(benchmark::State& state) {
    const std::string& body = Body();
    for (auto _ : state) {
        rapidjson::Document document;
        document.Parse(body.c_str(), body.size());
        if (document.HasParseError()) state.SkipWithError("parse failed");
        benchmark::DoNotOptimize(document);
    }
    state.SetBytesProcessed(static_cast<int64_t>(state.iterations() * body.size()));
}

// ---- Paired runs: the ratios come from these --------------------------------------

using Korvane::Veldra::Bench::RunPaired;

void ParseWithLibrary(const std::string& body) {
    JsonVariant json;
    if (!Parse(json, body)) std::abort();
    benchmark::DoNotOptimize(json);
}
void ParseWithRapidJson(const std::string& body) {
    rapidjson::Document document;
    document.Parse(body.c_str(), body.size());
    if (document.HasParseError()) std::abort();
    benchmark::DoNotOptimize(document);
}

template <const std::string& (*Body)()>
void PairedParse(benchmark::State& state) {
    const std::string& body = Body();
    RunPaired(state, [&] { ParseWithLibrary(body); }, [&] { ParseWithRapidJson(body); });
}

template <typename Message, const std::string& (*Body)()>
void PairedParseAndRead(benchmark::State& state) {
    const std::string& body = Body();
    RunPaired(
        state,
        [&] {
            Message message;
            Deserialize(body, message);
            benchmark::DoNotOptimize(message);
        },
        [&] { ParseWithRapidJson(body); });
}

template <typename Message, const Message& (*Data)()>
void PairedWrite(benchmark::State& state) {
    const Message& message = Data();
    CheckSameBytes(state, Serialize(message), RapidSerialize(message));
    RunPaired(
        state, [&] { benchmark::DoNotOptimize(Serialize(message)); },
        [&] { benchmark::DoNotOptimize(RapidSerialize(message)); });
}

#ifdef KVVELDRA_HAVE_SIMDJSON
// simdjson as it is meant to be used: one parser, whose buffers are kept from
// one document to the next, and the body padded once.
template <const std::string& (*Body)()>
void SimdjsonParseTree(benchmark::State& state) {
    const std::string& body = Body();
    const simdjson::padded_string padded(body);
    simdjson::dom::parser parser;
    for (auto _ : state) {
        simdjson::dom::element document;
        if (parser.parse(padded).get(document) != simdjson::SUCCESS) {
            state.SkipWithError("parse failed");
        }
        benchmark::DoNotOptimize(document);
    }
    state.SetBytesProcessed(static_cast<int64_t>(state.iterations() * body.size()));
}

template <const std::string& (*Body)()>
void PairedParseSimdjson(benchmark::State& state) {
    const std::string& body = Body();
    const simdjson::padded_string padded(body);
    simdjson::dom::parser parser;
    RunPaired(
        state, [&] { ParseWithLibrary(body); },
        [&] {
            simdjson::dom::element document;
            if (parser.parse(padded).get(document) != simdjson::SUCCESS) std::abort();
            benchmark::DoNotOptimize(document);
        });
}
#endif

template <typename Message, const std::string& (*Body)()>
void ParseMessage(benchmark::State& state) {
    const std::string& body = Body();
    for (auto _ : state) {
        Message message;
        Deserialize(body, message);
        benchmark::DoNotOptimize(message);
    }
    state.SetBytesProcessed(static_cast<int64_t>(state.iterations() * body.size()));
}

template <typename Message, const Message& (*Data)()>
void WriteMessage(benchmark::State& state) {
    const Message& message = Data();
    CheckSameBytes(state, Serialize(message), RapidSerialize(message));
    std::size_t bytes = 0;
    for (auto _ : state) {
        const std::string body = Serialize(message);
        bytes = body.size();
        benchmark::DoNotOptimize(body.data());
    }
    state.SetBytesProcessed(static_cast<int64_t>(state.iterations() * bytes));
}

template <typename Message, const Message& (*Data)()>
void RapidWriteMessage(benchmark::State& state) {
    const Message& message = Data();
    std::size_t bytes = 0;
    for (auto _ : state) {
        const std::string body = RapidSerialize(message);
        bytes = body.size();
        benchmark::DoNotOptimize(body.data());
    }
    state.SetBytesProcessed(static_cast<int64_t>(state.iterations() * bytes));
}

BENCHMARK(ParseTree<QueryBody>)->Name("Query/Parse/Library")->Unit(benchmark::kMillisecond);
BENCHMARK(RapidParseTree<QueryBody>)->Name("Query/Parse/RapidJSON")->Unit(benchmark::kMillisecond);
BENCHMARK(ParseMessage<QueryResponse, QueryBody>)
    ->Name("Query/ParseAndRead/Library")
    ->Unit(benchmark::kMillisecond);
BENCHMARK(WriteMessage<QueryResponse, Query>)
    ->Name("Query/Write/Library")
    ->Unit(benchmark::kMillisecond);
BENCHMARK(RapidWriteMessage<QueryResponse, Query>)
    ->Name("Query/Write/RapidJSON")
    ->Unit(benchmark::kMillisecond);

BENCHMARK(ParseTree<UpdateBody>)->Name("Update/Parse/Library")->Unit(benchmark::kMillisecond);
BENCHMARK(RapidParseTree<UpdateBody>)
    ->Name("Update/Parse/RapidJSON")
    ->Unit(benchmark::kMillisecond);
BENCHMARK(ParseMessage<Update, UpdateBody>)
    ->Name("Update/ParseAndRead/Library")
    ->Unit(benchmark::kMillisecond);
BENCHMARK(WriteMessage<Update, Updates>)
    ->Name("Update/Write/Library")
    ->Unit(benchmark::kMillisecond);
BENCHMARK(RapidWriteMessage<Update, Updates>)
    ->Name("Update/Write/RapidJSON")
    ->Unit(benchmark::kMillisecond);

// The pairs run longer than the single rows: their ratios are the results.
#define KVVELDRA_PAIRED(function, name) \
    BENCHMARK(function)->Name(name)->Unit(benchmark::kMillisecond)->MinTime(2.0)
KVVELDRA_PAIRED((PairedParse<QueryBody>), "Query/Paired/Parse");
KVVELDRA_PAIRED((PairedParseAndRead<QueryResponse, QueryBody>), "Query/Paired/ParseAndRead");
KVVELDRA_PAIRED((PairedWrite<QueryResponse, Query>), "Query/Paired/Write");
KVVELDRA_PAIRED((PairedParse<UpdateBody>), "Update/Paired/Parse");
KVVELDRA_PAIRED((PairedParseAndRead<Update, UpdateBody>), "Update/Paired/ParseAndRead");
KVVELDRA_PAIRED((PairedWrite<Update, Updates>), "Update/Paired/Write");

#ifdef KVVELDRA_HAVE_SIMDJSON
KVVELDRA_PAIRED((PairedParseSimdjson<QueryBody>), "Query/Paired/ParseSimdjson");
KVVELDRA_PAIRED((PairedParseSimdjson<UpdateBody>), "Update/Paired/ParseSimdjson");
BENCHMARK(SimdjsonParseTree<QueryBody>)
    ->Name("Query/Parse/simdjson")
    ->Unit(benchmark::kMillisecond);
BENCHMARK(SimdjsonParseTree<UpdateBody>)
    ->Name("Update/Parse/simdjson")
    ->Unit(benchmark::kMillisecond);
#endif

}  // namespace Korvane::Veldra::VeldraMessageLibrary::Bench

namespace {

using Korvane::Veldra::Bench::PrintRatio;
using Korvane::Veldra::Bench::RatioFigures;

// How much faster ours is than theirs in a paired run: theirs' time over ours
// (the median when the run was repeated).
double PairedRatio(const RatioFigures& figures, const std::string& run) {
    const std::string median = run + "_median";
    const std::string& name = figures.Get(median, "ours_ns") > 0 ? median : run;
    const double ours = figures.Get(name, "ours_ns");
    return ours > 0 ? figures.Get(name, "theirs_ns") / ours : 0;
}

}  // namespace

int main(int argc, char** argv) {
    // Each iteration frees a tree of some megabytes. With glibc's defaults the
    // freed top of the heap goes back to the system and the next iteration
    // faults it in again, page by page: the figure then measures the kernel,
    // differs from machine to machine, and depends on what else the iteration
    // keeps alive (a message that outlives its tree pins the heap's top).
    // A service's heap stays warm, so the heap is kept here too, for every
    // row alike.
    mallopt(M_TRIM_THRESHOLD, 1 << 30);
    mallopt(M_MMAP_THRESHOLD, 1 << 30);
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 1;
    const RatioFigures figures = Korvane::Veldra::Bench::RunWithRatios();
    for (const std::string body : {"Query", "Update"}) {
        const auto print = [&](const std::string& what, const std::string& pair,
                               const char* target) {
            PrintRatio(body + " " + what, PairedRatio(figures, body + "/Paired/" + pair), 1.0,
                       target);
        };
        print("parse, library / RapidJSON DOM", "Parse", ">= 1.2");
        print("write, library / RapidJSON Writer", "Write", ">= 1.5");
        print("parse and read fields / RapidJSON DOM parse", "ParseAndRead", ">= 0.9");
#ifdef KVVELDRA_HAVE_SIMDJSON
        print("parse, library / simdjson DOM", "ParseSimdjson", "-");
#endif
    }
    benchmark::Shutdown();
    return 0;
}
