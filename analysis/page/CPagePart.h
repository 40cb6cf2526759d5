#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace gw {

struct ConvertedMotion;

/// The page's content for one conversion. It is created in the process that has the conversion's trees, and
/// can be sent as text to the process that writes the page.
class CPagePart
{
public:
    /// `number` identifies the conversion on the page, starting at 1. `motionCount` is the total number of
    /// conversions: the more there are, the coarser the curves, so that a browser can still open the page.
    CPagePart(size_t number, size_t motionCount);

    /// Draws a conversion. Its trees are posed again.
    void Show(const ConvertedMotion& motion);

    /// Returns whether a conversion was drawn.
    bool HasFigures() const { return !m_kSection.empty(); }
    /// Returns the conversion's row in the overview table.
    const std::string& Row() const { return m_kRow; }
    /// Returns the section about the conversion.
    const std::string& Section() const { return m_kSection; }
    /// Returns a score for ranking conversions: larger is worse.
    double Badness() const { return m_fBadness; }

    /// Returns the part as text for FromText; empty for one without figures.
    std::string ToText() const;
    /// Restores a part from ToText. Returns false for any other text.
    bool FromText(std::string_view text);

private:
    std::string SummaryRow(const ConvertedMotion& motion, const std::string& anchor);

    size_t m_uiNumber;
    size_t m_uiMotionCount;
    double m_fBadness = 0.0;
    std::string m_kRow;
    std::string m_kSection;
};

} // namespace gw
