#include "CPagePart.h"

#include "CConversionSection.h"
#include "CMarkup.h"
#include "ConvertedMotion.h"

#include <algorithm>

namespace gw {

namespace {

// Points per curve: at most two per pixel of a wide screen. With several motions there are fewer, so that
// twenty take about two megabytes.
constexpr size_t kMostPoints = 2000;
constexpr size_t kLeastPoints = 200;
constexpr size_t kPointsOfPage = 8000;

size_t PointsFor(size_t detailCount)
{
    return std::clamp(kPointsOfPage / std::max<size_t>(detailCount, 1), kLeastPoints, kMostPoints);
}

} // namespace

void CPagePart::Show(const ConvertedMotion& motion)
{
    CMarkup section;
    CConversionSection(motion, {PointsFor(m_uiDetailCount), m_uiDetailCount == 1})
        .Append(section, "motion" + std::to_string(m_uiNumber));
    m_kSection = section.Text();
}

} // namespace gw
