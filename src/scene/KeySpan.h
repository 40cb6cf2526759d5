#pragma once

#include "CKeyArray.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <vector>

namespace gw {

/// A search position on a time axis that stays where it was, so that sequential play costs one compare or
/// two.
using KeyCursor = uint32_t;

/// The keys around a key time: it lies at `fraction` between indices a and b.
struct KeySpan
{
    float fraction;
    uint32_t a;
    uint32_t b;
};

/// The keys around a time on an ascending axis, which must not be empty. On an axis that is not ascending, as
/// files may have it, the indices still lie within.
KeySpan FindKeys(float time, const std::vector<float>& times, KeyCursor& cursor);

/// A key by its index. Files may hold fewer keys than times: the last key stands in for those that are
/// missing. There must be one.
template <class T>
const T& KeyAt(const std::vector<T>& keys, uint32_t index)
{
    return keys[std::min<size_t>(index, keys.size() - 1)];
}

template <class T>
const T& KeyAt(const CKeyArray<T>& keys, uint32_t index)
{
    return keys[index];
}

/// The value between two keys; `empty` where there are none. Keys is a vector or a CKeyArray.
template <class Keys, class T>
T LinearKey(const Keys& keys, const KeySpan& span, const T& empty)
{
    if (keys.empty())
        return empty;
    const T& a = KeyAt(keys, span.a);
    return span.fraction == 0.0f ? a : a + (KeyAt(keys, span.b) - a) * span.fraction;
}

} // namespace gw
