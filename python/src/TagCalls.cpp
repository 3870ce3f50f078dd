#include "TagCalls.h"

#include "Records.h"
#include "Status.h"
#include "Texts.h"
#include "Times.h"
#include "Values.h"

namespace py = pybind11;

namespace kvveldra_python {
namespace {

// Runs call(reference, error) on an open tag, raising for its status.
template <typename Call>
void OnTag(TagHandle& tag, Call&& call) {
    tag.Require();
    const uint32_t reference = tag.Reference();
    tag.Owner().Checked([&](std::string& error) { return call(reference, error); });
}

// Runs call(instance, references, error) on the one tag.
template <typename Call>
void OnTagList(TagHandle& tag, Call&& call) {
    tag.Require();
    const std::vector<uint32_t> references{tag.Reference()};
    const uint64_t instance = tag.Owner().Instance();
    tag.Owner().Checked([&](std::string& error) { return call(instance, references, error); });
}

TagConsoleSample Sample(TagHandle& tag, py::handle value, py::handle timestamp) {
    const std::string text = ValueText(value, tag.DataType(), tag.Path());
    if (timestamp.is_none()) return {text, Now()};
    return {text, TimeOf(timestamp, "the time for tag '" + tag.Path() + "'")};
}

void Write(TagHandle& tag, const TagConsoleSamples& samples) {
    const int32_t type = tag.DataType();
    OnTag(tag, [&](uint32_t reference, std::string& error) {
        return TagConsoleWriteTag(reference, type, &samples, false, &error);
    });
}

}  // namespace

void WriteValue(TagHandle& tag, py::handle value, py::handle timestamp) {
    tag.Require();
    Write(tag, TagConsoleSamples{Sample(tag, value, timestamp)});
}

void WriteValues(TagHandle& tag, py::handle values) {
    tag.Require();
    if (py::isinstance<py::str>(values) || !py::isinstance<py::iterable>(values)) {
        throw py::type_error("write_many of tag '" + tag.Path() +
                             "' takes a list of values or (value, time) pairs");
    }
    TagConsoleSamples samples;
    for (const py::handle item : values) {
        if (py::isinstance<py::tuple>(item)) {
            const py::tuple pair = py::reinterpret_borrow<py::tuple>(item);
            if (pair.size() != 2) {
                throw py::value_error("write_many of tag '" + tag.Path() +
                                      "': a tuple must be a (value, time) pair");
            }
            samples.push_back(Sample(tag, pair[0], pair[1]));
        } else {
            samples.push_back(Sample(tag, item, py::none()));
        }
    }
    if (samples.empty()) {
        throw py::value_error("write_many of tag '" + tag.Path() + "' got no values to write");
    }
    Write(tag, samples);
}

py::object ReadValue(TagHandle& tag) {
    tag.Require();
    std::vector<TagConsoleValue> results;
    OnTagList(tag, [&](uint64_t instance, const std::vector<uint32_t>& references,
                       std::string& error) {
        return TagConsoleReadValues(instance, &references, false, 0, &results, &error);
    });
    for (const auto& result : results) {
        if (result.path == tag.Path()) return ValueRecord(result);
    }
    RaiseStatus(kNoSuchTag, "No such tag: '" + tag.Path() + "'.");
}

std::vector<std::string> Keywords(TagHandle& tag) {
    std::vector<std::string> keywords;
    OnTag(tag, [&](uint32_t reference, std::string& error) {
        return TagConsoleGetKeywords(reference, false, &keywords, &error);
    });
    return keywords;
}

void SetKeywords(TagHandle& tag, py::handle keywords) {
    const auto texts = TextList(keywords, "the keywords of tag '" + tag.Path() + "'");
    OnTag(tag, [&](uint32_t reference, std::string& error) {
        return TagConsoleSetKeywords(reference, &texts, false, &error);
    });
}

TagConsoleProperties Properties(TagHandle& tag) {
    TagConsoleProperties properties;
    OnTag(tag, [&](uint32_t reference, std::string& error) {
        return TagConsoleGetProperties(reference, false, &properties, &error);
    });
    return properties;
}

void SetProperties(TagHandle& tag, py::handle properties) {
    const auto map = TextMap(properties, "the properties of tag '" + tag.Path() + "'");
    OnTag(tag, [&](uint32_t reference, std::string& error) {
        return TagConsoleSetProperties(reference, &map, false, &error);
    });
}

bool CollectAggregates(TagHandle& tag) {
    bool collect = false;
    OnTag(tag, [&](uint32_t reference, std::string& error) {
        return TagConsoleGetCollectAggregates(reference, false, &collect, &error);
    });
    return collect;
}

void SetCollectAggregates(TagHandle& tag, bool collect) {
    OnTag(tag, [&](uint32_t reference, std::string& error) {
        return TagConsoleSetCollectAggregates(reference, collect, false, &error);
    });
}

void ResetAggregates(TagHandle& tag) {
    OnTagList(tag, [](uint64_t instance, const std::vector<uint32_t>& references,
                      std::string& error) {
        return TagConsoleResetAggregates(instance, &references, false, &error);
    });
}

void DeleteTag(TagHandle& tag) {
    OnTagList(tag, [](uint64_t instance, const std::vector<uint32_t>& references,
                      std::string& error) {
        return TagConsoleDeleteTag(instance, &references, false, &error);
    });
}

void CloseTag(TagHandle& tag) {
    if (tag.Owner().Closed()) return;
    std::string error;
    int32_t status = 0;
    {
        py::gil_scoped_release release;
        status = tag.CloseReference(error);
    }
    CheckStatus(status, error);
}

}  // namespace kvveldra_python
