#pragma once

#include "CMarkup.h"
#include "Chart.h"
#include "ConvertedMotion.h"
#include "KeyFigures.h"
#include "WorstFrames.h"

#include <string>
#include <vector>

namespace gw {

/// The part of a page that tells of one conversion: key figures, worst frames, curves, tables.
class CConversionSection
{
public:
    /// The conversion must outlive the section, and its trees are posed anew. Curves are drawn in at most
    /// about `mostPoints` points.
    CConversionSection(const ConvertedMotion& motion, size_t mostPoints);

    /// Appends the section, which links find under `anchor`.
    void Append(CMarkup& page, const std::string& anchor);

private:
    void AppendHead(CMarkup& page) const;
    void AppendTiles(CMarkup& page) const;
    void AppendWorstFrames(CMarkup& page) const;
    void AppendCurves(CMarkup& page) const;
    Chart NewChart(const std::string& title, std::string_view unit) const;
    void AppendKnee(CMarkup& page, const FootDetail& foot, const std::string& name) const;
    void AppendSole(CMarkup& page, const FootDetail& foot, const std::string& name) const;
    void AppendHipHeight(CMarkup& page) const;

    const ConvertedMotion& motion_;
    size_t m_uiMostPoints;
    std::vector<WorstFrame> m_kWorst;
    std::vector<ChartMark> m_kMarks; // where these are
};

} // namespace gw
