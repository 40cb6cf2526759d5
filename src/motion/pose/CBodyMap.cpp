#include "CBodyMap.h"

#include <algorithm>

namespace gw {

bool CBodyMap::DrivesBody() const
{
    const auto armIsThere = [](const BodyArm& arm) { return arm.upperArm && arm.forearm && arm.hand; };
    const auto legIsThere = [](const BodyLeg& leg) { return leg.thigh && leg.shin; };
    return hip && !spine.empty() && head && std::ranges::all_of(arms, armIsThere) &&
           std::ranges::all_of(legs, legIsThere);
}

bool CBodyMap::HasFeet() const
{
    return std::ranges::all_of(legs, [](const BodyLeg& leg) { return leg.foot != nullptr; });
}

} // namespace gw
