#pragma once

#include "CKeyArray.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <vector>

namespace gw {

/// The last search position on a time axis. Keeping it makes sequential playback cost one or two comparisons.
using KeyCursor = uint32_t;

/// The keys around a key time, which lies at `fraction` between indices a and b.
struct KeySpan
{
    float fraction;
    uint32_t a;
    uint32_t b;
};

/// Returns the keys around a time on an ascending axis, which must not be empty. On an axis that is not
/// ascending, as some files have, the indices are still in range.
KeySpan FindKeys(float time, const std::vector<float>& times, KeyCursor& cursor);

/// Returns a key by index. Files can have fewer keys than times: the last key then stands in for missing
/// ones. There must be at least one key.
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

/// Returns the value between two keys; `empty` without keys. Keys is a vector or a CKeyArray.
template <class Keys, class T>
T LinearKey(const Keys& keys, const KeySpan& span, const T& empty)
{
    if (keys.empty())
        return empty;
    const T& a = KeyAt(keys, span.a);
    return span.fraction == 0.0f ? a : a + (KeyAt(keys, span.b) - a) * span.fraction;
}

} // namespace gw
