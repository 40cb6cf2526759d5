// Judges a profile that matches by name. Names are not enough: a profile of another program can find all its
// bones and still drive an arm with a clavicle. So the joints are checked as a body, compared with what their
// names mean, and the rotation that the offsets produce at rest is measured.

#include "JudgeProfile.h"

#include "BodyJoints.h"
#include "BodyOfTable.h"
#include "BodySides.h"
#include "BodyTree.h"
#include "CRetargeter.h"
#include "FindBodyByNames.h"
#include "HostBones.h"
#include "RowTurns.h"
#include "Skeleton.h"

#include <algorithm>

namespace gw {

namespace {

// Between a bone that comes out right and one turned by 90 degrees, with room for a bent limb.
constexpr double kAcross = 60.0;

std::string NameOf(const CNode* joint)
{
    return joint ? std::string(joint->NameView()) : std::string();
}

bool IsOneOf(const std::vector<CNode*>& joints, const CNode* joint)
{
    return std::ranges::find(joints, joint) != joints.end();
}

// Returns whether places are equivalent for a profile: any of several necks will do, and no row names a toe
// or distinguishes the joints of a spine.
bool IsSamePlace(const BodyPlace& place, const CBodyMap& byNames, const CNode* joint)
{
    if (place.joint == EBodyJoint::Neck)
        return IsOneOf(byNames.neck, joint);
    return place.joint == EBodyJoint::Spine || place.joint == EBodyJoint::Toe ||
           JointAt(byNames, place) == joint;
}

void CompareNames(const CBodyMap& body, const CBodyMap& byNames, ProfileVerdict& verdict)
{
    for (const BodyPlace& place : BodyPlaces())
    {
        CNode* const joint = JointAt(body, place);
        CNode* const named = JointAt(byNames, place);
        if (joint && named && !IsSamePlace(place, byNames, joint))
            verdict.doubts.push_back({EDoubt::OtherName, NameOf(joint), NameOf(named)});
    }
}

void TakeNamed(CNode* named, const CNode* above, CNode*& joint)
{
    if (named && IsAtOrBelow(named, above))
        joint = named;
}

// No row names a toe, and the joint below a foot need not be one: a middle foot can even point backward. Some
// profiles leave out the hands, without which the length of a forearm is unknown.
void AddUntold(const CBodyMap& byNames, CBodyMap& body)
{
    for (const EBodySide side : kBodySides)
    {
        TakeNamed(byNames.Leg(side).toe, body.Leg(side).foot, body.Leg(side).toe);
        if (!body.Arm(side).hand)
            TakeNamed(byNames.Arm(side).hand, body.Arm(side).forearm, body.Arm(side).hand);
    }
}

// A torso driven by a collar is not part of the spine.
void CheckSpine(const CBodyMap& body, const CNode* chest, ProfileVerdict& verdict)
{
    const auto place = std::ranges::find(body.spine, chest);
    if (place == body.spine.end())
        return;
    verdict.leftOut = static_cast<size_t>(body.spine.end() - place - 1);
    if (verdict.leftOut > 0)
        verdict.doubts.push_back({EDoubt::SpineCut, NameOf(chest), NameOf(body.spine.back())});
}

void CheckTurns(const CRetargeter& table, const CNodeNames& targets, const CBodyMap& body, SourceBody& source,
                ProfileVerdict& verdict)
{
    const BodyStance rest = StanceIn(source.tree, 0, body);
    const std::vector<RowTurn> turns = MeasureTurns(table, targets, body, rest, source.worlds);
    for (const RowTurn& turn : turns)
    {
        verdict.turn += turn.degrees / static_cast<double>(turns.size());
        if (turn.degrees > kAcross)
            verdict.doubts.push_back({EDoubt::Turned, NameOf(table.SourceOf(turn.target)), {}});
    }
}

ESureness SurenessOf(const std::vector<ProfileDoubt>& doubts)
{
    // A body can have unusual proportions.
    const auto isGrave = [](const ProfileDoubt& doubt) { return doubt.kind < EDoubt::OddLength; };
    if (std::ranges::any_of(doubts, isGrave))
        return ESureness::Doubtful;
    return doubts.empty() ? ESureness::Sure : ESureness::Likely;
}

} // namespace

SourceBody::SourceBody(CNode& root) : byNames(FindBodyByNames(root)), tree(root) {}

const std::vector<BodyDoubt>& SourceBody::Check(const CBodyMap& body)
{
    if (body != checked)
    {
        doubts = CheckBody(body, tree);
        checked = body;
    }
    return doubts;
}

ProfileVerdict JudgeProfile(const CRetargeter& table, const CNodeNames& targets, SourceBody& source)
{
    CBodyMap body = BodyOfTable(table, targets);
    AddUntold(source.byNames, body);
    ProfileVerdict verdict;
    for (const BodyDoubt& doubt : source.Check(body))
        verdict.doubts.push_back({doubt.kind, NameOf(JointAt(body, doubt.place)), {}});
    CompareNames(body, source.byNames, verdict);
    CheckSpine(body, table.SourceOf(targets.Find(kTorsoBone)), verdict);
    CheckTurns(table, targets, body, source, verdict);
    verdict.sureness = SurenessOf(verdict.doubts);
    return verdict;
}

} // namespace gw
