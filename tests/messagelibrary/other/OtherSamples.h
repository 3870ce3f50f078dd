#pragma once

#include <string>

#include "messagelibrary/audit/AuditRecords.h"
#include "messagelibrary/configuration/ConfigurationRecords.h"
#include "messagelibrary/smtp/SmtpRecords.h"
#include "messagelibrary/tags/TagSamples.h"

// Records of the audit, configuration and e-mail messages with their written
// forms.

namespace Korvane::Veldra::VeldraMessageLibrary::Testing {

inline AuditTrailMessages::AuditEntry SampleAuditEntry() {
    return {SampleTime(),
            std::string("sub"),
            std::string("svc"),
            kOddPath,
            std::string("rec"),
            std::string("dev"),
            std::string("det"),
            1,
            -2,
            3,
            2147483647,
            std::string("s1"),
            std::string(""),
            std::string("s3"),
            std::nullopt};
}
inline const std::string kAuditEntryJson =
    R"({"timestamp":)" + kTimeJson + R"(,"subtype":"sub","originator":"svc","userName":)" +
    kOddPathJson +
    R"(,"recordType":"rec","device":"dev","detail":"det","int1":1,"int2":-2,"int3":3,)"
    R"("int4":2147483647,"str1":"s1","str2":"","str3":"s3","str4":null})";

inline AuditTrailMessages::AuditQueryParameters SampleAuditQuery() {
    return {SampleTime(),
            SampleTime(),
            std::string("o"),
            std::string("r"),
            std::string("s"),
            std::string("d"),
            std::string("x"),
            1,
            2,
            3,
            4,
            std::string("a"),
            std::string("b"),
            std::string("c"),
            std::nullopt,
            true,
            std::vector<int32_t>{1, -3},
            5,
            6,
            std::string("timestamp"),
            std::string("true")};
}
inline const std::string kAuditQueryJson =
    R"({"timestampFrom":)" + kTimeJson + R"(,"timestampTo":)" + kTimeJson +
    R"(,"originator":"o","recordType":"r","subtype":"s","device":"d","detail":"x","int1":1,)"
    R"("int2":2,"int3":3,"int4":4,"str1":"a","str2":"b","str3":"c","str4":null,)"
    R"("queryUsingTimestamps":true,"queryUsingInts":[1,-3],"skipCount":5,"maxRecords":6,)"
    R"("orderBy":"timestamp","orderByDescending":"true"})";

inline SmtpMessages::SmtpAddressGroup SampleAddressGroup() {
    return {std::string("g1"), std::string("ops"), JsonStringList{"a@x.org", "b@x.org"},
            JsonStringList{}, std::nullopt};
}
inline const std::string kAddressGroupJson =
    R"({"id":"g1","name":"ops","toAddresses":["a@x.org","b@x.org"],"ccAddresses":[],)"
    R"("bccAddresses":null})";

inline SmtpMessages::SmtpTemplateEntry SampleTemplate() {
    return {std::string("t1"), std::string("alarm"), std::nullopt, std::string("Alarm {tag}"),
            std::string("Line 1\nLine 2")};
}
inline const std::string kTemplateJson =
    R"({"id":"t1","name":"alarm","description":null,"subject":"Alarm {tag}",)"
    R"("contents":"Line 1\nLine 2"})";

}  // namespace Korvane::Veldra::VeldraMessageLibrary::Testing
