#include "Report.h"

#include <algorithm>

#include "JsonWriter.h"
#include "TagTypes.h"
#include "TextEscape.h"
#include "TimeText.h"

namespace kvtag {
namespace {

void WriteTime(JsonWriter& json, TagConsoleTime time) {
    const std::string text = FormatIsoTime(time);
    if (text.empty()) {
        json.Null();
    } else {
        json.String(text);
    }
}

// The two members every tag's object starts with.
JsonWriter& WritePathAndType(JsonWriter& json, const std::string& path, int32_t type) {
    return json.Key("path").String(path).Key("type").String(TypeName(type));
}

std::string TimeOrDash(TagConsoleTime time) {
    const std::string text = FormatIsoTime(time);
    return text.empty() ? "-" : text;
}

// Before the first sample the average, minimum and maximum are nothing:
// null in JSON, "-" in text.
bool HasSamples(const TagConsoleValue& value) {
    return value.aggregateCount > 0;
}

void WriteExtreme(JsonWriter& json, const TagConsoleValue& value, const std::string& text) {
    if (HasSamples(value) && !text.empty()) {
        json.String(text);
    } else {
        json.Null();
    }
}

void WriteAggregates(JsonWriter& json, const TagConsoleValue& value) {
    json.BeginObject().Key("count").Integer(value.aggregateCount).Key("average");
    if (HasSamples(value)) {
        json.Number(value.aggregateAverage);
    } else {
        json.Null();
    }
    json.Key("minimum");
    WriteExtreme(json, value, value.aggregateMinimum);
    json.Key("maximum");
    WriteExtreme(json, value, value.aggregateMaximum);
    json.EndObject();
}

std::string ExtremeText(const TagConsoleValue& value, const std::string& text) {
    return HasSamples(value) && !text.empty() ? EscapeText(text) : "-";
}

std::string AggregatesText(const TagConsoleValue& value) {
    return "count " + std::to_string(value.aggregateCount) + ", average " +
           (HasSamples(value) ? NumberText(value.aggregateAverage) : "-") + ", minimum " +
           ExtremeText(value, value.aggregateMinimum) + ", maximum " +
           ExtremeText(value, value.aggregateMaximum);
}

}  // namespace

Rendered RenderList(const ListReport& report) {
    Rendered out;
    JsonWriter json;
    json.BeginObject()
        .Key("total")
        .Integer(report.total)
        .Key("skip")
        .Integer(report.skip)
        .Key("take")
        .Integer(report.take)
        .Key("tags")
        .BeginArray();
    for (const auto& tag : report.tags) {
        out.text += EscapeText(tag.path) + "\t" + TypeName(tag.type) + "\n";
        WritePathAndType(json.BeginObject(), tag.path, tag.type).EndObject();
    }
    json.EndArray().EndObject();
    out.json = json.Text();
    return out;
}

Rendered RenderValues(const std::vector<TagConsoleValue>& values) {
    Rendered out;
    JsonWriter json;
    json.BeginObject().Key("values").BeginArray();
    for (const auto& value : values) {
        out.text += EscapeText(value.path) + "\t" + TypeName(value.dataType) + "\t" +
                    EscapeText(value.value) + "\t" + TimeOrDash(value.timestamp);
        if (value.aggregateCount > 0) out.text += "\t(" + AggregatesText(value) + ")";
        out.text += "\n";
        WritePathAndType(json.BeginObject(), value.path, value.dataType)
            .Key("value")
            .String(value.value)
            .Key("time");
        WriteTime(json, value.timestamp);
        json.Key("aggregates");
        if (value.aggregateCount > 0) {
            WriteAggregates(json, value);
        } else {
            json.Null();
        }
        json.EndObject();
    }
    json.EndArray().EndObject();
    out.json = json.Text();
    return out;
}

Rendered RenderWrites(const std::vector<WriteEntry>& writes) {
    Rendered out;
    JsonWriter json;
    json.BeginObject().Key("written").BeginArray();
    for (const auto& write : writes) {
        out.text += "wrote " + std::to_string(write.samples) +
                    (write.samples == 1 ? " sample to " : " samples to ") + EscapeText(write.path) +
                    " (" + TypeName(write.type) + ")\n";
        WritePathAndType(json.BeginObject(), write.path, write.type)
            .Key("samples")
            .Integer(static_cast<int64_t>(write.samples))
            .EndObject();
    }
    json.EndArray().EndObject();
    out.json = json.Text();
    return out;
}

Rendered RenderCreated(const TagEntry& tag) {
    JsonWriter json;
    WritePathAndType(json.BeginObject(), tag.path, tag.type).EndObject();
    return {"created " + EscapeText(tag.path) + " (" + TypeName(tag.type) + ")\n", json.Text()};
}

Rendered RenderKeywords(const std::string& path, const std::vector<std::string>& keywords) {
    Rendered out;
    JsonWriter json;
    json.BeginObject().Key("path").String(path).Key("keywords").BeginArray();
    for (const auto& keyword : keywords) {
        out.text += EscapeText(keyword) + "\n";
        json.String(keyword);
    }
    json.EndArray().EndObject();
    out.json = json.Text();
    return out;
}

Rendered RenderProperties(const std::string& path,
                          std::vector<std::pair<std::string, std::string>> properties) {
    std::sort(properties.begin(), properties.end());
    Rendered out;
    JsonWriter json;
    json.BeginObject().Key("path").String(path).Key("properties").BeginObject();
    for (const auto& [key, value] : properties) {
        out.text += EscapeText(key) + "=" + EscapeText(value) + "\n";
        json.Key(key).String(value);
    }
    json.EndObject().EndObject();
    out.json = json.Text();
    return out;
}

Rendered RenderAggregates(const AggregatesReport& report) {
    Rendered out;
    out.text = EscapeText(report.path) + "\t" + TypeName(report.type) + "\tcollect " +
               (report.collect ? "on" : "off") + "\t" + AggregatesText(report.value) + "\n";
    JsonWriter json;
    WritePathAndType(json.BeginObject(), report.path, report.type)
        .Key("collect")
        .Bool(report.collect)
        .Key("aggregates");
    WriteAggregates(json, report.value);
    json.EndObject();
    out.json = json.Text();
    return out;
}

Rendered RenderDeleted(const std::vector<std::string>& paths) {
    Rendered out;
    JsonWriter json;
    json.BeginObject().Key("deleted").BeginArray();
    for (const auto& path : paths) {
        out.text += "deleted " + EscapeText(path) + "\n";
        json.String(path);
    }
    json.EndArray().EndObject();
    out.json = json.Text();
    return out;
}

std::string JsonSuccess(const std::string& command, const std::string& resultJson) {
    JsonWriter json;
    json.BeginObject()
        .Key("ok")
        .Bool(true)
        .Key("command")
        .String(command)
        .Key("result")
        .Raw(resultJson)
        .EndObject();
    return json.Text();
}

std::string JsonFailure(const std::string& command, const std::string& kind, const int32_t* status,
                        const std::string& message) {
    JsonWriter json;
    json.BeginObject()
        .Key("ok")
        .Bool(false)
        .Key("command")
        .String(command)
        .Key("error")
        .BeginObject()
        .Key("kind")
        .String(kind)
        .Key("status");
    if (status) {
        json.Integer(*status);
    } else {
        json.Null();
    }
    json.Key("message").String(message).EndObject().EndObject();
    return json.Text();
}

}  // namespace kvtag
