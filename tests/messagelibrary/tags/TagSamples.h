#pragma once

#include <boost/date_time/posix_time/posix_time.hpp>
#include <string>

#include "messagelibrary/ErrorRecord.h"
#include "messagelibrary/TagRecords.h"

// Records with every field set, and their written forms, for the tag tests.

namespace Korvane::Veldra::VeldraMessageLibrary::Testing {

inline Timestamp SampleTime() {
    using namespace boost::posix_time;
    return ptime(boost::gregorian::date(2016, 3, 1), hours(12) + microseconds(250000));
}
inline const std::string kTimeJson = R"("2016-03-01T12:00:00.250000Z")";

// A path with bytes that must be escaped.
inline const std::string kOddPath = "a.\"b\"\\c\n\x7f\xc3\xa9";
inline const std::string kOddPathJson = R"("a.\"b\"\\c\n\u007f)"
                                        "\xc3\xa9\"";

inline TagRecord SampleRecord() {
    return {kOddPath, TagDataType::Double, JsonStringMap{{"unit", "m/s"}, {"z", ""}},
            JsonStringList{"k1", "k2"}, true};
}
inline const std::string kRecordJson = R"({"path":)" + kOddPathJson +
                                       R"(,"type":"DOUBLE","properties":{"unit":"m/s","z":""},)"
                                       R"("keywords":["k1","k2"],"collectAggregates":true})";

inline TagValue SampleValue() {
    return {TagDataType::UInt64, std::string("18446744073709551615")};
}
inline const std::string kValueJson = R"({"type":"U_INT64","value":"18446744073709551615"})";

inline TagAggregates SampleAggregates() {
    return {3, -1.25, std::string("1"), std::string("")};
}
inline const std::string kAggregatesJson = R"({"count":3,"avg":-1.25,"min":"1","max":""})";

inline TagValueSample SampleSample() {
    return {SampleTime(), SampleValue()};
}
inline const std::string kSampleJson =
    R"({"timestamp":)" + kTimeJson + R"(,"value":)" + kValueJson + "}";

inline TagValueUpdate SampleUpdate() {
    return {SampleTime(), SampleValue(), SampleAggregates()};
}
inline const std::string kUpdateJson = R"({"timestamp":)" + kTimeJson + R"(,"value":)" +
                                       kValueJson + R"(,"aggregates":)" + kAggregatesJson + "}";

inline ErrorRecord SampleError() {
    ErrorRecord inner;
    inner.name = "Tag.Inner";
    return {std::string("Tag.NoSuchTag"),    std::string("none"), JsonStringList{"a.b"},
            std::vector<ErrorRecord>{inner}, std::string("a.b"),  std::string("Tag")};
}
inline const std::string kErrorJson =
    R"({"name":"Tag.NoSuchTag","message":"none","args":["a.b"],"innerErrors":[{"name":)"
    R"("Tag.Inner","message":null,"args":null,"innerErrors":null,"resourceId":null,)"
    R"("resourceType":null}],"resourceId":"a.b","resourceType":"Tag"})";

}  // namespace Korvane::Veldra::VeldraMessageLibrary::Testing
