#include "KeySpan.h"

#include <cmath>

namespace gw {

namespace {

KeySpan Between(float time, const std::vector<float>& times, uint32_t a, uint32_t b)
{
    const float fraction = (time - times[a]) / (times[b] - times[a]);
    return {std::isfinite(fraction) ? fraction : 0.0f, a, b};
}

} // namespace

KeySpan FindKeys(float time, const std::vector<float>& times, KeyCursor& cursor)
{
    const uint32_t last = static_cast<uint32_t>(times.size()) - 1;
    if (!(time > times[0]))
        return {0.0f, cursor = 0, 0};
    if (time >= times[last])
        return {0.0f, cursor = last, last};
    uint32_t i = std::min(cursor, last);
    // On an ascending axis j cannot leave the range; an axis from a file may not be ascending.
    if (time > times[i])
    {
        uint32_t j = i + 1;
        for (; j < last && time >= times[j]; ++j)
            i = j;
        cursor = i;
        return Between(time, times, i, std::min(j, last));
    }
    if (time == times[i])
        return {0.0f, i, i};
    uint32_t j = i > 0 ? i - 1 : 0;
    for (; j > 0 && time <= times[j]; --j)
        i = j;
    cursor = i;
    return Between(time, times, j, i);
}

} // namespace gw
