// One pass over the motion collects everything that single poses cannot show: hinge axes, sole normals, mean
// directions of bones without length, and the frame that is closest to a standing pose.

#include "CMotionEvidence.h"

#include "Alignment.h"
#include "BodyPose.h"
#include "CPoseSampler.h"
#include "Directions.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

constexpr double kSampleSeconds = 1.0 / 30.0; // contacts need no finer steps

int FrameStep(const BodyMotion& motion)
{
    if (!IsFrameTime(motion.frequency))
        return 1;
    const double step = std::floor(kSampleSeconds / static_cast<double>(motion.frequency) + 0.01);
    return static_cast<int>(std::clamp(step, 1.0, std::max(1.0, motion.frameCount / 30.0)));
}

// Weights of body parts in the search for a reference pose.
constexpr double kFootWeight = 0.5;
constexpr double kElbowWeight = 0.3;
constexpr double kArmWeight = 0.2;

class CWeighedError
{
public:
    void Add(double degrees, double weight = 1.0)
    {
        m_fSum += weight * degrees * degrees;
        m_fWeight += weight;
    }
    double Mean() const { return m_fWeight > 0.0 ? std::sqrt(m_fSum / m_fWeight) : 0.0; }

private:
    double m_fSum = 0.0;
    double m_fWeight = 0.0;
};

void AddArm(const BodyArm& arm, const Vec3& up, const Vec3& sideways, CWeighedError& error)
{
    if (!arm.upperArm || !arm.forearm)
        return;
    const Vec3 upper = WayTo(arm.upperArm, arm.forearm);
    error.Add(std::min(AngleBetween(upper, -up), AngleBetween(upper, sideways)), kArmWeight);
    if (arm.hand)
        error.Add(AngleBetween(upper, WayTo(arm.forearm, arm.hand)), kElbowWeight);
}

// Returns, in degrees, how far a body is from standing upright and straight, weighing the limbs by their
// significance for a reference pose: legs down, shoulders above the hips, arms straight and down or sideways.
double StanceError(const CBodyMap& body, const Vec3& up)
{
    CWeighedError error;
    const Vec3 left = Across(HipLine(body), up);
    const Vec3 facing = Vec3Cross(left, up);
    error.Add(AngleBetween(WayTo(body.hip, TrunkTop(body)), up));
    if (const Vec3 shoulders = ShoulderLine(body); shoulders != kVec3Zero)
        error.Add(AngleBetween(shoulders, left));
    for (const EBodySide side : kBodySides)
    {
        const BodyLeg& leg = body.Leg(side);
        error.Add(AngleBetween(WayTo(leg.thigh, leg.shin), -up));
        error.Add(AngleBetween(WayTo(leg.shin, leg.foot), -up));
        if (const Vec3 ahead = Across(WayTo(leg.foot, leg.toe), up); ahead != kVec3Zero)
            error.Add(AngleBetween(ahead, facing), kFootWeight);
        AddArm(body.Arm(side), up, side == EBodySide::Left ? left : -left, error);
    }
    return error.Mean();
}

void WatchTrunk(const CBodyMap& body, CPoseSampler& sampler)
{
    for (CNode* joint : {body.hip, body.head, TrunkTop(body)})
        sampler.Watch(joint);
}

void WatchLimbs(const CBodyMap& body, CPoseSampler& sampler)
{
    for (const BodyArm& arm : body.arms)
    {
        for (CNode* joint : {arm.upperArm, arm.forearm, arm.hand})
            sampler.Watch(joint);
    }
    for (const BodyLeg& leg : body.legs)
    {
        for (CNode* joint : {leg.thigh, leg.shin, leg.foot, leg.toe})
            sampler.Watch(joint);
    }
}

} // namespace

CMotionEvidence::CMotionEvidence(const BodyMotion& motion, const Mat3& worldTurn,
                                 std::span<const LooseWay> ways, bool seeksFrame)
{
    for (const LooseWay& way : ways)
        m_kWays.push_back({way, kVec3Zero});
    auto hinge = m_kHinges.begin();
    for (const EBodySide side : kBodySides)
    {
        const BodyArm& arm = motion.body.Arm(side);
        const BodyLeg& leg = motion.body.Leg(side);
        *hinge++ = {arm.upperArm, arm.forearm, arm.hand, {}, {}};
        *hinge++ = {leg.thigh, leg.shin, leg.foot, {}, {}};
    }
    Walk(motion, worldTurn, seeksFrame);
}

void CMotionEvidence::Walk(const BodyMotion& motion, const Mat3& worldTurn, bool seeksFrame)
{
    CPoseSampler sampler(motion.frequency);
    if (seeksFrame)
        WatchTrunk(motion.body, sampler);
    WatchLimbs(motion.body, sampler);
    for (const Way& way : m_kWays)
        sampler.Watch(way.joints.to);
    CSoleMeter soles(motion.body, worldTurn);
    const Vec3 up = Turned(kVec3UnitY, Mat3Transpose(worldTurn));
    const int step = FrameStep(motion);
    double leg = 0.0;
    for (int frame = 0; frame < motion.frameCount; frame += step)
    {
        sampler.Pose(frame);
        leg = frame == 0 ? LegLength(motion.body) : leg;
        soles.Add();
        AddFrame();
        if (seeksFrame)
            JudgeFrame(motion.body, up, frame);
    }
    for (const EBodySide side : kBodySides)
        m_kSoles[static_cast<size_t>(side)] =
            soles.Normal(side, leg, static_cast<double>(motion.frequency) * step);
}

void CMotionEvidence::AddFrame()
{
    for (Hinge& hinge : m_kHinges)
    {
        if (!hinge.upper || !hinge.lower || !hinge.end)
            continue;
        const Vec3 upper = WayTo(hinge.upper, hinge.lower);
        const Vec3 lower = WayTo(hinge.lower, hinge.end);
        hinge.inUpper.Add(upper, lower, *hinge.upper);
        hinge.inLower.Add(upper, lower, *hinge.lower);
    }
    for (auto& [joints, sum] : m_kWays)
        sum = sum + LocalDirection(Vec3Normalized(WayTo(joints.from, joints.to)), *joints.from);
}

void CMotionEvidence::JudgeFrame(const CBodyMap& body, const Vec3& up, int frame)
{
    const double error = StanceError(body, up);
    if (m_iReferenceFrame >= 0 && !(error < m_fReferenceError))
        return;
    m_iReferenceFrame = frame;
    m_fReferenceError = error;
}

std::optional<Vec3> CMotionEvidence::MeanWay(const CNode& from) const
{
    for (const auto& [joints, sum] : m_kWays)
    {
        if (joints.from == &from && sum != kVec3Zero)
            return Vec3Normalized(sum);
    }
    return std::nullopt;
}

std::optional<Vec3> CMotionEvidence::HingeAxis(const CNode& bone) const
{
    for (const Hinge& hinge : m_kHinges)
    {
        if (hinge.upper == &bone)
            return hinge.inUpper.Axis();
        if (hinge.lower == &bone)
            return hinge.inLower.Axis();
    }
    return std::nullopt;
}

} // namespace gw
