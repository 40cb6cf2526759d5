#include "CSourcePoses.h"

#include "BoneMeshQueries.h"
#include "CBoneMesh.h"
#include "CNode.h"
#include "JointSteps.h"

#include <algorithm>
#include <cmath>
#include <iterator>

namespace gw {

namespace {

// A body's axes at rest are those of the file, except for a leaning spine or uneven hips.
Mat3 SnappedToAxes(const Mat3& axes)
{
    constexpr float kNear = 0.85f; // cosine, 32 degrees
    Mat3 snapped{};
    for (size_t i = 0; i < std::size(snapped.m); ++i)
        snapped.m[i] = std::fabs(axes.m[i]) > kNear ? std::copysign(1.0f, axes.m[i]) : 0.0f;
    const bool isWhole = Vec3Dot(Vec3Cross(snapped.Row(0), snapped.Row(1)), snapped.Row(2)) > 0.0;
    return isWhole ? snapped : axes;
}

// Spread legs roll the feet, whose soles are assumed to be flat.
bool HasLegsTogether(const BodyStance& stance)
{
    constexpr double kMostApart = 37.0; // degrees
    return stance.Stands() && *stance.apart < kMostApart;
}

} // namespace

size_t CSourcePoses::Reference() const
{
    for (size_t stance = 0; stance < Count(); ++stance)
    {
        if (HasLegsTogether(StanceIn(tree_, stance, body_)))
            return stance;
    }
    return std::min<size_t>(1, Count() - 1);
}

Mat3 CSourcePoses::Facing(size_t stance) const
{
    const BodyStance axes = StanceIn(tree_, stance, body_);
    Mat3 facing;
    facing.SetRow(0, axes.left);
    facing.SetRow(1, axes.up);
    facing.SetRow(2, axes.forward);
    return stance == 0 ? SnappedToAxes(facing) : facing;
}

Mat3 CSourcePoses::BoneTurn(size_t stance, int joint) const
{
    const CBoneMesh* mesh = FindBoneMesh(*tree_.Node(joint));
    const Mat3 turn = tree_.Stances().Turn(stance, joint);
    return mesh ? NormalizedRows(mesh->m_kMatrix) * turn : turn;
}

Vec3 CSourcePoses::Direction(size_t stance, int from, int to) const
{
    const CStances& stances = tree_.Stances();
    return Vec3Normalized(stances.Place(stance, to) - stances.Place(stance, from));
}

int CSourcePoses::JointBelow(int joint, int goal) const
{
    const CStances& stances = tree_.Stances();
    const std::vector<int> way = tree_.WayDown(joint, goal);
    int at = joint;
    for (size_t step = 0;; ++step)
    {
        const std::vector<int>& children = tree_.Children(at);
        if (step >= way.size() && children.empty())
            return CJointTree::kNone;
        at = step < way.size() ? way[step] : children.front();
        if (ArePlacedApart(stances.Place(0, joint), stances.Place(0, at)))
            return at;
    }
}

} // namespace gw
