#include "PairedFigures.h"

#include "Skeleton.h"

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

} // namespace gw
