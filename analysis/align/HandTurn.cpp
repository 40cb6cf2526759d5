#include "HandTurn.h"

#include "BodyPose.h"
#include "BodyTree.h"
#include "CReferencePose.h"
#include "Directions.h"

#include <algorithm>

namespace gw {

namespace {

// in degrees: a vector farther from the forearm's direction does not show the hand's
constexpr double kMostBend = 60.0;
constexpr size_t kFingersOfAPalm = 3; // plus a thumb
constexpr double kLeastPalm = 0.02;   // of a leg, from knuckle to knuckle

// Returns the vectors from the wrist to the fingers' first joints, if they are apart from it.
std::vector<Vec3> FingerWays(const CNode& hand, double apart)
{
    std::vector<Vec3> ways;
    for (const CNode* finger : ChildNodes(hand))
    {
        Vec3 way = PlaceOf(*finger) - PlaceOf(hand);
        if (Vec3Length(way) <= apart)
            way = way + ReachOf(*finger, apart);
        if (Vec3Length(way) > apart)
            ways.push_back(way);
    }
    if (ways.empty())
        ways.push_back(ReachOf(hand, apart));
    return ways;
}

Vec3 MeanDirection(const std::vector<Vec3>& ways)
{
    Vec3 sum = kVec3Zero;
    for (const Vec3& way : ways)
        sum = sum + Vec3Normalized(way);
    return Vec3Normalized(sum);
}

// Removes the thumb: of two fingers the one farther from the arm's direction, of several the one farthest
// from the others.
Vec3 TakeThumb(std::vector<Vec3>& ways, const Vec3& arm)
{
    const Vec3 middle = ways.size() == 2 ? arm : MeanDirection(ways);
    const auto thumb =
        std::ranges::max_element(ways, {}, [&](const Vec3& way) { return AngleBetween(way, middle); });
    const Vec3 way = *thumb;
    ways.erase(thumb);
    return way;
}

// Returns the vector from the little finger's knuckle to the one beside the thumb; zero if the fingers do not
// spread.
Vec3 PalmLine(const std::vector<Vec3>& ways, const Vec3& thumb, double least)
{
    Vec3 line = kVec3Zero;
    for (const Vec3& a : ways)
    {
        for (const Vec3& b : ways)
        {
            if (Vec3Length(a - b) > Vec3Length(line))
                line = a - b;
        }
    }
    if (Vec3Length(line) < least)
        return kVec3Zero;
    return Vec3Dot(line, thumb - ways.front()) + Vec3Dot(line, thumb - ways.back()) < 0.0 ? -line : line;
}

} // namespace

Mat3 HandTurn(const CNode& hand, EBodySide side, const CReferencePose& pose, const Mat3& start)
{
    const Vec3 axis = side == EBodySide::Left ? kVec3UnitX : -kVec3UnitX;
    std::vector<Vec3> ways = FingerWays(hand, kApart * pose.legLength);
    const bool hasPalm = ways.size() > kFingersOfAPalm;
    const Vec3 thumb = ways.size() > 1 ? TakeThumb(ways, Turned(axis, Mat3Transpose(start))) : kVec3Zero;
    const Vec3 along = Turned(MeanDirection(ways), start);
    if (along == kVec3Zero || AngleBetween(along, axis) > kMostBend)
        return start;
    const Mat3 turn = start * LeastSwing(along, axis);
    const Vec3 palm = hasPalm ? PalmLine(ways, thumb, kLeastPalm * pose.legLength) : kVec3Zero;
    if (palm == kVec3Zero)
        return turn;
    const double twist = TwistBetween(Turned(palm, turn), kVec3UnitZ, axis);
    return turn * TurnAbout(axis, twist);
}

} // namespace gw
