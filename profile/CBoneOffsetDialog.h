#pragma once

#include "ProfileFile.h"

#include <array>
#include <string>
#include <string_view>

namespace gw {

/// The dialog for rotation and axis conversion of one row, without its window: the contents of fields and
/// boxes, and the effect of user input. Axes are numbered 0, 1, 2 for X, Y, Z.
class CBoneOffsetDialog
{
public:
    /// Entries of each axis box, in order.
    static constexpr std::array<std::string_view, 6> kAxisEntries{"X", "-X", "Y", "-Y", "Z", "-Z"};

    /// Edits the numbers of a row with these two bones.
    explicit CBoneOffsetDialog(const RowNumbers& numbers = {}, std::string source = {},
                               std::string target = {});

    const RowNumbers& Numbers() const { return m_kNumbers; }
    const std::string& Source() const { return m_kSource; }
    const std::string& Target() const { return m_kTarget; }

    /// Returns the text of a rotation field.
    const std::string& RotationText(int axis) const { return m_kRotationText[static_cast<size_t>(axis)]; }
    /// Handles a rotation field losing the focus: a number within the limits is accepted, and the field shows
    /// the current number. The range is -180 to 180 for X, and -179 to 179 for Y and Z.
    void LeaveRotation(int axis, std::string_view text);

    /// Returns the selected entry of an axis box.
    int AxisEntry(int axis) const;
    /// Selects an entry of an axis box. If another box has the same axis, it gets the old one, so that the
    /// three remain a signed permutation.
    void ChooseAxis(int axis, int entry);

private:
    RowNumbers m_kNumbers;
    std::string m_kSource;
    std::string m_kTarget;
    std::array<std::string, 3> m_kRotationText;
};

} // namespace gw
