#include "CFaithfulLeg.h"

#include "CPoseSampler.h"
#include "Directions.h"
#include "JointSteps.h"
#include "SmoothCurve.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

// The share of a foot's pitch by which the toe end of its sole turns. Toes that stay flat would turn by 0,
// toes that do not bend by 1. How a source bends them is not followed, because some bend them within one
// frame.
constexpr double kToeTurn = 0.35;

constexpr double kKneeSeconds = 0.04; // over which the direction of a straight leg's knee is smoothed

size_t IndexOf(const CPoseMatcher& matcher, const CNode* node)
{
    return static_cast<size_t>(matcher.IndexOf(node));
}

double SegmentLength(const CNode& joint)
{
    return Vec3Length(joint.m_kMatrix.Translation());
}

// Returns the direction from one joint to the next, or `before` if both are at the same position.
Vec3 DirectionOr(const Vec3& before, const CNode& from, const CNode& to)
{
    const Vec3 direction =
        Vec3Normalized(to.m_kWorldMatrix.Translation() - from.m_kWorldMatrix.Translation());
    return direction == kVec3Zero ? before : direction;
}

// Returns whether the leg has all joints that are needed: thigh, knee and ankle.
bool IsWhole(const LegJoints& leg)
{
    return leg.thigh && leg.knee && leg.ankle;
}

std::vector<size_t> PathTo(const CPoseMatcher& matcher, const CNode& joint)
{
    std::vector<size_t> path;
    for (const CNode* node = &joint; node && matcher.IndexOf(node) >= 0; node = node->GetParentNode())
        path.push_back(IndexOf(matcher, node));
    std::ranges::reverse(path);
    return path;
}

} // namespace

std::optional<CFaithfulLeg> CFaithfulLeg::Plan(const CRetargeter& retargeter, const CPoseMatcher& matcher,
                                               const LegJoints& target, double restFloor)
{
    if (!IsWhole(target) || target.ankle->GetParentNode() != target.knee ||
        target.knee->GetParentNode() != target.thigh)
        return std::nullopt;
    LegJoints source{retargeter.SourceOf(target.thigh), retargeter.SourceOf(target.knee),
                     retargeter.SourceOf(target.ankle)};
    if (!IsWhole(source) || source.thigh == source.knee || source.knee == source.ankle)
        return std::nullopt;
    source.toe =
        ToeFrom(JointBelow(*source.ankle, retargeter.SourceOf(target.toe)), *source.knee, *source.ankle);
    return CFaithfulLeg(matcher, source, target, restFloor);
}

CFaithfulLeg::CFaithfulLeg(const CPoseMatcher& matcher, const LegJoints& source, const LegJoints& target,
                           double restFloor)
    : m_kSource(source), m_uiThigh(IndexOf(matcher, target.thigh)), m_uiCalf(IndexOf(matcher, target.knee)),
      m_uiFoot(IndexOf(matcher, target.ankle)),
      m_iToe(matcher.IndexOf(target.toe)), m_kLengths{SegmentLength(*target.knee),
                                                      SegmentLength(*target.ankle)},
      m_kHeelSole(SoleUnder(*target.ankle, restFloor)),
      m_kPath(PathTo(matcher, target.toe ? *target.toe : *target.ankle))
{
    if (target.toe)
    {
        m_fToeSole = static_cast<float>(Vec3Length(SoleUnder(*target.toe, restFloor)));
        m_kFlatToe =
            ToePlaceOf(RestWorld(*target.toe).Translation() - RestWorld(*target.ankle).Translation());
    }
}

void CFaithfulLeg::AppendSource()
{
    const Frame before = m_kFrames.empty() ? Frame{-kVec3UnitY, -kVec3UnitY} : m_kFrames.back();
    m_kFrames.push_back({DirectionOr(before.thigh, *m_kSource.thigh, *m_kSource.knee),
                         DirectionOr(before.shin, *m_kSource.knee, *m_kSource.ankle)});
}

void CFaithfulLeg::ReadTarget(const CPoseMatcher& matcher, size_t frame, const ToePlace& moved)
{
    const auto& bones = matcher.Bones();
    const Mat4& ankle = bones[m_uiFoot].world;
    Frame& at = m_kFrames[frame];
    const Mat4& thigh = bones[m_uiThigh].world;
    at.hip = thigh.Translation() - bones[m_kPath.front()].world.Translation();
    const Vec3 line = Vec3Normalized(Stretch(frame));
    const Vec3 knee = at.thigh * static_cast<float>(m_kLengths.upper);
    at.knee = knee - line * static_cast<float>(Vec3Dot(knee, line));
    at.pitch = kMat3Identity;
    at.heelEnd = TransformCoord(m_kHeelSole, ankle) - ankle.Translation();
    Mat3 pitch = kMat3Identity;
    if (HasToe())
    {
        at.toe = bones[static_cast<size_t>(m_iToe)].world.Translation() - ankle.Translation();
        pitch = PitchFoot(at.toe, {m_kFlatToe.ahead + moved.ahead, m_kFlatToe.height + moved.height});
    }
    TurnFoot(frame, pitch);
    m_kForward = m_kForward + ToLocal(at.thigh - at.shin, NormalizedRows(thigh));
}

void CFaithfulLeg::SteadyKnee(double secondsPerFrame)
{
    std::vector<Vec3> knees;
    for (const Frame& at : m_kFrames)
        knees.push_back(at.knee);
    SteadySides(knees, m_kLengths.upper, kKneeSeconds / secondsPerFrame);
    for (size_t frame = 0; frame < knees.size(); ++frame)
        m_kFrames[frame].knee = knees[frame];
}

void CFaithfulLeg::TurnFoot(size_t frame, const Mat3& turn)
{
    Frame& at = m_kFrames[frame];
    at.pitch = at.pitch * turn;
    at.heelEnd = Turned(at.heelEnd, turn);
    at.heel = -at.heelEnd.y;
    at.sole = at.heel;
    if (!HasToe())
        return;
    at.toe = Turned(at.toe, turn);
    const double ankleHeight = Vec3Length(at.heelEnd);
    const double upright = ankleHeight > 0.0 ? static_cast<double>(at.heel) / ankleHeight : 1.0;
    at.toeSole = m_fToeSole * static_cast<float>(1.0 - kToeTurn * (1.0 - upright));
    at.sole = std::max(at.heel, ToeSole(frame));
}

float CFaithfulLeg::ToeSole(size_t frame) const
{
    return !HasToe() ? 0.0f : m_kFrames[frame].toeSole - m_kFrames[frame].toe.y;
}

Vec3 CFaithfulLeg::Stretch(size_t frame) const
{
    const Frame& at = m_kFrames[frame];
    return at.thigh * static_cast<float>(m_kLengths.upper) + at.shin * static_cast<float>(m_kLengths.lower);
}

double CFaithfulLeg::KneeBend(size_t frame) const
{
    const Frame& at = m_kFrames[frame];
    const Vec3 off = at.thigh - at.shin; // the chord of the angle between unit vectors
    return std::min(0.5 * Vec3Length(off), 1.0);
}

Vec3 CFaithfulLeg::Forward(const CPoseMatcher& matcher) const
{
    return Turned(m_kForward, NormalizedRows(matcher.Bones()[m_uiThigh].world));
}

} // namespace gw
