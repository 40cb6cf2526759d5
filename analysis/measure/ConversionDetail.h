#pragma once

#include "FindContacts.h"
#include "Vec3.h"

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

// What a conversion did frame by frame, beside the sums of ConversionMeasures: kept only when asked for. All
// curves have one number for each frame compared, 32 bits each: about a hundred bytes a frame. Angles are
// degrees. Lengths are in the result's unit (mm) on both sides: the source's are scaled by the ratio of the
// legs. Heights are those above the floor: y = 0 for the result, for the source where its own soles stand.

/// How the bones of one part of the body point.
struct PartMeasures
{
    std::string_view name; ///< see BodyParts
    size_t boneCount = 0;  ///< those that were measured; without any the figures are 0
    double meanError = 0.0;
    double largestError = 0.0;
    std::string largestBone; ///< of the result
    int largestFrame = 0;
};

/// One foot, in the order of ConversionMeasures::feet.
struct FootDetail
{
    std::vector<float> sourceSole; ///< height of the sole's lower end
    std::vector<float> resultSole;
    std::vector<float> sourceKnee; ///< angle between thigh and calf, 0 for a straight leg
    std::vector<float> resultKnee;
    std::vector<Contact> sourceContacts;
    std::vector<Contact> resultContacts;
};

/// All curves of one conversion.
struct ConversionDetail
{
    double secondsPerFrame = 0.0; ///< of the source
    std::vector<PartMeasures> parts;

    /// How far the main bones' directions are off: their mean in each frame, the largest of them, and which
    /// bone this is, by its place in `mainBones`. Empty where no main bone is measured. A head without a
    /// joint above it points along its bone's axis.
    std::vector<float> meanError;
    std::vector<float> largestError;
    std::vector<uint8_t> largestBone;
    std::vector<std::string> mainBones;   ///< of the result
    std::vector<std::string> mainSources; ///< what drives them

    std::vector<FootDetail> feet;
    /// y of the source's floor, in its own unit: under its soles, and under its ankles, where it has nothing
    /// below them, as deep as under the result's.
    double sourceFloor = 0.0;

    /// Angle between the trunks; see ConversionMeasures::trunkMean. Empty where that is missing.
    std::vector<float> trunkError;
    /// Where the middle of the hip joints is; from the first frame in x and z, above the floor in y. Empty
    /// where no leg is mapped.
    std::vector<Vec3> sourceHips;
    std::vector<Vec3> resultHips;
};

} // namespace gw
