#include "CheckPoses.h"

#include "BodyPaths.h"
#include "CFindings.h"
#include "CKeyframeControl.h"
#include "CMotionFile.h"
#include "FindBodyByNames.h"
#include "GaitRate.h"
#include "Skeleton.h"

#include <algorithm>
#include <cmath>
#include <string>

namespace gw {

namespace {

constexpr double kLeastTravelShare = 0.1; // of the longest bone: what a joint below a still root must move

constexpr std::string_view kUpNames[2][3] = {
    {"X",  "Y",  "Z" },
    {"-X", "-Y", "-Z"},
};

const CKeyframeControl* TrackOf(const CNode& node)
{
    return RecordCast<CKeyframeControl>(node.GetControl());
}

// The largest distance from the first position that a track has.
double Travel(const CKeyframeControl& track)
{
    double travel = 0.0;
    for (const Vec3& position : track.m_kPositionKeys)
        travel = std::max(travel, Vec3Length(position - track.m_kPositionKeys[0]));
    return travel;
}

bool StandsStill(const CKeyframeControl& track)
{
    const auto& turns = track.m_kRotationKeys;
    return track.m_kPositionKeys.size() > 1 && Travel(track) == 0.0 &&
           std::ranges::all_of(turns, [&](const Quat& turn) { return turn == turns[0]; });
}

double LongestBone(const std::vector<CNode*>& nodes)
{
    double longest = 0.0;
    for (const CNode* node : nodes)
    {
        const CKeyframeControl* const track = TrackOf(*node);
        if (node->GetParentNode() && track)
            longest = std::max(longest, Vec3Length(track->m_kRestMatrix.Translation()));
    }
    return longest;
}

void CheckRoot(CNode& root, CFindings& findings)
{
    const CKeyframeControl* const track = TrackOf(root);
    if (!track || !StandsStill(*track))
        return;
    const double least = kLeastTravelShare * LongestBone(NodesOf(root));
    for (size_t i = 0; i < root.GetChildCount(); ++i)
    {
        const CNode* const child = RecordCast<CNode>(root.ChildAt(i));
        const CKeyframeControl* const below = child ? TrackOf(*child) : nullptr;
        if (below && least > 0.0 && Travel(*below) >= least)
            return findings.Add(EFault::StillRoot, 0, std::string(root.NameView()));
    }
}

// "declared 24 a second, rather 120"
std::string RateWords(double declared, double usual)
{
    return "declared " + std::to_string(std::lround(declared)) + " a second, rather " +
           std::to_string(std::lround(usual));
}

void CheckRate(const BodyPaths& paths, const UpAxis& up, const MotionFacts& facts, CFindings& findings)
{
    const std::optional<Gait> gait = FindGait(paths, up, facts.leg);
    const double rate = 1.0 / facts.frameSeconds;
    if (gait && std::isfinite(rate) && IsOtherRate(*gait, rate))
        findings.Add(EFault::WrongRate, 0, RateWords(rate, gait->UsualRate()));
}

} // namespace

MotionFacts CheckPoses(const CMotionFile& motion, CFindings& findings)
{
    CNode& root = *motion.motionRoot;
    CheckRoot(root, findings);
    const CBodyMap body = FindBodyByNames(root);
    MotionFacts facts;
    facts.jointCount = NodesOf(root).size();
    facts.frameCount = motion.GetKeyCount();
    facts.frameSeconds = static_cast<double>(motion.GetFrequency());
    facts.body = body.DrivesBody() ? EBodySource::Names : EBodySource::None;
    facts.leg = LegLength(body);
    facts.unit = UnitOfLeg(facts.leg);
    facts.restPose = RestPoseOf(body);
    const BodyPaths paths = FollowBody(motion, body);
    if (paths.FrameCount() == 0)
        return facts;
    const UpAxis up = FindUpAxis(paths);
    facts.up = kUpNames[up.negative][up.axis];
    CheckRate(paths, up, facts, findings);
    return facts;
}

} // namespace gw
