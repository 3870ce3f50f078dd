#include "WBHostRuntime.h"

#include <atomic>
#include <chrono>
#include <condition_variable>
#include <cstdlib>
#include <cstring>
#include <map>
#include <mutex>
#include <set>
#include <string>

namespace {

// Every block carries its size in a hidden prefix, so that a resize can zero
// exactly the bytes it adds.
struct BlockHeader {
    size_t size;
    size_t padding;  // keeps the caller's bytes 16-byte aligned
};

std::atomic<int32_t> gFailAllocations{0};

bool ShouldFail() {
    int32_t remaining = gFailAllocations.load();
    while (remaining > 0) {
        if (gFailAllocations.compare_exchange_weak(remaining, remaining - 1)) return true;
    }
    return false;
}

// The failures WbVariantFailNextCalls asked for: the count in the high half and
// the status in the low half, so that a call takes a failure and its status in
// one step.
std::atomic<uint64_t> gFailVariantCalls{0};

// The status of a variant call that is to fail, else 0.
int32_t TakeVariantFailure() {
    uint64_t packed = gFailVariantCalls.load();
    while ((packed >> 32) != 0) {
        if (gFailVariantCalls.compare_exchange_weak(packed, packed - (uint64_t{1} << 32))) {
            return static_cast<int32_t>(static_cast<uint32_t>(packed));
        }
    }
    return 0;
}

BlockHeader* HeaderOf(void* block) {
    return static_cast<BlockHeader*>(block) - 1;
}

void* NewBlock(size_t size) {
    auto* header = static_cast<BlockHeader*>(std::calloc(1, sizeof(BlockHeader) + size));
    if (header == nullptr) return nullptr;
    header->size = size;
    return header + 1;
}

struct Signals {
    std::mutex mutex;
    std::condition_variable changed;  // a signal fired, was freed, or a fire was tried
    std::map<uint32_t, bool> states;  // allocated signal number to fired flag
    // Signal number to the WBFireSignal calls with it since its allocation,
    // counted also while it was freed or unknown.
    std::map<uint32_t, uint64_t> fireAttempts;
    uint32_t next = 1;
};

// The handles WBNewHandleClr made and WBDisposeHandle has not freed yet: a
// function that takes a handle over checks that it belongs to this memory
// manager, as a real host would free or resize it.
struct LiveHandles {
    std::mutex mutex;
    std::set<WBHandle> handles;
};

LiveHandles& HandleTable() {
    static LiveHandles* table = new LiveHandles();
    return *table;
}

bool IsLiveHandle(WBHandle handle) {
    auto& table = HandleTable();
    std::lock_guard<std::mutex> lock(table.mutex);
    return table.handles.count(handle) != 0;
}

Signals& SignalTable() {
    static Signals* table = new Signals();
    return *table;
}

}  // namespace

struct WbVariant {
    int32_t type = WbVariantEmpty;
    union {
        double d;
        int32_t i;
        uint32_t u;
        uint8_t b;
    } value{};
    WBStrHandle text = nullptr;
};

