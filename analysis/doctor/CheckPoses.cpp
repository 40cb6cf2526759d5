#include "CheckPoses.h"

#include "BVHOutline.h"
#include "BodyPaths.h"
#include "BodyTree.h"
#include "CFindings.h"
#include "CKeyframeControl.h"
#include "CMotionFile.h"
#include "CPoseSampler.h"
#include "CheckBody.h"
#include "Directions.h"
#include "FindBody.h"
#include "FindBodyByNames.h"
#include "GaitRate.h"
#include "Skeleton.h"
#include "UpAxis.h"

#include <algorithm>
#include <cmath>
#include <string>

namespace gw {

namespace {

constexpr double kLeastTravelShare = 0.1; // of the longest bone: least motion below a still root

// Returns the largest distance of a track from its first position.
double Travel(const CKeyframeControl& track)
{
    double travel = 0.0;
    for (const Vec3& position : track.m_kPositionKeys.Distinct())
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

class CPoseCheck
{
public:
    CPoseCheck(CNode& root, const BVHOutline* outline, CFindings& findings)
        : root_(root), m_pkOutline(outline), findings_(findings)
    {
    }

    void CheckRoot()
    {
        const CKeyframeControl* const track = TrackOf(root_);
        if (!track || !StandsStill(*track))
            return;
        const double least = kLeastTravelShare * LongestBone(NodesOf(root_));
        for (const CNode* child : ChildNodes(root_))
        {
            const CKeyframeControl* const below = TrackOf(*child);
            if (below && least > 0.0 && Travel(*below) >= least)
                return Add(EFailure::StillRoot, root_);
        }
    }

    // Compares left and right in the names with the positions of legs or arms.
    void CheckSides()
    {
        const CBodyMap named = FindBodyByNames(root_);
        const std::vector<BodyDoubt> doubts = CheckBody(named);
        const auto doubt = std::ranges::find(doubts, EDoubt::SidesSwapped, &BodyDoubt::kind);
        const CNode* const joint = doubt == doubts.end() ? nullptr : JointAt(named, doubt->place);
        if (joint)
            Add(EFailure::SidesSwapped, *joint);
    }

    // A rate written in place of a frame time shows even without a gait.
    void CheckRate(const BodyPaths& paths, const Vec3& up, const MotionFacts& facts)
    {
        const std::optional<Gait> gait = FindGait(paths, up, facts.leg);
        const double rate = 1.0 / facts.frameSeconds;
        if (!gait || !std::isfinite(rate) || !IsOtherRate(*gait, rate) ||
            findings_.Has(EFailure::RateForTime))
            return;
        findings_.Add(EFailure::WrongRate, m_pkOutline ? m_pkOutline->frameTimeLine : 0,
                      RateWords(rate, gait->UsualRate()));
    }

private:
    void Add(EFailure fault, const CNode& node)
    {
        findings_.Add(fault, LineOf(node), std::string(node.NameView()));
    }
    size_t LineOf(const CNode& node) const
    {
        if (!m_pkOutline)
            return 0;
        const auto joint = std::ranges::find(m_pkOutline->joints, node.NameView(), &OutlineJoint::name);
        return joint == m_pkOutline->joints.end() ? 0 : joint->line;
    }
    // "declared 24 a second, rather 120"
    static std::string RateWords(double declared, double usual)
    {
        return "declared " + std::to_string(std::lround(declared)) + " a second, rather " +
               std::to_string(std::lround(usual));
    }

    CNode& root_;
    const BVHOutline* m_pkOutline;
    CFindings& findings_;
};

EBodySource SourceOf(const FoundBody& found)
{
    if (!found.body.DrivesBody())
        return EBodySource::None;
    const auto isNamed = [](EBodyEvidence evidence) { return evidence >= EBodyEvidence::Name; };
    const auto isThere = [](EBodyEvidence evidence) { return evidence != EBodyEvidence::None; };
    const auto named = std::ranges::count_if(found.evidence, isNamed);
    return 2 * named > std::ranges::count_if(found.evidence, isThere) ? EBodySource::Names
                                                                      : EBodySource::Shape;
}

} // namespace

MotionFacts CheckPoses(const CMotionFile& motion, const BVHOutline* outline, CFindings& findings)
{
    CNode& root = *motion.motionRoot;
    CPoseCheck check(root, outline, findings);
    check.CheckRoot();
    check.CheckSides();
    const FoundBody found = FindBody(root);
    MotionFacts facts;
    facts.jointCount = NodesOf(root).size();
    facts.frameCount = static_cast<size_t>(motion.GetKeyCount());
    facts.frameSeconds = static_cast<double>(motion.GetFrequency());
    facts.body = SourceOf(found);
    facts.leg = RestLegLength(found.body);
    const double unit = motion.imported.unitMeters;
    facts.unit = unit > 0.0 ? UnitOfMeters(unit) : UnitOfLeg(facts.leg);
    if (found.body.DrivesBody())
        facts.restPose = RestStanceOf(found.body).Verdict();
    const BodyPaths paths = FollowBody(motion, found.body);
    if (paths.FrameCount() == 0)
        return facts;
    const Vec3 up = FindUpAxis(found.body, motion.GetFrequency(), motion.GetKeyCount());
    facts.up = AxisName(up);
    check.CheckRate(paths, up, facts);
    return facts;
}

} // namespace gw
