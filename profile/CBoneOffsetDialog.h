#pragma once

#include "ProfileFile.h"

#include <array>
#include <string>
#include <string_view>

namespace gw {

/// The dialog that edits rotation and axis conversion of one row, without its window: what the fields and
/// boxes show, and what happens when the user leaves or chooses one. Axes are numbered 0, 1, 2 for X, Y, Z.
class CBoneOffsetDialog
{
public:
    /// The entries of each axis box, in order.
    static constexpr std::array<std::string_view, 6> kAxisEntries{"X", "-X", "Y", "-Y", "Z", "-Z"};

    explicit CBoneOffsetDialog(const RowNumbers& numbers = {});

    const RowNumbers& Numbers() const { return m_kNumbers; }

    /// What a rotation field shows.
    const std::string& RotationText(int axis) const { return m_kRotationText[static_cast<size_t>(axis)]; }
    /// A rotation field lost the focus with this text in it: a number within the limits is taken, and the
    /// field shows the number in force. X goes from -180 through 180, Y and Z from -179 through 179.
    void LeaveRotation(int axis, std::string_view text);

    /// The entry that an axis box shows.
    int AxisEntry(int axis) const;
    /// The user chose an entry of an axis box. A box that holds the same axis gets the one that was left, so
    /// that the three stay a signed permutation.
    void ChooseAxis(int axis, int entry);

private:
    RowNumbers m_kNumbers;
    std::array<std::string, 3> m_kRotationText;
};

} // namespace gw
