// Positions are added to the offsets. Programs that write positions on every joint mostly mean them to stand
// in place of the offsets: every bone then comes out twice as long. The same happens to the hip alone where
// its height at rest is the root's offset and its channels hold its place in the world.

#include "CheckOffsets.h"

#include "AlongAxis.h"
#include "BVHOutline.h"
#include "CFindings.h"
#include "CRowTable.h"
#include "JointRows.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace gw {

namespace {

constexpr size_t kProbeRows = 8;       // rows of which one may tell that positions repeat the offsets
constexpr double kRepeatShare = 0.01;  // of an offset's length
constexpr double kLeastHipShare = 0.5; // of the reach; a smaller offset is no height of a hip
constexpr double kMostHipShare = 1.6;  // and a larger one is a place in a room
constexpr double kHipMotionShare =
    0.25; // of the reach: the hip stays so near to its height, most of the time

double FiniteOr0(double number)
{
    return std::isfinite(number) ? number : 0.0;
}

// What the rows have of one joint's positions.
class CPositions
{
public:
    CPositions(const OutlineJoint& joint, const CRowTable& table)
        : joint_(joint), table_(table), m_bThere(PositionColumns(joint, m_kColumns))
    {
    }

    bool AreThere() const { return m_bThere && table_.RowCount() > 0; }
    const std::array<size_t, 3>& Columns() const { return m_kColumns; }

    bool RepeatOffset(size_t row) const
    {
        return Vec3Length(At(row) - joint_.offset) <= kRepeatShare * Vec3Length(joint_.offset);
    }
    // Whether they stay nearer to the offset than to its lack.
    bool StandForOffset() const
    {
        double toOffset = 0.0;
        double toZero = 0.0;
        for (size_t row = 0; row < table_.RowCount(); ++row)
        {
            toOffset += FiniteOr0(Vec3Length(At(row) - joint_.offset));
            toZero += FiniteOr0(Vec3Length(At(row)));
        }
        return toOffset < toZero;
    }
    // From the offset, along one axis.
    double MeanDistance(size_t axis) const
    {
        double sum = 0.0;
        for (size_t row = 0; row < table_.RowCount(); ++row)
            sum += FiniteOr0(std::fabs(AlongAxis(At(row) - joint_.offset, axis)));
        return sum / static_cast<double>(table_.RowCount());
    }

private:
    Vec3 At(size_t row) const { return PositionIn(table_, row, m_kColumns); }

    const OutlineJoint& joint_;
    const CRowTable& table_;
    std::array<size_t, 3> m_kColumns{};
    bool m_bThere;
};

class COffsetCheck
{
public:
    COffsetCheck(const BVHOutline& outline, const CRowTable& table, CFindings& findings)
        : outline_(outline), table_(table), findings_(findings)
    {
    }

    std::vector<float> Run()
    {
        CheckHip();
        CheckBones();
        return m_kSubtrahends;
    }

private:
    void CheckHip()
    {
        const OutlineJoint& root = outline_.joints.front();
        const CPositions positions(root, table_);
        if (!positions.AreThere() || !HoldsHeight(root, positions))
            return;
        findings_.Add(EFault::DoubledHipOffset, root.offsetLine, root.name);
        Subtract(root, positions);
    }
    // Which way is up is not known here: some way the height must stand in both.
    bool HoldsHeight(const OutlineJoint& root, const CPositions& positions) const
    {
        const double reach = SkeletonReach(outline_);
        for (size_t axis = 0; axis < 3; ++axis)
        {
            const double height = std::fabs(AlongAxis(root.offset, axis));
            if (height > 0.0 && height >= kLeastHipShare * reach && height <= kMostHipShare * reach &&
                positions.MeanDistance(axis) <= kHipMotionShare * reach)
                return true;
        }
        return false;
    }
    void CheckBones()
    {
        const OutlineJoint* first = nullptr;
        for (size_t row = 0; row < std::min(kProbeRows, table_.RowCount()) && !first; ++row)
            first = FirstRepeatingIn(row);
        if (!first)
            return;
        findings_.Add(EFault::DoubledOffset, first->offsetLine, first->name);
        for (const OutlineJoint& joint : outline_.joints)
        {
            const CPositions positions(joint, table_);
            if (IsCandidate(joint, positions) && positions.StandForOffset())
                Subtract(joint, positions);
        }
    }
    static bool IsCandidate(const OutlineJoint& joint, const CPositions& positions)
    {
        return joint.parent != OutlineJoint::kNoParent && joint.offset != kVec3Zero && positions.AreThere();
    }
    // The first joint that repeats its offset, where at least half of those that can do so.
    const OutlineJoint* FirstRepeatingIn(size_t row) const
    {
        const OutlineJoint* first = nullptr;
        size_t candidates = 0;
        size_t repeating = 0;
        for (const OutlineJoint& joint : outline_.joints)
        {
            const CPositions positions(joint, table_);
            if (!IsCandidate(joint, positions))
                continue;
            ++candidates;
            if (!positions.RepeatOffset(row))
                continue;
            ++repeating;
            first = first ? first : &joint;
        }
        return repeating * 2 >= candidates ? first : nullptr;
    }
    void Subtract(const OutlineJoint& joint, const CPositions& positions)
    {
        m_kSubtrahends.resize(table_.ColumnCount());
        for (size_t axis = 0; axis < 3; ++axis)
            m_kSubtrahends[positions.Columns()[axis]] = AlongAxis(joint.offset, axis);
    }

    const BVHOutline& outline_;
    const CRowTable& table_;
    CFindings& findings_;
    std::vector<float> m_kSubtrahends;
};

} // namespace

double SkeletonReach(const BVHOutline& outline)
{
    double reach = 0.0;
    std::vector<Vec3> places;
    places.reserve(outline.joints.size());
    for (const OutlineJoint& joint : outline.joints)
    {
        const bool root = joint.parent == OutlineJoint::kNoParent;
        places.push_back(root ? kVec3Zero : places[joint.parent] + joint.offset);
        reach = std::max(reach, Vec3Length(places.back()));
    }
    return reach;
}

std::vector<float> CheckOffsets(const BVHOutline& outline, const CRowTable& table, CFindings& findings)
{
    return outline.joints.empty() ? std::vector<float>() : COffsetCheck(outline, table, findings).Run();
}

} // namespace gw
