#pragma once

#include <cstddef>
#include <utility>

namespace gw {

class CObject;

/// A counted reference: keeps a scene object alive. Assignment counts the new object before it releases the
/// old one; an object whose count falls to 0 deletes itself. T may be forward-declared where the reference is
/// only declared.
template <class T>
class Ref
{
public:
    Ref() = default;
    Ref(std::nullptr_t) {}
    Ref(T* object) : m_pkObject(object) { Retain(); }
    Ref(const Ref& other) : m_pkObject(other.m_pkObject) { Retain(); }
    Ref(Ref&& other) noexcept : m_pkObject(std::exchange(other.m_pkObject, nullptr)) {}
    template <class U>
    Ref(const Ref<U>& other) : m_pkObject(other.Get())
    {
        Retain();
    }
    ~Ref() { Drop(m_pkObject); }

    Ref& operator=(const Ref& other)
    {
        if (this != &other)
            Assign(other.m_pkObject);
        return *this;
    }
    Ref& operator=(Ref&& other) noexcept
    {
        if (this != &other)
            Drop(std::exchange(m_pkObject, std::exchange(other.m_pkObject, nullptr)));
        return *this;
    }
    Ref& operator=(T* object)
    {
        Assign(object);
        return *this;
    }

    T* Get() const { return m_pkObject; }
    T* operator->() const { return m_pkObject; }
    T& operator*() const { return *m_pkObject; }
    explicit operator bool() const { return m_pkObject != nullptr; }
    friend bool operator==(const Ref& a, const Ref& b) { return a.m_pkObject == b.m_pkObject; }
    friend bool operator==(const Ref& a, const T* b) { return a.m_pkObject == b; }

private:
    void Retain()
    {
        if (m_pkObject)
            m_pkObject->Retain();
    }
    static void Drop(T* object)
    {
        if (object)
            object->Release();
    }
    void Assign(T* object)
    {
        if (object == m_pkObject)
            return;
        if (object)
            object->Retain();
        Drop(std::exchange(m_pkObject, object));
    }

    T* m_pkObject = nullptr;
};

/// A counted reference from one scene object to another. It is not copied with its owner, since copying an
/// object never copies attachments; cloning fills it in.
template <class T>
class Held : public Ref<T>
{
public:
    using Ref<T>::Ref;
    Held() = default;
    Held(const Held&) : Ref<T>() {}
    Held(Held&& other) noexcept : Ref<T>(std::move(other)) {}
    Held& operator=(const Held& other) = default;
    Held& operator=(Held&& other) noexcept = default;
    using Ref<T>::operator=;
};

} // namespace gw
