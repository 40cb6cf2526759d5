#include "PageOutputDetails.h"

#include "CConversionPage.h"
#include "CDraftShelf.h"
#include "CInterrupt.h"
#include "CPagePart.h"
#include "CWorkerPool.h"
#include "ShellOptions.h"

#include <algorithm>
#include <new>
#include <thread>

namespace gw {

namespace {

class CDetailHandler : public CJobHandler
{
public:
    CDetailHandler(const ShellOptions& options, std::span<const ConversionJob> jobs, CDraftShelf* drafts,
                   CConversionPage& page)
        : options_(options), jobs_(jobs), drafts_(drafts), page_(page), m_kWorst(page.WorstWithoutDetails())
    {
    }

    size_t Count() const { return m_kWorst.size(); }

    uint8_t Run(size_t job, std::FILE* record) override
    {
        const size_t index = m_kWorst[job];
        if (drafts_)
            drafts_->Begin(index);
        CPagePart part = PartOf(job);
        try
        {
            DrawConversion(options_, jobs_[index],
                           {.part = &part, .drafts = drafts_, .voice = EVoice::Silent});
        } catch (const std::bad_alloc&)
        {
        }
        std::fwrite(part.Section().data(), 1, part.Section().size(), record);
        return 0;
    }
    bool Take(size_t job, const JobEnd& end) override
    {
        CPagePart part = PartOf(job);
        if (end.kind == JobEnd::EKind::Ran)
            part.SetSection(end.record);
        page_.AddDetails(part);
        return true;
    }

private:
    CPagePart PartOf(size_t job) const
    {
        return {m_kWorst[job] + 1, std::min(jobs_.size(), CConversionPage::kDetailCount)};
    }

    const ShellOptions& options_;
    std::span<const ConversionJob> jobs_;
    CDraftShelf* drafts_;
    CConversionPage& page_;
    std::vector<size_t> m_kWorst;
};

} // namespace

void AddPageDetails(const ShellOptions& options, std::span<const ConversionJob> jobs, CDraftShelf* drafts,
                    CConversionPage& page)
{
    CDetailHandler handler(options, jobs, drafts, page);
    if (handler.Count() == 0)
        return;
    const size_t cores = std::max(1u, std::thread::hardware_concurrency());
    const size_t workers = options.jobs ? static_cast<size_t>(*options.jobs) : cores;
    const CInterrupt interrupt;
    CWorkerPool(handler, {.workerCount = std::min(workers, handler.Count()), .jobSeconds = options.timeLimit})
        .Run(handler.Count(), interrupt);
}

} // namespace gw
