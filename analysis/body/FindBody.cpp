#include "FindBody.h"

#include "BodyTree.h"
#include "CJointTree.h"
#include "FindBodyByNames.h"
#include "FindBodyByShape.h"
#include "NumberedChains.h"

#include <utility>

namespace gw {

namespace {

// Adds optional joints from the other map if they fit between their neighbors.
void AddMissing(CBodyMap& body, const CBodyMap& other)
{
    for (const EBodySide side : kBodySides)
    {
        BodyArm& arm = body.Arm(side);
        BodyLeg& leg = body.Leg(side);
        const BodyArm& otherArm = other.Arm(side);
        const BodyLeg& otherLeg = other.Leg(side);
        if (!arm.clavicle && otherArm.upperArm == arm.upperArm)
            arm.clavicle = otherArm.clavicle;
        if (!leg.foot && otherLeg.shin == leg.shin)
            leg.foot = otherLeg.foot;
        if (!leg.toe && otherLeg.foot == leg.foot)
            leg.toe = otherLeg.toe;
    }
}

// Where no pose shows which side is left, the names decide. Returns whether they do.
bool SortSidesByNames(int sides, CBodyMap& body)
{
    if (sides < 0)
    {
        std::swap(body.arms[0], body.arms[1]);
        std::swap(body.legs[0], body.legs[1]);
    }
    return sides != 0;
}

EBodyEvidence EvidenceOf(const CNode* joint, const CNode* named, const CNode* shaped)
{
    if (!joint)
        return EBodyEvidence::None;
    if (joint == named)
        return joint == shaped ? EBodyEvidence::Both : EBodyEvidence::Name;
    return named ? EBodyEvidence::ShapeOnly : EBodyEvidence::Shape;
}

} // namespace

FoundBody FindBody(CNode& root)
{
    const CJointTree tree(root);
    const CBodyMap named = FindBodyByNames(root);
    bool sidesAreSure = false;
    CBodyMap shaped = FindBodyByShape(tree, sidesAreSure);

    FoundBody found;
    found.body = named;
    found.doubts = CheckBody(named, tree);
    NumberedChains chains;
    const bool namesAreGood = named.DrivesBody() && found.doubts.empty();
    if (!namesAreGood && shaped.DrivesBody())
    {
        chains = FindNumberedChains(root, shaped);
        if (!sidesAreSure && SortSidesByNames(chains.sides, shaped))
        {
            sidesAreSure = true;
            chains = FindNumberedChains(root, shaped);
        }
        found.body = shaped;
        found.doubts = CheckBody(shaped, tree);
        found.sidesAreSure = sidesAreSure;
    }
    AddMissing(found.body, namesAreGood ? shaped : named);
    for (size_t i = 0; i < kBodyPlaceCount; ++i)
    {
        const BodyPlace place = BodyPlaces()[i];
        const CNode* const shapedJoint = JointAt(shaped, place);
        found.evidence[i] = chains.agrees[i]
                                ? EBodyEvidence::Both
                                : EvidenceOf(JointAt(found.body, place), JointAt(named, place), shapedJoint);
    }
    return found;
}

} // namespace gw
