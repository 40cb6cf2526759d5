#pragma once

#include "BodySides.h"
#include "CJointTree.h"
#include "Mat3.h"

namespace gw {

/// The bones of a source's body, in the poses of its tree. Poses and joints are tree indices.
class CSourcePoses
{
public:
    CSourcePoses(const CJointTree& tree, const CBodyMap& body) : tree_(tree), body_(body) {}

    bool StandsAtRest() const { return StanceIn(tree_, 0, body_).Stands(); }
    /// Returns the first standing pose with the legs together, checking the rest pose first; otherwise the
    /// first frame.
    size_t Reference() const;
    /// Returns the rotation from x, y and z to the body's left, up and forward; at rest it is snapped to the
    /// file's axes if they are close.
    Mat3 Facing(size_t stance) const;
    /// Returns the rotation of a bone as a conversion reads it.
    Mat3 BoneTurn(size_t stance, int joint) const;
    /// Returns the unit direction from one joint to another.
    Vec3 Direction(size_t stance, int from, int to) const;
    /// Returns the first joint below that is at another place at rest, toward a goal if there is one,
    /// otherwise along first children; kNone if there is none.
    int JointBelow(int joint, int goal) const;

private:
    size_t Count() const { return tree_.Stances().Count(); }

    const CJointTree& tree_;
    const CBodyMap& body_;
};

} // namespace gw
