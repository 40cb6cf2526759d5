#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace gw {

struct ConvertedMotion;

/// What a page shows of one conversion. It is made where the trees of the conversion are, and may go to the
/// page as text, from another process too.
class CPagePart
{
public:
    /// `number` is the conversion's own among those of the page, from 1 on. `motionCount` is how many there
    /// will be: the more, the coarser are the curves, so that a browser can open the page.
    CPagePart(size_t number, size_t motionCount);

    /// Draws a conversion; its trees are posed anew.
    void Show(const ConvertedMotion& motion);

    /// Whether a conversion was drawn.
    bool HasFigures() const { return !m_kSection.empty(); }
    /// The conversion's row of the table of all.
    const std::string& Row() const { return m_kRow; }
    /// All that the page has about the conversion.
    const std::string& Section() const { return m_kSection; }
    /// How bad it is beside others: larger is worse.
    double Badness() const { return m_fBadness; }

    /// The part as text, for FromText of another one; empty for one without figures.
    std::string ToText() const;
    /// False for any other text.
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
