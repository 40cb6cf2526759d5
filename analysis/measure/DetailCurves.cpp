#include "DetailCurves.h"

#include "CBodyTrack.h"

namespace gw {

std::vector<float> PostureCurve(const CLegTrack& leg, float CLegTrack::Posture::*number, double floor,
                                double scale)
{
    std::vector<float> curve;
    curve.reserve(leg.Postures().size());
    for (const CLegTrack::Posture& posture : leg.Postures())
        curve.push_back(static_cast<float>((static_cast<double>(posture.*number) - floor) * scale));
    return curve;
}

std::vector<Vec3> HipsFromStart(const CBodyTrack& body, double floor)
{
    std::vector<Vec3> places;
    for (size_t f = 0; f < body.FrameCount(); ++f)
    {
        const Vec3 start = body.Hips(0);
        places.push_back(body.Hips(f) - Vec3{start.x, static_cast<float>(floor), start.z});
    }
    return places;
}

} // namespace gw
