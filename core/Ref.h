#pragma once
// Counted references, as every object the component holds is held: storing a new object into
// a Ref releases the one it held before.
#include <atomic>
#include <cstdint>
#include <utility>

namespace kg {

class RefCounted {
public:
    RefCounted();
    RefCounted(const RefCounted&) = delete;
    RefCounted& operator=(const RefCounted&) = delete;

    uint32_t addRef() noexcept { return ++refs_; }
    uint32_t release() noexcept;
    uint32_t refCount() const noexcept { return refs_; }

    // Objects of the component alive in this process (for the unload query).
    static long liveObjects() noexcept;

protected:
    virtual ~RefCounted();

private:
    std::atomic<uint32_t> refs_{0};
};

template <class T>
class Ref {
public:
    Ref() = default;
    Ref(std::nullptr_t) {}
    Ref(T* p) : p_(p) { if (p_) p_->addRef(); }  // NOLINT: implicit, as an object assignment
    Ref(const Ref& o) : Ref(o.p_) {}
    Ref(Ref&& o) noexcept : p_(std::exchange(o.p_, nullptr)) {}
    template <class U>
    Ref(const Ref<U>& o) : Ref(o.get()) {}  // NOLINT
    ~Ref() { reset(); }

    Ref& operator=(Ref o) noexcept
    {
        std::swap(p_, o.p_);
        return *this;
    }
    void reset() noexcept
    {
        if (T* p = std::exchange(p_, nullptr)) p->release();
    }

    T* get() const noexcept { return p_; }
    T* operator->() const noexcept { return p_; }
    T& operator*() const noexcept { return *p_; }
    explicit operator bool() const noexcept { return p_ != nullptr; }
    bool operator==(const Ref& o) const noexcept { return p_ == o.p_; }
    bool operator!=(const Ref& o) const noexcept { return p_ != o.p_; }

private:
    T* p_ = nullptr;
};

template <class T, class... A>
Ref<T> makeRef(A&&... a)
{
    return Ref<T>(new T(std::forward<A>(a)...));
}

}  // namespace kg
