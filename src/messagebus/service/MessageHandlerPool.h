#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <thread>
#include <vector>

#include "messagebus/concurrency/BlockingCollection.h"
#include "messagelibrary/GenericMessage.h"

namespace Korvane::Veldra::MessageBus {

// Handler threads behind one queue: Push hands a message over, and one of the
// threads runs the handler with it, in the order the messages were pushed.
// Close ends the threads once the queue is drained; a handler that throws is
// reported and the thread goes on.
class MessageHandlerPool {
public:
    using Handler = std::function<void(const std::shared_ptr<GenericMessage>&)>;
    using Reporter = std::function<void(const std::string& line)>;

    MessageHandlerPool(int32_t threadCount, Handler handler, Reporter report);
    // Closes and joins.
    ~MessageHandlerPool();
    MessageHandlerPool(const MessageHandlerPool&) = delete;
    MessageHandlerPool& operator=(const MessageHandlerPool&) = delete;

    // Dropped once the pool is closed.
    void Push(std::shared_ptr<GenericMessage> message);
    // Handles what is queued, ends the threads and waits for them. Must not
    // be called from a handler.
    void Close();

private:
    void Run();

    BlockingCollection<std::shared_ptr<GenericMessage>> Queue;
    const Handler HandleMessage;
    const Reporter Report;
    std::vector<std::thread> Threads;
};

}  // namespace Korvane::Veldra::MessageBus
