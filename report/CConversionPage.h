#pragma once

#include "CSpool.h"
#include "KeyFigures.h"

#include <cstddef>
#include <string>
#include <vector>

namespace gw {

struct ConvertedMotion;

/// One self-contained page about conversions: it needs no script, no other file and no network. A page about
/// several begins with a table of them, the worst one first.
class CConversionPage
{
public:
    /// `motionCount` is how many will come: the more, the coarser are the curves, so that a browser can open
    /// the page.
    explicit CConversionPage(size_t motionCount);

    /// Takes a conversion in; its trees are posed anew.
    void Add(const ConvertedMotion& motion);
    /// Takes in a source of which there is nothing to show; `outcome` is said in the table.
    void AddWithoutFigures(const std::string& source, const std::string& outcome);

    /// Whether any conversion was taken in with its figures.
    bool HasConversions() const { return m_uiSections > 0; }

    /// Writes the page in one step; false leaves what is there as it was.
    bool Write(const std::string& path);

private:
    struct Row
    {
        std::string source;
        std::string outcome; // empty for a conversion that was measured
        int frameCount = 0;
        std::vector<KeyFigure> figures;
        double badness = 0.0;
        size_t section = 0;
    };

    std::string Head() const;
    void AppendSummary(CMarkup& page) const;
    static void AppendSummaryRow(CMarkup& page, const Row& row);

    size_t m_uiMotionCount;
    std::vector<Row> m_kRows;
    size_t m_uiSections = 0;
    CSpool m_kSections;
};

} // namespace gw
