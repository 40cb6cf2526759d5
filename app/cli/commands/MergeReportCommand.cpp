// `merge-report`: joins the reports of a plan's shards. Lines are matched to the plan by output, so the order
// of the reports does not matter, and a source reported twice counts with its last line.

#include "CConversionPage.h"
#include "CDraftShelf.h"
#include "CMappedFile.h"
#include "CRunSummary.h"
#include "CSafeFile.h"
#include "CommandTable.h"
#include "Notice.h"
#include "NoticeJson.h"
#include "OptionJson.h"
#include "Output.h"
#include "PageOutput.h"
#include "PageOutputDetails.h"
#include "PageOutputRow.h"
#include "Paths.h"
#include "PlanFile.h"
#include "RunSetup.h"
#include "RunTally.h"
#include "SystemError.h"
#include "Text.h"
#include "Words.h"

#include <algorithm>
#include <cstdio>
#include <optional>
#include <unordered_map>

namespace gw {

namespace {

/// The last report line for an output.
struct RunLine
{
    std::string text;
    EConversion outcome = EConversion::Failed;
};

using Lines = std::unordered_map<std::string, RunLine>; // keyed by output

// A line truncated by a killed run is skipped, and one nested too deeply was not written by a run.
bool TakeLine(std::string_view text, Lines& lines)
{
    std::string output;
    std::string outcome;
    const EFailure failure = ReadReportLine(text, output, outcome);
    for (const EConversion end : {EConversion::Converted, EConversion::Skipped, EConversion::Failed})
    {
        if (failure == EFailure::None && outcome == OutcomeName(end))
            lines[output] = {std::string(text), end};
    }
    return failure != EFailure::TooDeep;
}

bool ReadReport(const std::string& path, Lines& lines)
{
    CMappedFile file;
    if (file.Open(path) != EFailure::None)
        return false;
    std::string_view rest = file.Text();
    size_t number = 0;
    for (std::string_view line; NextLine(rest, line);)
    {
        ++number;
        if (!TakeLine(line, lines))
            SayError({}, "bad-report",
                     Printable(path) + ':' + std::to_string(number) +
                         ": this line is nested too deeply for a report and was skipped");
    }
    return true;
}

// A shard that has not run has no report yet. Its sources are counted as left, with a message.
bool ReadReports(const ShellOptions& options, const CRunPlan& plan, Lines& lines)
{
    const std::span named = std::span(options.files).subspan(1);
    for (const std::string& path : named)
    {
        if (ReadReport(path, lines))
            continue;
        SayError(path, "unreadable-report", "the report cannot be read" + TakeSystemErrorWords());
        return false;
    }
    for (size_t shard = 0; named.empty() && shard < plan.shardCount; ++shard)
        ReadReport(ShardReport(options.files[0], shard), lines);
    return true;
}

void SayNotices(const ShellOptions& options, const std::string& line)
{
    std::vector<Notice> notices;
    ReadNotices(line, notices);
    for (const Notice& notice : notices)
        SayNotice(options, notice);
}

// Sorts the lines in plan order and counts their results.
std::string Join(const ShellOptions& options, const CRunPlan& plan, const Lines& lines, RunTally& tally,
                 CRunSummary& summary, CConversionPage& page)
{
    std::string joined;
    for (const CRunPlan::Entry& entry : plan.entries)
    {
        const auto found = lines.find(entry.output);
        if (found == lines.end())
        {
            ++tally.left;
            page.Add({.source = entry.source, .outcome = "left"});
            continue;
        }
        ++tally[found->second.outcome];
        joined += found->second.text + '\n';
        summary.Take(entry.source, found->second.outcome, found->second.text);
        page.Add(PageRowOf(entry.source, OutcomeName(found->second.outcome), found->second.text));
        if (options.verbose)
            SayNotices(options, found->second.text);
    }
    return joined;
}

void SayLeft(const CRunPlan& plan, const Lines& lines)
{
    std::vector<size_t> left(plan.shardCount);
    for (const CRunPlan::Entry& entry : plan.entries)
        left[entry.shard] += lines.contains(entry.output) ? 0 : 1;
    for (size_t shard = 0; shard < left.size(); ++shard)
    {
        if (left[shard] > 0)
            SayError({}, "unfinished",
                     "shard " + std::to_string(shard) + ": " + std::to_string(left[shard]) +
                         " sources are left; run it again");
    }
}

bool Write(const ShellOptions& options, const std::string& joined)
{
    if (options.output.empty())
    {
        std::fwrite(joined.data(), 1, joined.size(), stdout);
        return true;
    }
    CSafeFile file;
    if (file.Open(options.output) && file.Write(joined) && file.Commit())
        return true;
    SayError(options.output, "write-error", "the report cannot be written" + TakeSystemErrorWords());
    return false;
}

// Draws what can be drawn here: sources that another machine alone has get no details.
bool WriteRunPage(const ShellOptions& planned, const CRunPlan& plan, CConversionPage& page)
{
    std::vector<ConversionJob> jobs;
    for (const CRunPlan::Entry& entry : plan.entries)
        jobs.push_back({entry.source, entry.output});
    std::optional<CDraftShelf> drafts;
    if (planned.draft)
    {
        const std::string folder =
            plan.outputFolder.empty() ? SplitPath(planned.files[0]).folder : plan.outputFolder;
        drafts.emplace(planned.drafts.empty() ? ResumeDrafts(folder) : planned.drafts, jobs.size());
        for (size_t job = 0; job < jobs.size(); ++job)
            drafts->Settle(job); // the shards have kept their drafts
    }
    AddPageDetails(planned, jobs, drafts ? &*drafts : nullptr, page);
    return WritePage(planned, page);
}

} // namespace

EExit RunMergeReport(const ShellOptions& options)
{
    if (const EExit page = CheckPagePath(options); page != EExit::Done)
        return page;
    CRunPlan plan;
    Lines lines;
    if (!HasPageFolder(options) || !LoadPlan(options.files[0], plan) || !ReadReports(options, plan, lines))
        return EExit::Failed;
    if (!options.output.empty() && !MayWrite(options, options.output))
        return EExit::Failed;
    RunTally tally;
    CRunSummary summary;
    CConversionPage page;
    if (!Write(options, Join(options, plan, lines, tally, summary, page)))
        return EExit::Failed;
    SayLeft(plan, lines);
    std::string wrong;
    ShellOptions planned = options; // the summary depends on the options of the run
    ReadOptionsJson(plan.options, ~kHowToRun, planned, wrong);
    summary.Tell(planned, tally, options.verbose);
    if (IsPageAsked(options) && !WriteRunPage(planned, plan, page))
        return EExit::Failed;
    return tally[EConversion::Failed] + tally.left == 0 ? EExit::Done : EExit::Failed;
}

} // namespace gw
