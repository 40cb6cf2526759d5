#pragma once

#include "BodySides.h"
#include "CJointTree.h"
#include "Mat3.h"

namespace gw {

struct CBodyMap;

/// The bones of a source with a body in it, in the poses of its tree. Poses and joints are indices of the
/// tree.
class CSourcePoses
{
public:
    CSourcePoses(const CJointTree& tree, const CBodyMap& body) : m_kTree(tree), m_kLegs(LegsOf(tree, body)) {}

    bool StandsAtRest() const { return IsStance(m_kTree, 0, m_kLegs); }
    /// The rest pose if it is a stance, else the first frame that is one, else the first.
    size_t Reference() const;
    /// Takes x, y and z to the body's left, up and forward; at rest these are axes of the file where they lie
    /// near them.
    Mat3 Facing(size_t stance) const;
    /// The rotation of a bone as a conversion reads it.
    Mat3 BoneTurn(size_t stance, int joint) const;
    /// The unit direction from one joint to another.
    Vec3 Direction(size_t stance, int from, int to) const;
    /// The first joint at another place on the way down to a goal, or none given, along first children; none
    /// where all joints below are at the same place.
    int JointBelow(int joint, int goal) const;

private:
    size_t Count() const { return m_kTree.Stances().Count(); }
    bool AreApart(int a, int b) const;

    const CJointTree& m_kTree;
    LegsOfBody m_kLegs;
};

} // namespace gw
