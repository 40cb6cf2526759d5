#pragma once

#include "CMadeFigure.h"
#include "MeasureConversion.h"

#include <functional>

namespace gw {

using FigurePose = std::function<void(CMadeFigure& figure, int frame)>;
inline const FigurePose kStill = [](CMadeFigure&, int) {};

/// What was put in is measured within 1 %; a figure of 0 within a thousandth.
void ExpectMeasured(double figure, double putIn);

/// All bones that both figures have, paired by name.
std::vector<BonePair> PairByName(const CMadeFigure& source, const CMadeFigure& result);

/// What is measured of a bone; of none if it was not compared.
BoneMeasures BoneOf(const ConversionMeasures& measures, std::string_view target);

/// A source and its result, paired by name.
struct PairedFigures
{
    /// `sourceUnit` is the number of the source's units per millimeter.
    explicit PairedFigures(double sourceUnit = 1.0) : source(sourceUnit) {}

    /// Moves both, which can be done once, and measures the result.
    ConversionMeasures Measure(const FigurePose& sourcePose, const FigurePose& resultPose,
                               int frameCount = 120, float frequency = 1.0f / 30.0f);

    CMadeFigure source;
    CMadeFigure result;
    MotionClip sourceClip; ///< what was measured
    MotionClip resultClip;
    ConversionDetail detail;
};

} // namespace gw
