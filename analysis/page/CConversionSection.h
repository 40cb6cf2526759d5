#pragma once

#include "CMarkup.h"
#include "Chart.h"
#include "ConvertedMotion.h"
#include "KeyFigures.h"
#include "WorstFrames.h"

#include <string>
#include <vector>

namespace gw {

/// How much of a conversion is shown.
struct SectionExtent
{
    size_t mostPoints = 0;  ///< of a curve, about
    bool hasPlayer = false; ///< with a player of both figures
};

/// The section of a page about one conversion: key figures, worst frames, curves, tables.
class CConversionSection
{
public:
    /// The conversion must outlive the section, and its trees are posed again.
    CConversionSection(const ConvertedMotion& motion, const SectionExtent& extent);

    /// Appends the section; `anchor` is its link target.
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
    SectionExtent m_kExtent;
    std::vector<WorstFrame> m_kWorst;
    std::vector<ChartMark> m_kMarks; // the positions of the worst frames
};

} // namespace gw
