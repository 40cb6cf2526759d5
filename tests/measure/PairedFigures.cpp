#include "PairedFigures.h"

#include "Skeleton.h"

#include <algorithm>
#include <cmath>
#include <gtest/gtest.h>

namespace gw {

void ExpectMeasured(double figure, double putIn)
{
    EXPECT_NEAR(figure, putIn, putIn == 0.0 ? 1e-3 : std::fabs(putIn) * 0.01);
}

std::vector<BonePair> PairByName(const CMadeFigure& source, const CMadeFigure& result)
{
    std::vector<BonePair> pairs;
    for (CNode* target : NodesOf(result.Root()))
    {
        if (CNode* bone = FindNode(&source.Root(), target->GetName()))
            pairs.push_back({target, bone});
    }
    return pairs;
}

BoneMeasures BoneOf(const ConversionMeasures& measures, std::string_view target)
{
    const auto found = std::ranges::find(measures.bones, target, &BoneMeasures::target);
    return found == measures.bones.end() ? BoneMeasures() : *found;
}

ConversionMeasures PairedFigures::Measure(const FigurePose& sourcePose, const FigurePose& resultPose,
                                          int frameCount, float frequency)
{
    sourceClip = source.Record(frameCount, sourcePose, frequency);
    resultClip = result.Record(frameCount, resultPose, frequency);
    return MeasureConversion(sourceClip, resultClip, PairByName(source, result), &detail);
}

} // namespace gw
