#include "messagebus/service/MessageHandlerPool.h"

#include <utility>

#include "errors/ErrorCodes.h"

namespace Korvane::Veldra::MessageBus {

MessageHandlerPool::MessageHandlerPool(int32_t threadCount, Handler handler, Reporter report)
    : HandleMessage(std::move(handler)), Report(std::move(report)) {
    try {
        for (int32_t i = 0; i < threadCount; ++i) Threads.emplace_back([this] { Run(); });
    } catch (...) {
        Close();
        throw;
    }
}

MessageHandlerPool::~MessageHandlerPool() {
    Close();
}

void MessageHandlerPool::Push(std::shared_ptr<GenericMessage> message) {
    Queue.Push(std::move(message));
}

void MessageHandlerPool::Close() {
    Queue.Close();
    for (std::thread& thread : Threads) {
        if (thread.joinable()) thread.join();
    }
}

void MessageHandlerPool::Run() {
    for (;;) {
        std::shared_ptr<GenericMessage> message;
        try {
            message = Queue.Take();
        } catch (const VeldraException& error) {
            // Normally the queue is closed and drained; a failed wait ends
            // the thread too, as waiting again would fail the same way.
            if (error.Code() != ErrorCodes::kEndOfStream) {
                Report(std::string("Caught exception in message handler thread: ") + error.what());
            }
            return;
        }
        try {
            HandleMessage(message);
        } catch (const std::exception& error) {
            Report(std::string("Caught exception in message handler thread: ") + error.what());
        } catch (...) {
            Report("Caught exception in message handler thread!");
        }
    }
}

}  // namespace Korvane::Veldra::MessageBus
