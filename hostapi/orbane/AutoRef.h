#pragma once

#include <cstddef>
#include <type_traits>
#include <utility>

namespace Orbane {

// Holds one reference to a reference-counted host object (anything with
// IncRef/DecRef) and gives it back when it goes. Null-safe throughout.
template <class T> class AutoRef
{
public:
    AutoRef() noexcept = default;
    AutoRef(std::nullptr_t) noexcept {}
    // Takes over a reference the caller already owns (a new object, or the
    // result of an operation that returns a new reference).
    explicit AutoRef(T *adopt) noexcept : mPtr(adopt) {}
    // Adds a reference of its own to an object someone else keeps.
    static AutoRef Share(T *p) noexcept
    {
        if (p)
            p->IncRef();
        return AutoRef(p);
    }

    AutoRef(const AutoRef &o) noexcept : AutoRef(Share(o.mPtr)) {}
    AutoRef(AutoRef &&o) noexcept : mPtr(std::exchange(o.mPtr, nullptr)) {}
    template <class U, class = std::enable_if_t<std::is_convertible_v<U *, T *>>>
    AutoRef(AutoRef<U> &&o) noexcept : mPtr(o.Take())
    {
    }
    template <class U, class = std::enable_if_t<std::is_convertible_v<U *, T *>>>
    AutoRef(const AutoRef<U> &o) noexcept : AutoRef(Share(o.get()))
    {
    }
    AutoRef &operator=(AutoRef o) noexcept
    {
        std::swap(mPtr, o.mPtr);
        return *this;
    }
    ~AutoRef()
    {
        if (mPtr)
            mPtr->DecRef();
    }

    T *get() const noexcept { return mPtr; }
    T *operator->() const noexcept { return mPtr; }
    T &operator*() const noexcept { return *mPtr; }
    operator T *() const noexcept { return mPtr; }
    bool IsValid() const noexcept { return mPtr != nullptr; }

    // Hands the reference to the caller, leaving this empty.
    T *Take() noexcept { return std::exchange(mPtr, nullptr); }
    // Drops the held reference and adopts `adopt`.
    void Reset(T *adopt = nullptr) noexcept { AutoRef(adopt).Swap(*this); }
    void Swap(AutoRef &o) noexcept { std::swap(mPtr, o.mPtr); }

private:
    T *mPtr = nullptr;
};

} // namespace Orbane
