#pragma once

#include "CObject.h"

namespace gw {

/// A pointer from one scene object to another that is not counted and becomes null when the other dies. Like
/// Held, it is not copied with its owner; cloning sets it. It can be moved, so arrays of it can grow.
template <class T>
class Watch
{
public:
    Watch() = default;
    Watch(const Watch&) {}
    Watch(Watch&& other) noexcept
    {
        Set(other.Get());
        other.Set(nullptr);
    }
    Watch& operator=(const Watch& other)
    {
        Set(other.Get());
        return *this;
    }
    Watch& operator=(Watch&& other) noexcept
    {
        if (this != &other)
        {
            Set(other.Get());
            other.Set(nullptr);
        }
        return *this;
    }
    ~Watch() = default;

    T* Get() const { return static_cast<T*>(m_kWatcher.Object()); }
    T* operator->() const { return Get(); }
    explicit operator bool() const { return Get() != nullptr; }
    void Set(T* object) { m_kWatcher.Watch(object); }

private:
    CWatcher m_kWatcher;
};

} // namespace gw
