#pragma once

#include <atomic>
#include <future>
#include <map>
#include <string>
#include <thread>

namespace Korvane::Veldra::Testing {

// A tag service of the test's own, written on raw rabbitmq-c and nothing of
// the library: what the library reads from it is what any peer could send.
// It answers TagInfoQueryTagsRequest with the record scripted for the path
// asked for (its JSON text as it stands, so a record may lack keys or a
// body may be malformed), and TagCvQueryCurrentValuesByPathRequest with the
// value record scripted for each path.
class RawTagPeer {
public:
    // path -> the JSON of its record in a query response; a path scripted as
    // "MALFORMED" gets a body that does not parse.
    using Script = std::map<std::string, std::string>;

    RawTagPeer(std::string exchange, Script tags, Script values);
    ~RawTagPeer();
    RawTagPeer(const RawTagPeer&) = delete;
    RawTagPeer& operator=(const RawTagPeer&) = delete;

    // True once it consumes; false when it could not set up.
    bool Ready();

private:
    void Run();
    std::string Answer(const std::string& type, const std::string& body, std::string& answerType) const;

    const std::string exchange_;
    const Script tags_;
    const Script values_;
    std::atomic<bool> stop_{false};
    std::promise<bool> ready_;
    std::thread thread_;
};

}  // namespace Korvane::Veldra::Testing
