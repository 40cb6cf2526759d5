#pragma once

#include "ConversionMeasures.h"
#include "FindPlants.h"

#include <vector>

namespace gw {

class CLegTrack;

/// One foot of one side, with all its frames.
struct FootSide
{
    const CLegTrack& track;
    const FootPlants& plants;
    double scale; ///< the result's unit by that of the track
};

/// A joint's slide in a plant.
struct PlantSlide
{
    double added; ///< mm; see SlideMeasures
    int frame;    ///< in which the result's joint is farthest off
};

/// Everything about a foot but its names.
struct MeasuredFoot
{
    FootMeasures figures;
    std::vector<PlantSlide> ankleSlides; ///< one for each plant
    std::vector<PlantSlide> toeSlides;
    std::vector<float> heldSoles; ///< see FootMeasures::heldSole; one for each frame that the source stands
};

/// Both tracks have the same frames.
MeasuredFoot MeasureFoot(const FootSide& source, const FootSide& result, double secondsPerFrame);

/// The figures of some plants.
SlideMeasures SummaryOf(const std::vector<PlantSlide>& slides);

} // namespace gw
