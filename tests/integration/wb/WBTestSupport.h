#pragma once

#include <gtest/gtest.h>

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <memory>
#include <string>
#include <type_traits>
#include <utility>
#include <vector>

#include "WBHostRuntime.h"
#include "kvveldra/TagWB.h"
#include "support/ExportedNumbers.h"
#include "support/SuiteTagService.h"

namespace Korvane::Veldra::Testing {


// A new host string with the text.
WBStrHandle NewHostString(const std::string& text);
std::string Text(WBStrHandle handle);

// Frees what a host program owns in an element of an array.
inline void DisposeElement(WBStrHandle& element) { WBDisposeHandle(reinterpret_cast<WBHandle>(element)); }
inline void DisposeElement(WbVariant*& element) { WbVariantFree(element); }
inline void DisposeElement(WBProperty& element) {
    DisposeElement(element.key);
    DisposeElement(element.value);
}
template <typename Value>
void DisposeElement(Value& element) {
    if constexpr (!std::is_arithmetic_v<Value> && !std::is_same_v<Value, WBTimestamp>) {
        DisposeElement(element.path);
        DisposeElement(element.value);
    }
}

// An array handle that the test owns, with whatever its elements hold; the
// library fills it through Out().
template <typename Array>
class HostArray {
public:
    using Element = std::remove_reference_t<decltype(std::declval<Array&>().elt[0])>;

    HostArray() = default;
    // An array of the elements, which it then owns.
    explicit HostArray(const std::vector<Element>& elements) {
        const std::size_t count = elements.empty() ? 1 : elements.size();
        handle_ = reinterpret_cast<Array**>(WBNewHandleClr(offsetof(Array, elt) + count * sizeof(Element)));
        (*handle_)->dimSize = static_cast<int32_t>(elements.size());
        for (std::size_t i = 0; i < elements.size(); ++i) (*handle_)->elt[i] = elements[i];
    }
    ~HostArray() {
        for (std::size_t i = 0; i < Size(); ++i) DisposeElement((*handle_)->elt[i]);
        WBDisposeHandle(reinterpret_cast<WBHandle>(handle_));
    }
    HostArray(const HostArray&) = delete;
    HostArray& operator=(const HostArray&) = delete;

    Array** Get() const { return handle_; }
    Array*** Out() { return &handle_; }
    std::size_t Size() const {
        return handle_ == nullptr || *handle_ == nullptr ? 0 : static_cast<std::size_t>((*handle_)->dimSize);
    }
    Element& operator[](std::size_t index) const { return (*handle_)->elt[index]; }

private:
    Array** handle_ = nullptr;
};

// New host strings, one per text, for an array to own.
std::vector<WBStrHandle> NewHostStrings(const std::vector<std::string>& texts);

// A host string that the test owns.
struct HostString {
    WBStrHandle handle = nullptr;
    explicit HostString(const std::string& text = "") : handle(text.empty() ? nullptr : NewHostString(text)) {}
    ~HostString() { DisposeElement(handle); }
    HostString(const HostString&) = delete;
    HostString& operator=(const HostString&) = delete;
    std::string Text() const { return Testing::Text(handle); }
};

// A variant that the test owns.
struct HostVariant {
    WbVariant* variant = WbVariantNew();
    ~HostVariant() { WbVariantFree(variant); }
};

// The three outputs of a request function.
struct Pending {
    uint32_t id = 0;
    uint32_t timeoutMs = 0;
    uint32_t signal = 0;
};

// Waits on the request's signal as a host diagram does: true when it fired
// within the request's time-out.
inline bool Await(const Pending& pending) {
    return WBWaitSignal(pending.signal, pending.timeoutMs) == 1;
}

// Host time of Unix microseconds, and back.
WBTimestamp HostTime(int64_t unixMicros);
int64_t UnixMicros(const WBTimestamp& time);

// The host family on instance 0 against a tag service of the suite's own,
// through the shared library and the host runtime emulator. As with the
// console suite, the first test starts both, and each test fails while they
// are not up.
class WBBrokerTest : public ::testing::Test {
protected:
    void SetUp() override;
    static void TearDownTestSuite();

    static void StartService();
    static void StopService();
    static std::string UniquePath(const std::string& stem);

    // The three calls of an open; fails the test on any status but 0.
    static uint32_t Open(const std::string& path, int32_t type);
    // Waits, then finishes a request that delivers nothing.
    static int32_t AwaitAndFinish(const Pending& pending, std::string* error = nullptr);
    // Writes one text sample at Unix microseconds (0: no timestamp).
    static void Write(uint32_t reference, int32_t type, const std::string& value, int64_t unixMicros);
    // Reads one tag as text: its value and host timestamp.
    static std::string ReadText(uint32_t reference, int32_t type, WBTimestamp* timestamp = nullptr);
    static void Close(uint32_t reference);

private:
    static SuiteTagService& Suite();
    static void StartSuite();
};

}  // namespace Korvane::Veldra::Testing
