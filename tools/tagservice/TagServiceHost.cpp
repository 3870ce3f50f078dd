#include "TagServiceHost.h"

#include <iostream>
#include <utility>

namespace Korvane::Veldra::TagService {

TagServiceHost::TagServiceHost(MessageBus::Semaphore* shutdownEvent, TagServiceEndpoint& endpoint,
                               std::string readyText)
    : ManagedServiceBase(shutdownEvent), readyText_(std::move(readyText)) {
    AddWorkSubscriber(endpoint.Subscriber());
}

TagServiceHost::~TagServiceHost() {
    StopService();
}

void TagServiceHost::Start(const VeldraUtilities::ManagedServiceOptions& options) {
    Run(options);
    if (options.standalone) {
        GoLive();
    } else {
        Register();
    }
}

void TagServiceHost::GoLive() {
    ManagedServiceBase::GoLive();
    if (State() == VeldraMessageLibrary::ServiceState::Live) {
        std::cout << readyText_ << std::endl;
    }
}

}  // namespace Korvane::Veldra::TagService
