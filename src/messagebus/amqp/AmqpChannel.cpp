#include "messagebus/amqp/AmqpChannel.h"

#include <algorithm>
#include <utility>

namespace Korvane::Veldra::MessageBus {

void EnvelopeDeleter::operator()(amqp_envelope_t* envelope) const {
    if (envelope == nullptr) return;
    amqp_destroy_envelope(envelope);
    delete envelope;
}

EnvelopePtr MakeEnvelope() {
    return EnvelopePtr(new amqp_envelope_t{}, EnvelopeDeleter());
}

AmqpChannel::AmqpChannel(uint16_t id, std::shared_ptr<EnvelopeQueue> envelopes)
    : Id(id), Envelopes(std::move(envelopes)), ReturnEvents(std::make_shared<ReturnEventQueue>()) {}

void AmqpChannel::SetDirectTaker(DirectTaker taker) {
    std::lock_guard<std::mutex> lock(DirectMutex);
    Direct = std::move(taker);
}

bool AmqpChannel::OfferDirect(const EnvelopePtr& envelope) {
    std::lock_guard<std::mutex> lock(DirectMutex);
    return Direct && Direct(envelope);
}

bool AmqpChannel::AddBinding(const std::string& queueName, const std::vector<std::string>& keys) {
    std::lock_guard<std::recursive_mutex> lock(BindingMutex);
    AmqpBinding binding{queueName, keys};
    if (std::find(Bindings.begin(), Bindings.end(), binding) != Bindings.end()) return false;
    Bindings.push_back(std::move(binding));
    return true;
}

bool AmqpChannel::RemoveBinding(const std::string& queueName,
                                const std::vector<std::string>& keys) {
    std::lock_guard<std::recursive_mutex> lock(BindingMutex);
    const auto found = std::find(Bindings.begin(), Bindings.end(), AmqpBinding{queueName, keys});
    if (found == Bindings.end()) return false;
    Bindings.erase(found);
    return true;
}

std::vector<AmqpBinding> AmqpChannel::GetBindings() const {
    std::lock_guard<std::recursive_mutex> lock(BindingMutex);
    return Bindings;
}

void AmqpChannel::AddConsumerTag(std::string tag) {
    std::lock_guard<std::recursive_mutex> lock(BindingMutex);
    ConsumerTags.push_back(std::move(tag));
}

std::vector<std::string> AmqpChannel::TakeConsumerTags() {
    std::lock_guard<std::recursive_mutex> lock(BindingMutex);
    std::vector<std::string> tags;
    tags.swap(ConsumerTags);
    return tags;
}

bool AmqpChannel::TryTakeReturnEvent(ResetEvent& out) {
    return ReturnEvents->TryTake(out, 0);
}

void AmqpChannel::MarkUnbound() {
    std::lock_guard<std::mutex> lock(BoundMutex);
    Bound = false;
    ++BoundGeneration;
}

void AmqpChannel::RequestReset() {
    MarkUnbound();
    ChannelReset.Release();
}

uint64_t AmqpChannel::Generation() const {
    std::lock_guard<std::mutex> lock(BoundMutex);
    return BoundGeneration;
}

void AmqpChannel::MarkBound(uint64_t generation) {
    {
        std::lock_guard<std::mutex> lock(BoundMutex);
        if (generation != BoundGeneration) return;
        Bound = true;
    }
    BoundChanged.notify_all();
}

bool AmqpChannel::IsBound() const {
    std::lock_guard<std::mutex> lock(BoundMutex);
    return Bound;
}

bool AmqpChannel::WaitBound(std::chrono::steady_clock::duration timeout) const {
    std::unique_lock<std::mutex> lock(BoundMutex);
    return BoundChanged.wait_for(lock, timeout, [this] { return Bound; });
}

}  // namespace Korvane::Veldra::MessageBus
