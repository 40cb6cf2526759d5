#pragma once

#include "CSpool.h"

#include <cstddef>
#include <string>
#include <vector>

namespace gw {

class CMarkup;
class CPagePart;

/// A self-contained page about conversions: it needs no scripts, no other files and no network. A page about
/// several conversions begins with a table of them, worst first.
class CConversionPage
{
public:
    /// Adds a conversion whose part has been drawn.
    void Add(const std::string& source, const CPagePart& part);
    /// Adds a source without figures to show; `outcome` is its text in the table.
    void AddWithoutFigures(const std::string& source, const std::string& outcome);

    /// Returns whether any conversion with figures was added.
    bool HasConversions() const { return m_uiSections > 0; }

    /// Replaces the page atomically. Returns false, leaving an existing file unchanged, if that fails.
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
