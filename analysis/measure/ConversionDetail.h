#pragma once

#include "FindContacts.h"
#include "Vec3.h"

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

// The frame-by-frame detail of a conversion, in addition to the sums in ConversionMeasures; kept only on
// request. Every curve has one 32-bit number per compared frame, about a hundred bytes per frame in total.
// Angles are in degrees. Lengths are in the result's unit (mm) on both sides: the source's are scaled by the
// ratio of the leg lengths. Heights are measured from the floor, which is y = 0 for the result and the level
// of the source's own soles for the source.

/// How well the bones of one part of the body keep their directions.
struct PartMeasures
{
    std::string_view name; ///< see BodyParts
    size_t boneCount = 0;  ///< number of measured bones; if 0, the figures are 0
    double meanError = 0.0;
    double largestError = 0.0;
    std::string largestBone; ///< bone of the result
    int largestFrame = 0;
};

/// One foot, in the order of ConversionMeasures::feet.
struct FootDetail
{
    std::vector<float> sourceSole; ///< height of the lower end of the sole
    std::vector<float> resultSole;
    std::vector<float> sourceKnee; ///< angle between thigh and calf, 0 for a straight leg
    std::vector<float> resultKnee;
    std::vector<Contact> sourceContacts;
    std::vector<Contact> resultContacts;
};

/// All curves of one conversion.
struct ConversionDetail
{
    double secondsPerFrame = 0.0; ///< frame time of the source
    std::vector<PartMeasures> parts;

    /// Direction errors of the main bones in each frame: their mean, the largest one, and its bone as an
    /// index into `mainBones`. Empty if no main bone is measured. The direction of a head without a joint
    /// above it is its bone's axis.
    std::vector<float> meanError;
    std::vector<float> largestError;
    std::vector<uint8_t> largestBone;
    std::vector<std::string> mainBones;   ///< bones of the result
    std::vector<std::string> mainSources; ///< bones that drive them

    std::vector<FootDetail> feet;
    /// y of the source's floor, in the source's unit. The floor is under the soles. If the skeleton has
    /// nothing below its ankles, the floor is as far below them as in the result.
    double sourceFloor = 0.0;

    /// Angle between the trunks; see ConversionMeasures::trunkMean. Empty if that is missing.
    std::vector<float> trunkError;
    /// Position of the midpoint of the hip joints: x and z from the first frame, y above the floor. Empty if
    /// no leg is mapped.
    std::vector<Vec3> sourceHips;
    std::vector<Vec3> resultHips;
};

} // namespace gw
