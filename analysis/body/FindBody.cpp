#include "FindBody.h"

#include "BodyTree.h"
#include "CJointTree.h"
#include "FindBodyByNames.h"
#include "FindBodyByShape.h"

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
    const CBodyMap shaped = FindBodyByShape(tree, sidesAreSure);

    FoundBody found;
    found.body = named;
    found.doubts = CheckBody(named, tree);
    const bool namesAreGood = named.DrivesBody() && found.doubts.empty();
    if (!namesAreGood && shaped.DrivesBody())
    {
        found.body = shaped;
        found.doubts = CheckBody(shaped, tree);
        found.sidesAreSure = sidesAreSure;
    }
    AddMissing(found.body, namesAreGood ? shaped : named);
    for (size_t i = 0; i < kBodyPlaceCount; ++i)
    {
        const BodyPlace place = BodyPlaces()[i];
        found.evidence[i] =
            EvidenceOf(JointAt(found.body, place), JointAt(named, place), JointAt(shaped, place));
    }
    return found;
}

} // namespace gw
