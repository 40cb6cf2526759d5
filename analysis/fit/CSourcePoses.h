#pragma once

#include "BodySides.h"
#include "CJointTree.h"
#include "Mat3.h"

namespace gw {

/// The bones of a source with a body in it, in the poses of its tree. Poses and joints are indices of the
/// tree.
class CSourcePoses
{
public:
    CSourcePoses(const CJointTree& tree, const CBodyMap& body) : tree_(tree), body_(body) {}

    bool StandsAtRest() const { return StanceIn(tree_, 0, body_).Stands(); }
    /// The first pose that is a stance with the legs together, the rest pose before all others, else the
    /// first frame.
    size_t Reference() const;
    /// Takes x, y and z to the body's left, up and forward; at rest these are axes of the file where they lie
    /// near them.
    Mat3 Facing(size_t stance) const;
    /// The rotation of a bone as a conversion reads it.
    Mat3 BoneTurn(size_t stance, int joint) const;
    /// The unit direction from one joint to another.
    Vec3 Direction(size_t stance, int from, int to) const;
    /// The first joint below that is at another place at rest, towards a goal, or none given, along first
    /// children; none if there is none.
    int JointBelow(int joint, int goal) const;

private:
    size_t Count() const { return tree_.Stances().Count(); }

    const CJointTree& tree_;
    const CBodyMap& body_;
};

} // namespace gw
