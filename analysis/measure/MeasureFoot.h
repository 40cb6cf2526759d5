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
    double scale; ///< result units per track unit
};

/// How far a joint slides in one plant.
struct PlantSlide
{
    double added; ///< mm; see SlideMeasures
    int frame;    ///< frame in which the result's joint is farthest off
};

/// Everything about a foot except its names.
struct MeasuredFoot
{
    FootMeasures figures;
    std::vector<PlantSlide> ankleSlides; ///< one per plant
    std::vector<PlantSlide> toeSlides;
    std::vector<float> heldSoles; ///< see FootMeasures::heldSole; one per frame in which the source stands
};

/// Measures a foot. Both tracks must have the same number of frames.
MeasuredFoot MeasureFoot(const FootSide& source, const FootSide& result, double secondsPerFrame);

/// Returns the summary of a list of plants.
SlideMeasures SummaryOf(const std::vector<PlantSlide>& slides);

} // namespace gw
