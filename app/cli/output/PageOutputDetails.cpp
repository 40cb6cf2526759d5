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
#include <utility>

namespace gw {

CDetailHandler::CDetailHandler(const ShellOptions& options, std::span<const ConversionJob> jobs,
                               CDraftShelf* drafts, std::vector<size_t> worst, CConversionPage* page)
    : options_(options), jobs_(jobs), drafts_(drafts), m_kWorst(std::move(worst)), page_(page)
{
}

uint8_t CDetailHandler::Run(size_t job, std::FILE* record)
{
    const size_t index = m_kWorst[job];
    if (drafts_)
        drafts_->Begin(index);
    CPagePart part = PartOf(job);
    try
    {
        DrawConversion(options_, jobs_[index], {.part = &part, .drafts = drafts_, .voice = EVoice::Silent});
    } catch (const std::bad_alloc&)
    {
    }
    std::fwrite(part.Section().data(), 1, part.Section().size(), record);
    return 0;
}

bool CDetailHandler::Take(size_t job, const JobEnd& end)
{
    CPagePart part = PartOf(job);
    if (end.kind == JobEnd::EKind::Ran)
        part.SetSection(end.record);
    if (page_)
        page_->AddDetails(part);
    return true;
}

CPagePart CDetailHandler::PartOf(size_t job) const
{
    return {m_kWorst[job] + 1, std::min(jobs_.size(), CConversionPage::kDetailCount)};
}

void AddPageDetails(const ShellOptions& options, std::span<const ConversionJob> jobs, CDraftShelf* drafts,
                    CConversionPage& page)
{
    const std::vector<size_t> worst = page.WorstWithoutDetails();
    if (worst.empty())
        return;
    CDetailHandler handler(options, jobs, drafts, worst, &page);
    const size_t cores = std::max(1u, std::thread::hardware_concurrency());
    const size_t workers = options.jobs ? static_cast<size_t>(*options.jobs) : cores;
    const CInterrupt interrupt;
    CWorkerPool(handler, {.workerCount = std::min(workers, worst.size()), .jobSeconds = options.timeLimit})
        .Run(worst.size(), interrupt);
}

} // namespace gw
