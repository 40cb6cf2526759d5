#pragma once

#include "CLegTrack.h"
#include "Vec3.h"

#include <vector>

namespace gw {

class CBodyTrack;

/// Returns one number of a leg's postures for each frame: (number - floor) x scale.
std::vector<float> PostureCurve(const CLegTrack& leg, float CLegTrack::Posture::*number, double floor = 0.0,
                                double scale = 1.0);

/// Returns the positions of the hips: x and z relative to the first frame, y above the floor.
std::vector<Vec3> HipsFromStart(const CBodyTrack& body, double floor);

} // namespace gw
