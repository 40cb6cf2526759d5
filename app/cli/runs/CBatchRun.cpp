// Runs the desktop program's batch jobs in worker processes. The outcome is the same as in a single process.

#include "CBatchRun.h"

#include "CContentHash.h"
#include "CJsonWriter.h"
#include "CShellConversion.h"
#include "CShellNotices.h"
#include "CheckText.h"
#include "JsonStatus.h"
#include "NoticeJson.h"
#include "StringTable.h"
#include "Text.h"
#include "Words.h"

#include <algorithm>

namespace gw {

EBatchJob BatchJobOf(const ShellOptions& options)
{
    return options.job == "htr" ? EBatchJob::ToMotion : EBatchJob::ToContainer;
}

bool SelectBatchProfile(const ShellOptions& options, CShellConversion& conversion, const std::string& first)
{
    if (BatchJobOf(options) != EBatchJob::ToMotion)
        return true;
    return (!options.profile.empty() || conversion.Open(first)) && conversion.SelectProfile();
}

CBatchRun::CBatchRun(const ShellOptions& options, Jobs jobs, RunState state, CShellConversion& conversion,
                     CShellNotices& notices)
    : CFileRun(options, std::move(jobs), std::move(state)), conversion_(conversion), ownNotices_(notices)
{
}

// The profile is read from its file again for every source, unless it was adapted and has no file.
EBatchStep CBatchRun::ConvertMotion(const ConversionJob& job)
{
    if (!conversion_.ReadSource(job.source))
        return EBatchStep::Ended;
    conversion_.LoadTarget();
    if (!conversion_.IsAdapted())
        conversion_.RereadProfile();
    if (!conversion_.Convert(true))
        return EBatchStep::Abandoned;
    if (!conversion_.WriteBatchResult(job.output))
        return EBatchStep::Ended;
    if (Options().check)
        check_ = MeasureMotion(MotionOf(conversion_, job), conversion_.ProfilePath());
    return EBatchStep::Done;
}

EBatchStep CBatchRun::RunJob(const ConversionJob& job)
{
    if (BatchJobOf(Options()) == EBatchJob::ToMotion)
        return ConvertMotion(job);
    CFailureRecord record;
    const bool packaged = PackageMotionFile(job.source, job.output, record);
    conversion_.Notify(job.source, record);
    return packaged ? EBatchStep::Done : EBatchStep::Abandoned;
}

// A file whose failure is reported counts as failed. It ends the run only if it would end the desktop
// program's run.
CFileRun::FileEnd CBatchRun::Convert(const ShellOptions& options, size_t index, std::FILE* record)
{
    const ConversionJob& job = AllJobs()[index];
    check_.reset();
    if (IsEachTold())
        SayWord(Options(), Printable(job.source) + " (" + std::to_string(index + 1) + " of " +
                               std::to_string(AllJobs().size()) + ')');
    ownNotices_.SetVoice(Voice());
    const size_t before = ownNotices_.All().size();
    const EBatchStep step = RunJob(job);
    const auto notices = std::span(ownNotices_.All()).subspan(before);
    const bool good = step == EBatchStep::Done && std::ranges::all_of(notices, &Notice::IsWarning);
    const EConversion outcome = good ? EConversion::Converted : EConversion::Failed;
    WriteRecord(index, outcome, notices, record);
    if (options.json)
        WriteRecord(index, outcome, notices, stdout);
    if (check_ && IsEachTold() && !options.quiet && !options.json)
        PrintCheck(*check_, "check");
    const bool endsRun = step != EBatchStep::Done && !options.keepGoing;
    return {outcome, endsRun, endsRun && step == EBatchStep::Abandoned};
}

void CBatchRun::WriteRecord(size_t index, EConversion outcome, std::span<const Notice> notices,
                            std::FILE* record)
{
    const bool converts = BatchJobOf(Options()) == EBatchJob::ToMotion;
    CJsonWriter json(record);
    json.BeginObject();
    json.Key("source").Text(AllJobs()[index].source);
    json.Key("output").Text(AllJobs()[index].output);
    json.Key("outcome").Text(OutcomeName(outcome));
    WriteStatus(json, OutcomeName(outcome), {notices.begin(), notices.end()});
    json.Key("profile").Text(converts ? conversion_.Profile().name : "");
    json.Key("profilePath").Text(converts ? conversion_.ProfilePath() : "");
    json.Key("frames").Integer(converts ? conversion_.Result().GetKeyCount() : 0);
    if (const std::string mended = conversion_.Mended().Words(); !mended.empty())
        json.Key("mended").Text(mended);
    WriteNotices(json, {notices.begin(), notices.end()});
    if (check_)
        WriteKeyFigures(json, *check_, "figures");
    json.EndObject();
    json.EndDocument();
}

void CBatchRun::TellLost(size_t index, const Notice& reason, std::FILE* record)
{
    if (Voice() != EVoice::Silent)
        SayNotice(Options(), reason);
    WriteRecord(index, EConversion::Failed, {&reason, 1}, record);
    if (Options().json)
        WriteRecord(index, EConversion::Failed, {&reason, 1}, stdout);
}

void CBatchRun::TellUpToDate(size_t index)
{
    if (IsEachTold())
        SayWord(Options(), Printable(AllJobs()[index].source) + ": skipped, the output is up to date");
}

bool CBatchRun::AddProfiles(CContentHash& key)
{
    if (BatchJobOf(Options()) == EBatchJob::ToMotion)
        key.AddFile(conversion_.ProfilePath());
    if (conversion_.IsAdapted())
        key.AddText(TextOf(conversion_.Profile()));
    return true;
}

void CBatchRun::TakeRecord(size_t, EConversion, std::string_view record, std::string_view)
{
    ++m_uiTaken;
    ReadNotices(record, m_kNotices);
}

bool CBatchRun::TellEnd()
{
    const bool good = !IsAbandoned() && Tally()[EConversion::Failed] == 0;
    const int message = BatchJobOf(Options()) == EBatchJob::ToMotion ? kConvertedMessage : kPackagedMessage;
    if (!Options().json && !IsEachTold())
        TellSummary();
    const std::string count[] = {std::to_string(Tally()[EConversion::Converted])};
    if (!IsAbandoned())
        SayWord(Options(), FormatText(conversion_.Message(message), count));
    return good;
}

} // namespace gw
