#include "WBHostRuntime.h"

#include <atomic>
#include <chrono>
#include <condition_variable>
#include <cstdlib>
#include <cstring>
#include <map>
#include <mutex>
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
    std::condition_variable fired;
    std::map<uint32_t, bool> states;  // signal number to fired flag
    uint32_t next = 1;
};

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
    return signal;
}

int32_t WBFreeSignal(uint32_t signal) {
    auto& table = SignalTable();
    std::lock_guard<std::mutex> lock(table.mutex);
    return table.states.erase(signal) == 1 ? 0 : 1;
}

int32_t WBFireSignal(uint32_t signal) {
    auto& table = SignalTable();
    {
        std::lock_guard<std::mutex> lock(table.mutex);
        const auto found = table.states.find(signal);
        if (found == table.states.end()) return 1;
        found->second = true;
    }
    table.fired.notify_all();
    return 0;
}

int32_t WBWaitSignal(uint32_t signal, uint32_t timeoutMs) {
    auto& table = SignalTable();
    std::unique_lock<std::mutex> lock(table.mutex);
    const bool fired = table.fired.wait_for(lock, std::chrono::milliseconds(timeoutMs), [&] {
        const auto found = table.states.find(signal);
        return found == table.states.end() || found->second;
    });
    const auto found = table.states.find(signal);
    return fired && found != table.states.end() && found->second ? 1 : 0;
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

int32_t WbVariantNestInVariant(WbVariant** slot) {
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
    if (Reset(variant, WbVariantDouble) != 0) return 1;
    variant->value.d = value;
    return 0;
}

int32_t WbVariantSetI32(WbVariant* variant, int32_t value) {
    if (Reset(variant, WbVariantI32) != 0) return 1;
    variant->value.i = value;
    return 0;
}

int32_t WbVariantSetUI32(WbVariant* variant, uint32_t value) {
    if (Reset(variant, WbVariantUI32) != 0) return 1;
    variant->value.u = value;
    return 0;
}

int32_t WbVariantSetBool(WbVariant* variant, uint8_t value) {
    if (Reset(variant, WbVariantBool) != 0) return 1;
    variant->value.b = value;
    return 0;
}

int32_t WbVariantSetLStr(WbVariant* variant, WBStrHandle value) {
    if (Reset(variant, WbVariantLStr) != 0) return 1;
    // The variant keeps a copy of its own.
    const int32_t length = (value != nullptr && *value != nullptr) ? (*value)->cnt : 0;
    const size_t size = sizeof(int32_t) + (length > 0 ? static_cast<size_t>(length) : 1);
    WBHandle copy = WBNewHandleClr(size);
    if (copy == nullptr) return 2;
    auto* block = static_cast<WBStr*>(*copy);
    if (length > 0) std::memcpy(block->str, (*value)->str, static_cast<size_t>(length));
    block->cnt = length > 0 ? length : 0;
    variant->text = reinterpret_cast<WBStrHandle>(copy);
    return 0;
}

}  // extern "C"
