// Positions are added to the offsets. Programs that write positions on every joint mostly mean them to
// replace the offsets: every bone then comes out twice as long. The same happens to the hip alone if its rest
// height is the root's offset and its channels contain its position in the world.

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

constexpr size_t kProbeRows = 8;       // rows that can show that positions repeat the offsets
constexpr double kRepeatShare = 0.01;  // of an offset's length
constexpr double kLeastHipShare = 0.5; // of the reach; a smaller offset is not a hip height
constexpr double kMostHipShare = 1.6;  // and a larger one is a position in a room
constexpr double kHipMotionShare =
    0.25; // of the reach: the hip stays this close to its height most of the time

double FiniteOr0(double number)
{
    return std::isfinite(number) ? number : 0.0;
}

// The position values of one joint in all rows.
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
    // Returns whether they are closer to the offset than to zero.
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
    // Returns the distance from the offset along one axis.
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
        findings_.Add(EFailure::DoubledHipOffset, root.offsetLine, root.name);
        Subtract(root, positions);
    }
    // The up axis is unknown here, so the height must be repeated along some axis of both.
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
        findings_.Add(EFailure::DoubledBone, first->offsetLine, first->name);
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
    // Returns the first joint that repeats its offset, if at least half of the joints that could do so do.
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
