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

} // namespace gw
