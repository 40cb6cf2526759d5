#pragma once

#include "CSpool.h"
#include "PageRow.h"

#include <cstddef>
#include <string>
#include <vector>

namespace gw {

class CMarkup;
class CPagePart;

/// A self-contained page about conversions: it needs no other files and no network. A page about several
/// sources begins with the failures, the totals and a sortable table; it shows details of a few only.
class CConversionPage
{
public:
    /// How many conversions of a run are shown in detail. With ten thousand, the page would be too large.
    static constexpr size_t kDetailCount = 20;

    /// Adds a source.
    void Add(PageRow row) { m_kRows.push_back(std::move(row)); }
    /// Adds the details of the source with the part's number. Nothing happens without any, or if the source
    /// has details already.
    void AddDetails(const CPagePart& part);

    /// Returns the indices of the worst kDetailCount conversions that have no details yet.
    std::vector<size_t> WorstWithoutDetails() const;
    /// Returns whether there is anything to show: details, or several sources.
    bool HasContent() const { return m_kRows.size() > 1 || !m_kDetailed.empty(); }

    /// Replaces the page atomically. Returns false, leaving an existing file unchanged, if that fails.
    bool Write(const std::string& path);

private:
    bool IsDetailed(size_t number) const;
    std::string Head() const;
    static std::string Foot();
    void AppendOverview(CMarkup& page) const;

    std::vector<PageRow> m_kRows;
    std::vector<size_t> m_kDetailed; ///< numbers of the sources that have details
    CSpool m_kSections;
};

} // namespace gw
