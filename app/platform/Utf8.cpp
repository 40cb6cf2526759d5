#include "Utf8.h"

namespace gw {

void AppendUtf8(std::string& text, uint32_t point)
{
    if (point > 0x10ffff || (point >= 0xd800 && point < 0xe000))
        point = 0xfffd;
    if (point < 0x80)
    {
        text += static_cast<char>(point);
        return;
    }
    const int tailCount = point < 0x800 ? 1 : point < 0x10000 ? 2 : 3;
    constexpr uint32_t kLead[] = {0, 0xc0, 0xe0, 0xf0};
    text += static_cast<char>(kLead[tailCount] | point >> (6 * tailCount));
    for (int i = tailCount - 1; i >= 0; --i)
        text += static_cast<char>(0x80 | (point >> (6 * i) & 0x3f));
}

} // namespace gw
