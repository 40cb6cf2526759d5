#pragma once

#include "CMadeFigure.h"
#include "MeasureConversion.h"

namespace gw {

/// What was put in is measured within 1 %; a figure of 0 within a thousandth.
void ExpectMeasured(double figure, double putIn);

/// All bones that both figures have, paired by name.
std::vector<BonePair> PairByName(const CMadeFigure& source, const CMadeFigure& result);

} // namespace gw
