// Names are read one by one (JointWords) and then interpreted together, because the same word names different
// joints in different families of skeletons. Where the trunk's names are unclear, the tree decides: the hip
// is where legs and head branch, and the spine is the path from there to the neck.

#include "FindBodyByNames.h"

#include "BodyTree.h"
#include "JointNames.h"
#include "Skeleton.h"

#include <algorithm>
#include <tuple>
#include <unordered_map>

namespace gw {

namespace {

struct Candidate
{
    CNode* node = nullptr;
    JointName name;
    size_t depth = 0;

    // A joint comes before its helpers, and the first of several before the others.
    auto Order() const { return std::tuple(name.helper, name.number, depth); }
};

// The named joints of a skeleton, by word and side.
class CNamedJoints
{
public:
    explicit CNamedJoints(CNode& root);

    CNode* Find(EJointWord word, ENameSide side = ENameSide::None) const
    {
        return m_kBest[static_cast<size_t>(word)][static_cast<size_t>(side)].node;
    }
    /// Returns the deepest joint of the trunk with a word, or null.
    CNode* FindDeepest(EJointWord word) const;
    bool Says(const CNode* node, EJointWord word) const;

private:
    void Add(const Candidate& candidate);

    std::vector<Candidate> m_kAll;
    std::unordered_map<const CNode*, EJointWord> m_kWord;
    Candidate m_kBest[kJointWordCount][3];
};

CNamedJoints::CNamedJoints(CNode& root)
{
    const std::vector<CNode*> nodes = NodesOf(root);
    const std::vector<JointName> names = ReadJointNames(nodes);
    std::unordered_map<const CNode*, size_t> depths; // parents precede their children
    for (size_t i = 0; i < nodes.size(); ++i)
    {
        const auto parent = depths.find(nodes[i]->GetParentNode());
        const size_t depth = depths[nodes[i]] = parent == depths.end() ? 0 : parent->second + 1;
        if (names[i].word != EJointWord::None)
            Add({nodes[i], names[i], depth});
    }
}

void CNamedJoints::Add(const Candidate& candidate)
{
    m_kAll.push_back(candidate);
    m_kWord[candidate.node] = candidate.name.word;
    const JointName& name = candidate.name;
    Candidate& best = m_kBest[static_cast<size_t>(name.word)][static_cast<size_t>(name.side)];
    if (!best.node || candidate.Order() < best.Order())
        best = candidate;
}

CNode* CNamedJoints::FindDeepest(EJointWord word) const
{
    const Candidate* deepest = nullptr;
    for (const Candidate& candidate : m_kAll)
    {
        if (candidate.name.word == word && (!deepest || candidate.depth > deepest->depth))
            deepest = &candidate;
    }
    return deepest ? deepest->node : nullptr;
}

bool CNamedJoints::Says(const CNode* node, EJointWord word) const
{
    const auto found = m_kWord.find(node);
    return found != m_kWord.end() && found->second == word;
}

CNode* FirstOf(std::initializer_list<CNode*> nodes)
{
    const auto found = std::ranges::find_if(nodes, [](const CNode* node) { return node != nullptr; });
    return found == nodes.end() ? nullptr : *found;
}

// LeftShoulder is the clavicle if there is a LeftArm or another upper arm, otherwise the upper arm.
BodyArm ArmOf(const CNamedJoints& joints, ENameSide side)
{
    using enum EJointWord;
    const auto find = [&](EJointWord word) { return joints.Find(word, side); };
    CNode* const arm = FirstOf({find(UpperArm), find(Arm)});
    CNode* const shoulder = find(Shoulder);
    return {FirstOf({find(Clavicle), arm ? shoulder : nullptr}), FirstOf({arm, shoulder}), find(Forearm),
            FirstOf({find(Wrist), find(Hand)})};
}

// LeftLeg is the shin if something else is the thigh. LeftFoot is the toe if LeftAnkle is the foot.
BodyLeg LegOf(const CNamedJoints& joints, ENameSide side)
{
    using enum EJointWord;
    const auto find = [&](EJointWord word) { return joints.Find(word, side); };
    CNode* const shin = find(Shin);
    CNode* const thigh = FirstOf({find(Thigh), find(SideHip), shin ? find(Leg) : nullptr});
    CNode* const ankle = find(Ankle);
    return {thigh, FirstOf({shin, find(Leg)}), FirstOf({ankle, find(Foot)}),
            FirstOf({find(Toe), ankle ? find(Foot) : nullptr})};
}

// In rigs that call the whole trunk spine, or have a neck but no head, the last such joint is the head.
CNode* HeadOf(const CNamedJoints& joints, const CNode* chest)
{
    using enum EJointWord;
    CNode* const named = FirstOf({joints.Find(Head), joints.Find(HeadEnd), joints.FindDeepest(Neck)});
    CNode* const last = joints.FindDeepest(Spine);
    return named ? named : last != chest && IsAtOrBelow(last, chest) ? last : nullptr;
}

// Returns the joint named hip, or, if legs or head are not below it, the joint where they branch.
CNode* HipOf(const CNamedJoints& joints, const CBodyMap& body)
{
    CNode* const legs = CommonAncestor(body.legs[0].thigh, body.legs[1].thigh);
    CNode* const parting = CommonAncestor(legs, body.head);
    CNode* const named = FirstOf({joints.Find(EJointWord::Hip), joints.Find(EJointWord::HipBase)});
    const bool carriesBody = !parting || IsAtOrBelow(parting, named);
    return named && carriesBody ? named : parting;
}

// Fills the path from hip to head: spine up to the first joint named neck, otherwise up to where the arms
// branch.
void FillTrunk(const CNamedJoints& joints, const CNode* chest, CBodyMap& body)
{
    const std::vector<CNode*> way = NodesBetween(body.hip, body.head);
    auto neck = std::ranges::find_if(way, [&](CNode* node) { return joints.Says(node, EJointWord::Neck); });
    const auto top = std::ranges::find(way, chest);
    if (neck == way.end() && top != way.end())
        neck = top + 1;
    body.spine.assign(way.begin(), neck);
    body.neck.assign(neck, way.end());
}

} // namespace

CBodyMap FindBodyByNames(CNode& root)
{
    const CNamedJoints joints(root);
    CBodyMap body;
    body.arms = {ArmOf(joints, ENameSide::Left), ArmOf(joints, ENameSide::Right)};
    body.legs = {LegOf(joints, ENameSide::Left), LegOf(joints, ENameSide::Right)};
    const CNode* const chest = CommonAncestor(body.arms[0].upperArm, body.arms[1].upperArm);
    body.head = HeadOf(joints, chest);
    body.hip = HipOf(joints, body);
    FillTrunk(joints, chest, body);
    return body;
}

} // namespace gw
