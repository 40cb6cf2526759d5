#include "BodyPaths.h"

#include "AlongAxis.h"
#include "CMotionFile.h"
#include "CPoseSampler.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

Vec3 PlaceOf(const CNode& node)
{
    return node.m_kWorldMatrix.Translation();
}

double RestDistance(const CNode& a, const CNode& b)
{
    return Vec3Length(RestWorld(a).Translation() - RestWorld(b).Translation());
}

} // namespace

BodyPaths FollowBody(const CMotionFile& motion, const CBodyMap& body)
{
    BodyPaths paths;
    if (!body.hip || !body.HasFeet() || motion.GetKeyCount() < 1)
        return paths;
    CPoseSampler sampler(motion.GetFrequency());
    sampler.Watch(body.hip);
    for (const BodyLeg& leg : body.legs)
        sampler.Watch(leg.foot);
    for (int frame = 0; frame < motion.GetKeyCount(); ++frame)
    {
        sampler.Pose(frame);
        paths.hip.push_back(PlaceOf(*body.hip));
        for (const EBodySide side : kBodySides)
            paths.feet[static_cast<size_t>(side)].push_back(PlaceOf(*body.Leg(side).foot));
    }
    return paths;
}

UpAxis FindUpAxis(const BodyPaths& paths)
{
    Vec3 sum = kVec3Zero;
    for (size_t frame = 0; frame < paths.FrameCount(); ++frame)
        sum = sum + paths.hip[frame] * 2.0f - paths.feet[0][frame] - paths.feet[1][frame];
    const auto isLess = [&](size_t a, size_t b) {
        return std::fabs(AlongAxis(sum, a)) < std::fabs(AlongAxis(sum, b));
    };
    const size_t axis = std::max({size_t{1}, size_t{0}, size_t{2}}, isLess);
    return {axis, AlongAxis(sum, axis) < 0.0f};
}

double RestLegLength(const CBodyMap& body)
{
    double sum = 0.0;
    for (const BodyLeg& leg : body.legs)
    {
        if (!leg.thigh || !leg.shin || !leg.foot)
            return 0.0;
        sum += RestDistance(*leg.thigh, *leg.shin) + RestDistance(*leg.shin, *leg.foot);
    }
    return sum / 2.0;
}

} // namespace gw
