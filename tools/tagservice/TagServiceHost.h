#pragma once

#include <string>

#include "TagServiceEndpoint.h"
#include "messagebus/concurrency/Semaphore.h"
#include "utilities/managedservice/ManagedServiceBase.h"

namespace Korvane::Veldra::TagService {

// The tag service as a managed service: the endpoint's consumers are its work
// subscribers, started on going live and stopped on going idle. Each time it
// goes live it prints the ready line on standard output.
class TagServiceHost : public VeldraUtilities::ManagedServiceBase {
public:
    // The endpoint must outlive the host.
    TagServiceHost(MessageBus::Semaphore* shutdownEvent, TagServiceEndpoint& endpoint,
                   std::string readyText);
    ~TagServiceHost() override;

    void GoLive() override;

    // Runs the base, then does what the base leaves to the service itself:
    // standalone it goes live at once; under a manager it registers now
    // rather than wait for the manager's next status request.
    void Start(const VeldraUtilities::ManagedServiceOptions& options);

private:
    const std::string readyText_;
};

}  // namespace Korvane::Veldra::TagService
