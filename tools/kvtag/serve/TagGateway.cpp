#include "TagGateway.h"

#include <boost/asio/post.hpp>

#include "Commands.h"

namespace kvtag::serve {

TagGateway::TagGateway(const ConsoleInstance& instance) : instance_(instance) {}

TagGateway::~TagGateway() {
    Stop();
}

bool TagGateway::Submit(std::function<void()> job) {
    if (queued_.fetch_add(1) >= kMaxQueued) {
        --queued_;
        return false;
    }
    boost::asio::post(thread_, [this, job = std::move(job)] {
        --queued_;
        job();
    });
    return true;
}

boost::asio::any_io_executor TagGateway::Executor() {
    return thread_.get_executor();
}

void TagGateway::Stop() {
    thread_.stop();
    thread_.join();
}

std::string TagGateway::ListJson(const std::string& pattern, uint32_t skip, uint32_t take) const {
    Invocation call;
    call.command = Command::List;
    call.global.json = true;  // no count of the page on standard error
    call.paths = {pattern};
    call.skip = skip;
    call.take = take;
    return RunCommand(call, instance_, {}).json;
}

Reading TagGateway::Read(const std::vector<std::string>& paths) const {
    OpenedTags opened(instance_.Verbose());
    std::vector<FoundTag> found;
    Reading reading;
    for (const auto& path : paths) {
        if (auto tag = FindTag(instance_, path, opened)) {
            found.push_back(std::move(*tag));
        } else {
            reading.missing.push_back(path);
        }
    }
    if (!found.empty()) reading.values = ReadValues(instance_, found);
    return reading;
}

std::string TagGateway::WriteJson(const std::string& path, const std::string& value) const {
    Invocation call;
    call.command = Command::Write;
    call.paths = {path};
    call.value = value;
    return RunCommand(call, instance_, {}).json;
}

}  // namespace kvtag::serve
