// The rules of the dialog that edits one row.

#include "ProfileFixture.h"

#include <gmock/gmock.h>
#include <tuple>

namespace gw {

TEST(BoneOffsetDialog, RotationLimitsAreUneven)
{
    const std::tuple<const char*, int, const char*, const char*> rows[] = {
        {"X at half a circle", 0, "-180", "-180"},     {"X beyond", 0, "181", "7"},
        {"Y at its limit", 1, "179", "179"},           {"Z at half a circle", 2, "180", "7"},
        {"Z with words behind", 2, " -90 deg", "-90"}, {"no number is 0", 0, "", "0"},
        {"beyond 32 bits", 0, "99999999999", "7"},
    };
    for (const auto& [what, axis, text, shown] : rows)
    {
        RowNumbers numbers;
        numbers.rotation = {7, 7, 7};
        CBoneOffsetDialog dialog(numbers);
        dialog.LeaveRotation(axis, text);
        EXPECT_EQ(dialog.RotationText(axis), shown) << what;
        EXPECT_EQ(std::to_string(dialog.Numbers().rotation[size_t(axis)]), shown) << what;
    }
}

TEST(BoneOffsetDialog, ChosenAxisIsSwappedOutOfTheOtherBoxes)
{
    const std::tuple<const char*, int, const char*, AxisCodes, AxisCodes> rows[] = {
        {"Y box holds it", 0, "Y", {1, 2, 3}, {2, 1, 3}},
        {"reversed counts as held", 0, "-Z", {1, 2, 3}, {-3, 2, 1}},
        {"old sign goes along", 2, "X", {1, 2, -3}, {-3, 2, 1}},
        {"own axis reversed", 1, "-Y", {1, 2, 3}, {1, -2, 3}},
        {"both boxes hold it", 0, "Y", {1, 2, -2}, {2, 1, 1}},
    };
    for (const auto& [what, axis, chosen, before, after] : rows)
    {
        RowNumbers numbers;
        numbers.axes = before;
        CBoneOffsetDialog dialog(numbers);
        const auto& entries = CBoneOffsetDialog::kAxisEntries;
        const auto entry = std::find(entries.begin(), entries.end(), chosen) - entries.begin();
        dialog.ChooseAxis(axis, int(entry));
        EXPECT_EQ(dialog.Numbers().axes, after) << what;
        EXPECT_EQ(entries[size_t(dialog.AxisEntry(axis))], chosen) << what;
        dialog.ChooseAxis(axis, 6);
        dialog.ChooseAxis(axis, -1);
        EXPECT_EQ(dialog.Numbers().axes, after) << "no such entries";
    }
}

} // namespace gw
