#pragma once

#include <boost/intrusive_ptr.hpp>

#include <cstdint>

#include "taglibrary/requests/RefCountedThreadSafePolicy.h"

namespace kvsup::wb {

// One signal of the graphical host, allocated at construction and freed when
// the last reference goes. Throws VeldraException (the host-function-missing
// code) when the process has no WBAllocSignal.
class WBDynamicSignal : public RefCountedThreadSafePolicy {
public:
    WBDynamicSignal();
    ~WBDynamicSignal() override;

    uint32_t Number() const { return number_; }
    // WBFireSignal's result: 0 when the host took it.
    int32_t Fire() const;

private:
    uint32_t number_ = 0;
    uint8_t owned_ = 0;
};

using WBDynamicSignalPtr = boost::intrusive_ptr<WBDynamicSignal>;

}  // namespace kvsup::wb
