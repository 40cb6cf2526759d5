#include "CConversionRun.h"

#include "CContentHash.h"
#include "CPagePart.h"
#include "CShellConversion.h"
#include "CShellNotices.h"
#include "Notice.h"
#include "PageOutput.h"
#include "PageOutputDetails.h"
#include "PageOutputRow.h"

#include <utility>

namespace gw {

namespace {

// A large run draws the details of its worst conversions at its end.
bool IsDrawnAtOnce(const ShellOptions& options, size_t jobCount)
{
    return IsPageAsked(options) && jobCount <= CConversionPage::kDetailCount;
}

} // namespace

CFileRun::FileEnd CConversionRun::Convert(const ShellOptions& options, size_t index, std::FILE* record)
{
    CPagePart part(index + 1, AllJobs().size());
    const EConversion outcome =
        ConvertFile(options, AllJobs()[index],
                    {.record = record,
                     .part = IsDrawnAtOnce(options, AllJobs().size()) ? &part : nullptr,
                     .drafts = Drafts(),
                     .voice = Voice()});
    m_kDrawn = part.Section();
    return {.outcome = outcome, .endsRun = outcome == EConversion::Failed && !options.keepGoing};
}

void CConversionRun::TellLost(size_t index, const Notice& reason, std::FILE* record)
{
    TellFailed(Options(), AllJobs()[index], reason, {.record = record, .voice = Voice()});
}

void CConversionRun::TellUpToDate(size_t index)
{
    TellSkipped(Options(), AllJobs()[index], "the output is up to date", Voice());
}

// Adds the named profile, or all profiles that sources may choose from.
bool CConversionRun::AddProfiles(CContentHash& key)
{
    CShellNotices notices(Options());
    CShellConversion conversion(Options(), {}, notices);
    if (!Options().profile.empty())
    {
        const std::string path = conversion.ResolveProfile(Options().profile);
        key.AddFile(path);
        return !path.empty();
    }
    for (const InstalledProfile& profile : conversion.InstalledProfiles())
        key.AddText(profile.name).AddFile(profile.path);
    return true;
}

// Moves the text out, because the next job may not be a conversion.
std::string CConversionRun::Enclosure()
{
    return std::exchange(m_kDrawn, {});
}

void CConversionRun::TakeRecord(size_t index, EConversion outcome, std::string_view record,
                                std::string_view enclosure)
{
    m_uiTaken = index + 1;
    if (!IsPageAsked(Options()))
        return;
    CPagePart part(index + 1, AllJobs().size());
    m_kPage.Add(PageRowOf(AllJobs()[index].source, OutcomeName(outcome), record));
    part.SetSection(enclosure);
    m_kPage.AddDetails(part);
}

bool CConversionRun::FinishPage()
{
    for (size_t left = m_uiTaken; left < AllJobs().size(); ++left)
        m_kPage.Add({.source = AllJobs()[left].source, .outcome = "left"});
    if (m_uiTaken == AllJobs().size()) // otherwise somebody wants the run to end
        AddPageDetails(Options(), AllJobs(), Drafts(), m_kPage);
    return !m_kPage.HasContent() || WritePage(Options(), m_kPage);
}

bool CConversionRun::TellEnd()
{
    TellSummary();
    const bool isWritten = !IsPageAsked(Options()) || FinishPage();
    return isWritten && Tally()[EConversion::Failed] == 0;
}

} // namespace gw
