#pragma once

#include "CBodyMap.h"
#include "CNode.h"

namespace gw {

// What a body that is posed shows. Places and directions are world space, from the nodes' world matrices.

inline Vec3 PlaceOf(const CNode& node)
{
    return node.m_kWorldMatrix.Translation();
}
/// The way from one joint to another; zero where one is missing.
Vec3 WayTo(const CNode* from, const CNode* to);
/// A world direction in the space of a posed node.
Vec3 LocalDirection(const Vec3& direction, const CNode& node);
/// From the right thigh to the left one.
Vec3 HipLine(const CBodyMap& body);
/// From the right upper arm to the left one; zero where one is missing.
Vec3 ShoulderLine(const CBodyMap& body);
/// The joint at the upper end of the spine: the neck, else the head, else the last joint there is; null for
/// a body of legs.
CNode* TrunkTop(const CBodyMap& body);
/// Thigh to knee to ankle of the longer leg.
double LegLength(const CBodyMap& body);

/// Degrees by which a body strays from standing upright and straight, its limbs weighed by what they tell
/// about a reference pose: legs down, shoulders over the hips, arms straight and down or sideways.
double StanceError(const CBodyMap& body, const Vec3& up);
/// Whether the body stands at all, whichever way is up: legs along the trunk, shoulders and feet facing as
/// the hips do. `up` is the world axis, plus or minus, that the trunk lies along.
bool FindStance(const CBodyMap& body, Vec3& up);
/// The world axis, plus or minus, that is nearest to a direction.
Vec3 NearestAxis(const Vec3& direction);

} // namespace gw
