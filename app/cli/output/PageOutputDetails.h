#pragma once

#include "CJobHandler.h"
#include "CPagePart.h"
#include "ConvertFile.h"

#include <span>
#include <vector>

namespace gw {

class CConversionPage;
class CDraftShelf;
struct ShellOptions;

/// Adds details of the worst conversions to a page of a run, where they are missing: most conversions of a
/// large run, and those that were skipped because their results were up to date, are not drawn when they run.
/// They are converted again in memory, in worker processes; nothing is written or printed. A source that
/// cannot be converted any more gets no details. `jobs` are the page's sources, in order.
void AddPageDetails(const ShellOptions& options, std::span<const ConversionJob> jobs, CDraftShelf* drafts,
                    CConversionPage& page);

/// Draws the details of some conversions; job i is the one with index `worst[i]`.
class CDetailHandler : public CJobHandler
{
public:
    /// Everything must outlive the handler. The page, which gets the details, is not used in workers.
    CDetailHandler(const ShellOptions& options, std::span<const ConversionJob> jobs, CDraftShelf* drafts,
                   std::vector<size_t> worst, CConversionPage* page);

    uint8_t Run(size_t job, std::FILE* record) override;
    std::string Description() const override;
    bool Take(size_t job, const JobEnd& end) override;

private:
    CPagePart PartOf(size_t job) const;

    const ShellOptions& options_;
    std::span<const ConversionJob> jobs_;
    CDraftShelf* drafts_;
    std::vector<size_t> m_kWorst;
    CConversionPage* page_;
};

} // namespace gw
