#pragma once

#include "CSpool.h"

#include <cstddef>
#include <string>
#include <vector>

namespace gw {

class CMarkup;
class CPagePart;

/// One self-contained page about conversions: it needs no script, no other file and no network. A page about
/// several begins with a table of them, the worst one first.
class CConversionPage
{
public:
    /// Takes a conversion in that was drawn.
    void Add(const std::string& source, const CPagePart& part);
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
        std::string markup;
        double badness = 0.0;
    };

    std::string Head() const;
    static std::string Foot();
    void AppendSummary(CMarkup& page) const;

    std::vector<Row> m_kRows;
    size_t m_uiSections = 0;
    CSpool m_kSections;
};

} // namespace gw
