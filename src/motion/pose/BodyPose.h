#pragma once

#include "CBodyMap.h"
#include "CNode.h"

namespace gw {

// Measures of a posed body. Positions and directions are in world space, from the nodes' world matrices.

inline Vec3 PlaceOf(const CNode& node)
{
    return node.m_kWorldMatrix.Translation();
}
/// Returns the vector from one joint to another; zero if one is missing.
Vec3 WayTo(const CNode* from, const CNode* to);
/// Converts a world direction to the space of a posed node.
Vec3 LocalDirection(const Vec3& direction, const CNode& node);
/// Returns the vector from the right thigh to the left one.
Vec3 HipLine(const CBodyMap& body);
/// Returns the vector from the right upper arm to the left one; zero if one is missing.
Vec3 ShoulderLine(const CBodyMap& body);
/// Returns the joint at the upper end of the spine: the neck, otherwise the head, otherwise the last spine
/// joint; null for a body without a trunk.
CNode* TrunkTop(const CBodyMap& body);
/// Returns the length of the longer leg, from thigh to knee to ankle.
double LegLength(const CBodyMap& body);

} // namespace gw
