#pragma once

#include <amqp.h>

#include <chrono>
#include <condition_variable>
#include <cstdint>
#include <functional>
#include <memory>
#include <mutex>
#include <string>
#include <vector>

#include "messagebus/concurrency/ResetEvent.h"
#include "messagebus/concurrency/Semaphore.h"
#include "messagebus/concurrency/SharedQueue.h"

namespace Korvane::Veldra::MessageBus {

// Releases what rabbitmq-c put in an envelope, then the envelope itself.
struct EnvelopeDeleter {
    void operator()(amqp_envelope_t* envelope) const;
};

using EnvelopePtr = std::shared_ptr<amqp_envelope_t>;
using EnvelopeQueue = SharedQueue<EnvelopePtr>;
using ReturnEventQueue = SharedQueue<ResetEvent>;
// Offered each delivery of a channel on the connection's reader thread before
// it is queued; true when it took the envelope, which then is not queued.
using DirectTaker = std::function<bool(const EnvelopePtr&)>;

// A zeroed envelope owned through EnvelopeDeleter, ready for
// amqp_consume_message.
EnvelopePtr MakeEnvelope();

// The lowest channel number from 1 upward, below 65535, that the table (a map
// keyed by channel number) does not hold; 0 when every one is taken.
template <typename ChannelTable>
uint16_t LowestFreeChannelId(const ChannelTable& channels) {
    for (uint32_t id = 1; id < 65535; ++id) {
        if (channels.find(static_cast<uint16_t>(id)) == channels.end()) {
            return static_cast<uint16_t>(id);
        }
    }
    return 0;
}

// One queue binding made on a channel: the queue and the elements of its key.
struct AmqpBinding {
    std::string QueueName;
    std::vector<std::string> Keys;

    bool operator==(const AmqpBinding& other) const {
        return QueueName == other.QueueName && Keys == other.Keys;
    }
};

// The record of one opened AMQP channel: its number, the queue the reader
// thread fills with its deliveries, the notices of returned messages, the
// signal to declare and bind anew, and what has been bound on it.
class AmqpChannel {
public:
    AmqpChannel(uint16_t id, std::shared_ptr<EnvelopeQueue> envelopes);
    AmqpChannel(const AmqpChannel&) = delete;
    AmqpChannel& operator=(const AmqpChannel&) = delete;

    // False, and nothing added, when an equal binding is recorded already.
    bool AddBinding(const std::string& queueName, const std::vector<std::string>& keys);
    // True when an equal binding was found and erased; the rest keep their order.
    bool RemoveBinding(const std::string& queueName, const std::vector<std::string>& keys);
    std::vector<AmqpBinding> GetBindings() const;
    // Installs the taker the reader offers deliveries to first; an empty one
    // removes it. Returns once no offer to the previous taker is in progress,
    // so that its owner may go after removing it.
    void SetDirectTaker(DirectTaker taker);
    // True when the taker took the envelope; false (also without a taker)
    // leaves it to be queued.
    bool OfferDirect(const EnvelopePtr& envelope);
    // Takes a waiting notice without waiting.
    bool TryTakeReturnEvent(ResetEvent& out);

    // The broker's tags of the consumers started on this channel; a new
    // connection or a reopened channel has none of them any more.
    void AddConsumerTag(std::string tag);
    std::vector<std::string> TakeConsumerTags();

    // ---- Whether the queue and bindings are in place on the broker ----
    // A reply sent to a queue that a lost connection took with it (an
    // auto-delete queue goes with its last consumer) is dropped by the
    // broker, so a request that expects a reply waits for its queue first.
    // Every change of connection or channel makes a new generation; only the
    // rebind that started in the current generation marks it bound again.

    // The queue may be gone: the connection or the channel was lost.
    void MarkUnbound();
    // MarkUnbound, then posts ChannelReset so that the consumer declares and
    // binds anew.
    void RequestReset();
    // The generation a rebind starts in.
    uint64_t Generation() const;
    // The rebind of that generation succeeded; nothing when a newer loss
    // came meanwhile, whose own rebind follows.
    void MarkBound(uint64_t generation);
    bool IsBound() const;
    // Waits up to `timeout` for the channel to be bound; true when it is.
    bool WaitBound(std::chrono::steady_clock::duration timeout) const;

    const uint16_t Id;
    const std::shared_ptr<EnvelopeQueue> Envelopes;
    const std::shared_ptr<ReturnEventQueue> ReturnEvents;
    // Posted when the channel must be declared and bound anew.
    Semaphore ChannelReset;

private:
    // Held across each offer, so that removing the taker waits for it.
    std::mutex DirectMutex;
    DirectTaker Direct;  // guarded by DirectMutex

    mutable std::recursive_mutex BindingMutex;
    std::vector<AmqpBinding> Bindings;
    std::vector<std::string> ConsumerTags;  // guarded by BindingMutex

    // Guards the two below; BoundChanged is notified when Bound turns true.
    mutable std::mutex BoundMutex;
    mutable std::condition_variable BoundChanged;
    bool Bound = true;
    uint64_t BoundGeneration = 0;
};

}  // namespace Korvane::Veldra::MessageBus
