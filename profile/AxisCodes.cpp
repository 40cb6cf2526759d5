#include "AxisCodes.h"

#include "Text.h"

#include <algorithm>
#include <cstdlib>

namespace gw {

namespace {

struct AxisNameRow
{
    int code;
    std::string_view text;
};

constexpr AxisNameRow kAxisNames[] = {
    {1,  " X"},
    {-1, "-X"},
    {2,  " Y"},
    {-2, "-Y"},
    {3,  " Z"},
    {-3, "-Z"},
};

} // namespace

int AxisCodeOf(std::string_view text)
{
    const auto same = [=](const AxisNameRow& name) { return EqualNoCase(name.text, text); };
    const auto* found = std::ranges::find_if(kAxisNames, same);
    return found == std::end(kAxisNames) ? 0 : found->code;
}

std::string_view AxisText(int code)
{
    const auto* found = std::ranges::find(kAxisNames, code, &AxisNameRow::code);
    return found == std::end(kAxisNames) ? std::string_view() : found->text;
}

Mat3 AxisMatrix(const AxisCodes& codes)
{
    Mat3 matrix{};
    for (size_t row = 0; row < codes.size(); ++row)
    {
        const int code = codes[row];
        if (code != 0 && code >= -3 && code <= 3)
            matrix.m[3 * row + static_cast<size_t>(std::abs(code)) - 1] = code > 0 ? 1.0f : -1.0f;
    }
    return matrix;
}

} // namespace gw
