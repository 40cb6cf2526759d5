#include "BodyPaths.h"

#include "BodyPose.h"
#include "CMotionFile.h"
#include "CPoseSampler.h"

namespace gw {

namespace {

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