extern "C" {

WBHandle WBNewHandleClr(size_t size) {
    if (ShouldFail()) return nullptr;
    void** handle = static_cast<void**>(std::malloc(sizeof(void*)));
    if (handle == nullptr) return nullptr;
    *handle = NewBlock(size);
    if (*handle == nullptr) {
        std::free(handle);
        return nullptr;
    }
    auto& table = HandleTable();
    std::lock_guard<std::mutex> lock(table.mutex);
    table.handles.insert(handle);
    return handle;
}

int32_t WBResizeHandleClr(WBHandle handle, size_t size) {
    if (handle == nullptr || *handle == nullptr) return 1;
    if (ShouldFail()) return 2;
    BlockHeader* header = HeaderOf(*handle);
    const size_t old = header->size;
    auto* grown = static_cast<BlockHeader*>(std::realloc(header, sizeof(BlockHeader) + size));
    if (grown == nullptr) return 2;
    if (size > old) std::memset(reinterpret_cast<char*>(grown + 1) + old, 0, size - old);
    grown->size = size;
    *handle = grown + 1;
    return 0;
}

void WBDisposeHandle(WBHandle handle) {
    if (handle == nullptr) return;
    {
        auto& table = HandleTable();
        std::lock_guard<std::mutex> lock(table.mutex);
        table.handles.erase(handle);
    }
    if (*handle != nullptr) std::free(HeaderOf(*handle));
    std::free(handle);
}

size_t WBHandleSize(WBHandle handle) {
    return handle == nullptr || *handle == nullptr ? 0 : HeaderOf(*handle)->size;
}

void WBFailNextAllocations(int32_t count) {
    gFailAllocations.store(count);
}

uint32_t WBAllocSignal(void) {
    auto& table = SignalTable();
    std::lock_guard<std::mutex> lock(table.mutex);
    while (table.next == 0 || table.states.count(table.next) != 0) ++table.next;
    const uint32_t signal = table.next++;
    table.states[signal] = false;
    table.fireAttempts.erase(signal);
    return signal;
}

int32_t WBFreeSignal(uint32_t signal) {
    auto& table = SignalTable();
    {
        std::lock_guard<std::mutex> lock(table.mutex);
        if (table.states.erase(signal) == 0) return 1;
    }
    // Waits on it end now, with 0.
    table.changed.notify_all();
    return 0;
}

int32_t WBFireSignal(uint32_t signal) {
    auto& table = SignalTable();
    int32_t status = 1;
    {
        std::lock_guard<std::mutex> lock(table.mutex);
        ++table.fireAttempts[signal];
        const auto found = table.states.find(signal);
        if (found != table.states.end()) {
            found->second = true;
            status = 0;
        }
    }
    table.changed.notify_all();
    return status;
}

int32_t WBWaitSignal(uint32_t signal, uint32_t timeoutMs) {
    auto& table = SignalTable();
    std::unique_lock<std::mutex> lock(table.mutex);
    // Ends early when the signal fires or is freed; only a fire counts.
    table.changed.wait_for(lock, std::chrono::milliseconds(timeoutMs), [&] {
        const auto found = table.states.find(signal);
        return found == table.states.end() || found->second;
    });
    const auto found = table.states.find(signal);
    return found != table.states.end() && found->second ? 1 : 0;
}

int32_t WBWaitFireAttempt(uint32_t signal, uint32_t timeoutMs) {
    auto& table = SignalTable();
    std::unique_lock<std::mutex> lock(table.mutex);
    const bool tried = table.changed.wait_for(lock, std::chrono::milliseconds(timeoutMs), [&] {
        const auto found = table.fireAttempts.find(signal);
        return found != table.fireAttempts.end() && found->second > 0;
    });
    return tried ? 1 : 0;
}

void* WbVariantGetDataPtr(WbVariant* variant) {
    if (variant == nullptr) return nullptr;
    if (variant->type == WbVariantLStr) return &variant->text;
    return &variant->value;
}

WbVariant* WbVariantNew(void) {
    return new WbVariant();
}

void WbVariantFree(WbVariant* variant) {
    if (variant == nullptr) return;
    WBDisposeHandle(reinterpret_cast<WBHandle>(variant->text));
    delete variant;
}

int32_t WbVariantGetType(const WbVariant* variant) {
    return variant == nullptr ? WbVariantEmpty : variant->type;
}

void WbVariantFailNextCalls(int32_t count, int32_t status) {
    const bool on = count > 0 && status != 0;
    gFailVariantCalls.store(
        on ? (static_cast<uint64_t>(count) << 32) | static_cast<uint32_t>(status) : 0);
}

int32_t WbVariantNestInVariant(WbVariant** slot) {
    if (const int32_t failure = TakeVariantFailure()) return failure;
    if (slot == nullptr) return 1;
    WbVariantFree(*slot);
    *slot = new WbVariant();
    return 0;
}

static int32_t Reset(WbVariant* variant, int32_t type) {
    if (variant == nullptr) return 1;
    WBDisposeHandle(reinterpret_cast<WBHandle>(variant->text));
    variant->text = nullptr;
    variant->type = type;
    return 0;
}

int32_t WbVariantSetDBL(WbVariant* variant, double value) {
    if (const int32_t failure = TakeVariantFailure()) return failure;
    if (Reset(variant, WbVariantDouble) != 0) return 1;
    variant->value.d = value;
    return 0;
}

int32_t WbVariantSetI32(WbVariant* variant, int32_t value) {
    if (const int32_t failure = TakeVariantFailure()) return failure;
    if (Reset(variant, WbVariantI32) != 0) return 1;
    variant->value.i = value;
    return 0;
}

int32_t WbVariantSetUI32(WbVariant* variant, uint32_t value) {
    if (const int32_t failure = TakeVariantFailure()) return failure;
    if (Reset(variant, WbVariantUI32) != 0) return 1;
    variant->value.u = value;
    return 0;
}

int32_t WbVariantSetBool(WbVariant* variant, uint8_t value) {
    if (const int32_t failure = TakeVariantFailure()) return failure;
    if (Reset(variant, WbVariantBool) != 0) return 1;
    variant->value.b = value;
    return 0;
}

int32_t WbVariantSetLStr(WbVariant* variant, WBStrHandle value) {
    if (const int32_t failure = TakeVariantFailure()) return failure;
    // The variant takes the handle over and frees it with itself, as the
    // host does: it must come from this memory manager. A null handle is the
    // empty string.
    const auto handle = reinterpret_cast<WBHandle>(value);
    if (handle != nullptr && !IsLiveHandle(handle)) return 1;
    if (Reset(variant, WbVariantLStr) != 0) return 1;
    if (handle == nullptr) {
        WBHandle empty = WBNewHandleClr(sizeof(int32_t));
        if (empty == nullptr) return 2;
        variant->text = reinterpret_cast<WBStrHandle>(empty);
        return 0;
    }
    variant->text = value;
    return 0;
}

}  // extern "C"
