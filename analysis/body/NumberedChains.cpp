// A chain counts if each of its joints is the child of the previous one. If there is another joint in
// between, or a second one above the upper arm, the numbers do not show which joints are elbow and wrist:
// then the shape stays the only evidence.

#include "NumberedChains.h"

#include "JointNames.h"
#include "Skeleton.h"

#include <algorithm>
#include <span>
#include <unordered_map>
#include <vector>

namespace gw {

namespace {

using enum EBodyJoint;

// The joints of a limb outward. The first two are the ones that make it one.
struct LimbPlaces
{
    EJointWord word;
    std::array<EBodyJoint, 4> joints;
    EBodyJoint above; // may be in the same chain; Hip if nothing may
};
constexpr LimbPlaces kLimbs[] = {
    {EJointWord::Arm, {UpperArm, Forearm, Hand, Hand}, Clavicle},
    {EJointWord::Leg, {Thigh, Shin, Foot, Toe},        Hip     },
};

ENameSide NameSide(EBodySide side)
{
    return side == EBodySide::Left ? ENameSide::Left : ENameSide::Right;
}

class CChainNames
{
public:
    explicit CChainNames(CNode& root)
    {
        const std::vector<CNode*> nodes = NodesOf(root);
        const std::vector<JointName> names = ReadJointNames(nodes);
        for (size_t i = 0; i < nodes.size(); ++i)
            m_kNames.emplace(nodes[i], names[i]);
    }

    JointName NameOf(const CNode* node) const
    {
        const auto found = m_kNames.find(node);
        return found == m_kNames.end() ? JointName() : found->second;
    }

    // Returns the first nodes of a list that form a chain: each the child of the previous one, all with the
    // same words. Empty if their numbers neither rise nor fall.
    std::vector<const CNode*> ChainOf(std::span<CNode* const> nodes) const;

private:
    std::unordered_map<const CNode*, JointName> m_kNames;
};

std::vector<const CNode*> CChainNames::ChainOf(std::span<CNode* const> nodes) const
{
    std::vector<const CNode*> chain;
    int direction = 0;
    for (const CNode* node : nodes)
    {
        if (!node || node == (chain.empty() ? nullptr : chain.back()))
            break;
        if (!chain.empty())
        {
            const JointName before = NameOf(chain.back());
            const JointName name = NameOf(node);
            if (node->GetParentNode() != chain.back() || name.word != before.word || name.side != before.side)
                break;
            const int step = (name.number > before.number) - (name.number < before.number);
            if (step == 0 || step * direction < 0)
                return {};
            direction = step;
        }
        chain.push_back(node);
    }
    return chain;
}

void Mark(const CBodyMap& body, BodyPlace place, std::span<const CNode* const> chain, NumberedChains& chains)
{
    const CNode* const joint = JointAt(body, place);
    if (joint && std::ranges::find(chain, joint) != chain.end())
        chains.agrees[IndexOf(place)] = true;
}

void MarkLimb(const CChainNames& names, const CBodyMap& body, const LimbPlaces& limb, EBodySide side,
              NumberedChains& chains)
{
    CNode* const upper = JointAt(body, {limb.joints[0], side});
    const JointName name = names.NameOf(upper);
    if (!upper || name.word != limb.word || name.side != NameSide(side))
        return;
    std::vector<CNode*> nodes;
    CNode* above = upper->GetParentNode();
    const auto isInLimb = [&](const CNode* node) {
        return names.NameOf(node).word == name.word && names.NameOf(node).side == name.side;
    };
    if (isInLimb(above))
    {
        if (limb.above == Hip || above != JointAt(body, {limb.above, side}) ||
            isInLimb(above->GetParentNode()))
            return;
        nodes.push_back(above);
    }
    for (const EBodyJoint joint : limb.joints)
        nodes.push_back(JointAt(body, {joint, side}));
    const std::vector<const CNode*> chain = names.ChainOf(nodes);
    if (std::ranges::find(chain, JointAt(body, {limb.joints[1], side})) == chain.end())
        return;
    for (const EBodyJoint joint : limb.joints)
        Mark(body, {joint, side}, chain, chains);
    Mark(body, {limb.above, side}, chain, chains);
}

void MarkTrunk(const CChainNames& names, const CBodyMap& body, NumberedChains& chains)
{
    if (names.NameOf(body.hip).word != EJointWord::Spine || body.spine.empty())
        return;
    std::vector<CNode*> nodes{body.hip};
    nodes.insert(nodes.end(), body.spine.begin(), body.spine.end());
    const std::vector<const CNode*> chain = names.ChainOf(nodes);
    if (chain.size() < 2)
        return;
    Mark(body, {Hip}, chain, chains);
    Mark(body, {Spine}, chain, chains);
}

int SidesOf(const CChainNames& names, const CBodyMap& body)
{
    int votes = 0;
    int limbs = 0;
    for (const EBodySide side : kBodySides)
    {
        for (const LimbPlaces& limb : kLimbs)
        {
            for (const EBodyJoint joint : {limb.joints[0], limb.joints[1]})
            {
                const ENameSide said = names.NameOf(JointAt(body, {joint, side})).side;
                votes += said == ENameSide::None ? 0 : said == NameSide(side) ? 1 : -1;
                ++limbs;
            }
        }
    }
    return votes == limbs ? 1 : votes == -limbs ? -1 : 0;
}

} // namespace

NumberedChains FindNumberedChains(CNode& root, const CBodyMap& body)
{
    const CChainNames names(root);
    NumberedChains chains;
    chains.sides = SidesOf(names, body);
    for (const EBodySide side : kBodySides)
    {
        for (const LimbPlaces& limb : kLimbs)
            MarkLimb(names, body, limb, side, chains);
    }
    MarkTrunk(names, body, chains);
    return chains;
}

} // namespace gw
