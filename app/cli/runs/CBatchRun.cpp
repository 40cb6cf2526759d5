#include "CBatchRun.h"

#include "CBoneMapProfile.h"
#include "CContentHash.h"
#include "CJsonWriter.h"
#include "CShellContent.h"
#include "CShellWindow.h"
#include "ReportJson.h"
#include "Text.h"
#include "Words.h"

#include <algorithm>

namespace gw {

EBatchJob BatchJobOf(const COptions& options)
{
    return options.job == "htr" ? EBatchJob::ToMotion : EBatchJob::ToContainer;
}

CBatchRun::CBatchRun(const COptions& options, Jobs jobs, CRunState state, CShellContent& content,
                     CShellWindow& window)
    : CFileRun(options, std::move(jobs), std::move(state)), m_kContent(content), m_kWindow(window)
{
}

EBatchJob CBatchRun::Job() const
{
    return BatchJobOf(Options());
}

// A file of which a failure is told counts as failed, and ends the run only where the desktop program's ends.
CFileRun::CFileEnd CBatchRun::Convert(const COptions& options, size_t index, std::FILE* record)
{
    const CConversionJob& job = AllJobs()[index];
    const size_t before = m_kWindow.Reports().size();
    const EBatchStep step = m_kContent.RunBatchFile(Job(), job.source, job.output, index, AllJobs().size());
    const auto reports = std::span(m_kWindow.Reports()).subspan(before);
    const bool good = step == EBatchStep::Done && std::ranges::all_of(reports, &CReport::warning);
    const EConversion outcome = good ? EConversion::Converted : EConversion::Failed;
    WriteRecord(index, outcome, reports, record);
    const bool endsRun = step != EBatchStep::Done && !options.keepGoing;
    return {outcome, endsRun, endsRun && step == EBatchStep::Abandoned};
}

void CBatchRun::WriteRecord(size_t index, EConversion outcome, std::span<const CReport> reports,
                            std::FILE* record)
{
    std::string profile;
    std::string profilePath;
    if (Job() == EBatchJob::ToMotion)
    {
        m_kContent.Profile()->GetProfileName(profile);
        profilePath = m_kContent.ToldProfilePath();
    }
    CJsonWriter json(record);
    json.BeginObject();
    json.Key("source").Text(AllJobs()[index].source);
    json.Key("output").Text(AllJobs()[index].output);
    json.Key("outcome").Text(OutcomeName(outcome));
    json.Key("profile").Text(profile);
    json.Key("profilePath").Text(profilePath);
    json.Key("frames").Integer(Job() == EBatchJob::ToMotion ? m_kContent.ResultMotion().GetKeyCount() : 0);
    WriteReports(json, {reports.begin(), reports.end()});
    json.EndObject();
    json.EndDocument();
}

void CBatchRun::TellLost(size_t index, const CReport& reason, std::FILE* record)
{
    SayReport(Options(), reason);
    WriteRecord(index, EConversion::Failed, {&reason, 1}, record);
}

void CBatchRun::TellUpToDate(size_t index)
{
    SayWord(Options(), Printable(AllJobs()[index].source) + ": skipped, the output is up to date");
}

bool CBatchRun::AddProfiles(CContentHash& key)
{
    if (Job() == EBatchJob::ToMotion)
        key.AddFile(m_kContent.ProfilePath());
    return true;
}

void CBatchRun::TakeRecord(size_t, EConversion, std::string_view record, std::string_view)
{
    ++m_uiTaken;
    ReadReports(record, m_kReports);
}

bool CBatchRun::TellEnd()
{
    const bool good = !IsAbandoned() && Tally()[EConversion::Failed] == 0;
    if (!IsAbandoned())
        m_kContent.TellBatch(Job(), Tally()[EConversion::Converted]);
    return good;
}

} // namespace gw
