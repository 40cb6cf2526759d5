#include "CBoneOffsetDialog.h"

#include "Numbers.h"

#include <cstdlib>
#include <utility>

namespace gw {

namespace {

// The limits differ by design: only X can be rotated by half a turn.
constexpr std::array<int, 3> kRotationLimit{180, 179, 179};

// The other two boxes, in the order in which they are checked.
constexpr std::array<std::array<size_t, 2>, 3> kOtherAxes{
    {{1, 2}, {0, 2}, {0, 1}}
};

} // namespace

CBoneOffsetDialog::CBoneOffsetDialog(const RowNumbers& numbers, std::string source, std::string target)
    : m_kNumbers(numbers), m_kSource(std::move(source)), m_kTarget(std::move(target))
{
    for (size_t axis = 0; axis < m_kRotationText.size(); ++axis)
        m_kRotationText[axis] = std::to_string(numbers.rotation[axis]);
}

void CBoneOffsetDialog::LeaveRotation(int axis, std::string_view text)
{
    const auto index = static_cast<size_t>(axis);
    const int limit = kRotationLimit[index];
    const int degrees = ParseInt(text);
    if (degrees >= -limit && degrees <= limit)
        m_kNumbers.rotation[index] = degrees;
    m_kRotationText[index] = std::to_string(m_kNumbers.rotation[index]);
}

int CBoneOffsetDialog::AxisEntry(int axis) const
{
    const int code = m_kNumbers.axes[static_cast<size_t>(axis)];
    return 2 * (std::abs(code) - 1) + (code < 0 ? 1 : 0);
}

void CBoneOffsetDialog::ChooseAxis(int axis, int entry)
{
    if (entry < 0 || static_cast<size_t>(entry) >= kAxisEntries.size())
        return;
    AxisCodes& axes = m_kNumbers.axes;
    const auto index = static_cast<size_t>(axis);
    const int letter = entry / 2 + 1;
    const int left = axes[index];
    axes[index] = entry % 2 == 0 ? letter : -letter;
    for (const size_t other : kOtherAxes[index])
    {
        if (std::abs(axes[other]) == letter)
            axes[other] = left;
    }
}

} // namespace gw
