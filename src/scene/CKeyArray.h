#pragma once

#include <algorithm>
#include <cstddef>
#include <cstring>
#include <initializer_list>
#include <span>
#include <type_traits>
#include <utility>
#include <vector>

namespace gw {

/// The keys of a track. While all keys are equal, bit for bit, only one is stored: most bones never change
/// their length, and almost none its scale. An index past the end returns the last key; the array must not be
/// empty.
/// one.
template <class T>
class CKeyArray
{
    static_assert(std::is_trivially_copyable_v<T>);

public:
    CKeyArray() = default;
    CKeyArray(std::initializer_list<T> keys) : CKeyArray(std::vector<T>(keys)) {}
    /// Stores one key if all are equal.
    CKeyArray(std::vector<T> keys) : m_uiSize(keys.size())
    {
        const auto differs = [&](const T& key) { return !IsSame(key, keys.front()); };
        if (std::ranges::any_of(keys, differs))
            m_kStored = std::move(keys);
        else if (!keys.empty())
            m_kStored.assign(1, keys.front());
    }

    size_t size() const { return m_uiSize; }
    bool empty() const { return m_uiSize == 0; }
    const T& operator[](size_t index) const { return m_kStored[std::min(index, m_kStored.size() - 1)]; }
    const T& front() const { return m_kStored.front(); }
    const T& back() const { return m_kStored.back(); }
    /// Returns the stored keys: one if all are equal, otherwise all.
    std::span<const T> Distinct() const { return m_kStored; }

    /// Announces the number of keys. Allocates nothing until keys differ.
    void reserve(size_t count) { m_uiExpected = count; }
    void assign(size_t count, const T& key)
    {
        m_kStored.assign(count > 0 ? 1 : 0, key);
        m_uiSize = count;
    }
    void push_back(const T& key)
    {
        if (m_uiSize == 0)
            m_kStored.assign(1, key);
        else if (m_kStored.size() != 1 || !IsSame(key, m_kStored.front()))
            Expand().push_back(key);
        ++m_uiSize;
    }
    /// Replaces the key at an index, which must be below size().
    void Set(size_t index, const T& key)
    {
        if (m_kStored.size() != 1 || !IsSame(key, m_kStored.front()))
            Expand()[index] = key;
    }
    /// Returns all keys, stored separately, for editing. Do not change their number.
    std::vector<T>& Expand()
    {
        if (m_kStored.size() < m_uiSize)
        {
            m_kStored.reserve(std::max(m_uiExpected, m_uiSize + 1));
            m_kStored.resize(m_uiSize, T(m_kStored.front()));
        }
        return m_kStored;
    }

    friend bool operator==(const CKeyArray& a, const CKeyArray& b)
    {
        for (size_t i = 0; i < std::min(a.size(), b.size()); ++i)
        {
            if (!(a[i] == b[i]))
                return false;
        }
        return a.size() == b.size();
    }

private:
    // By bytes: -0 and 0 are different keys, and a NaN equals itself. Keys are floats without gaps.
    static bool IsSame(const T& a, const T& b)
    {
        return std::memcmp(&a, &b, sizeof(T)) == 0; // NOLINT(bugprone-suspicious-memory-comparison)
    }

    std::vector<T> m_kStored; // empty, one key for all, or all keys
    size_t m_uiSize = 0;
    size_t m_uiExpected = 0;
};

} // namespace gw
