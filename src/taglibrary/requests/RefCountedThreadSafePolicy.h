#pragma once

#include <atomic>
#include <cstdint>

namespace kvsup {

// An intrusive reference count that any thread may raise and lower; the
// object deletes itself when the last reference goes. Used through
// boost::intrusive_ptr.
class RefCountedThreadSafePolicy {
public:
    RefCountedThreadSafePolicy() = default;
    RefCountedThreadSafePolicy(const RefCountedThreadSafePolicy&) = delete;
    RefCountedThreadSafePolicy& operator=(const RefCountedThreadSafePolicy&) = delete;
    virtual ~RefCountedThreadSafePolicy() = default;

    void AddRef() const { count_.fetch_add(1, std::memory_order_relaxed); }
    void Release() const {
        if (count_.fetch_sub(1, std::memory_order_acq_rel) == 1) delete this;
    }
    uint32_t RefCount() const { return count_.load(std::memory_order_acquire); }

private:
    mutable std::atomic<uint32_t> count_{0};
};

inline void intrusive_ptr_add_ref(const RefCountedThreadSafePolicy* object) {
    object->AddRef();
}
inline void intrusive_ptr_release(const RefCountedThreadSafePolicy* object) {
    object->Release();
}

}  // namespace kvsup
