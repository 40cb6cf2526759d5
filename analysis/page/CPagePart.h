#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace gw {

struct ConvertedMotion;

/// The details of one conversion on a page. They are drawn in the process that has the conversion's trees,
/// and can be sent as text to the process that writes the page.
class CPagePart
{
public:
    /// `number` identifies the source on the page, starting at 1. `detailCount` is the number of conversions
    /// that are shown in detail: the more there are, the coarser the curves, so that a browser can still open
    /// the page. A single one gets a player of both figures.
    CPagePart(size_t number, size_t detailCount) : m_uiNumber(number), m_uiDetailCount(detailCount) {}

    /// Draws a conversion. Its trees are posed again.
    void Show(const ConvertedMotion& motion);

    size_t Number() const { return m_uiNumber; }
    /// Returns whether a conversion was drawn.
    bool HasFigures() const { return !m_kSection.empty(); }
    /// Returns the section about the conversion; empty if none was drawn.
    const std::string& Section() const { return m_kSection; }
    /// Restores a section that was drawn in another process.
    void SetSection(std::string_view section) { m_kSection = section; }

private:
    size_t m_uiNumber;
    size_t m_uiDetailCount;
    std::string m_kSection;
};

} // namespace gw
