// A worker is the program, started again, so it makes its handler from a description: lines of JSON. The
// first one says what kind of run it is and holds its options, and each other line is a job of the run.

#include "WorkerStart.h"

#include "CBatchRun.h"
#include "CConversionRun.h"
#include "CJsonMembers.h"
#include "CShellConversion.h"
#include "CShellNotices.h"
#include "CWorkerStart.h"
#include "JsonText.h"
#include "OptionJson.h"
#include "PageOutputDetails.h"
#include "Text.h"

#include <charconv>
#include <cstdlib>
#include <memory>
#include <string>

namespace gw {

namespace {

constexpr std::string_view kConversionRun = "convert";
constexpr std::string_view kBatchRun = "batch";
constexpr std::string_view kDetails = "details";
constexpr uint64_t kAllOptions = ~uint64_t{0};

void AddShelf(CJsonLine& head, const CDraftShelf* shelf)
{
    if (!shelf)
        return;
    const DraftShelfLink link = shelf->Link();
    head.Add("drafts", link.folder)
        .Add("draftsAreTemporary", link.isTemporary ? 1 : 0)
        .Add("draftMemory", link.memory)
        .Add("draftJobs", link.jobCount);
}

// Returns false if the run has no shelf.
bool TakeShelf(const CJsonMembers& head, DraftShelfLink& link)
{
    uint64_t isTemporary = 0;
    uint64_t jobCount = 0;
    const bool has = head.TakeText("drafts", link.folder) && head.TakeText("draftMemory", link.memory) &&
                     head.TakeCount("draftsAreTemporary", isTemporary) &&
                     head.TakeCount("draftJobs", jobCount);
    link.isTemporary = isTemporary != 0;
    link.jobCount = jobCount;
    return has;
}

std::string JobLines(std::span<const ConversionJob> jobs)
{
    std::string lines;
    for (const ConversionJob& job : jobs)
    {
        CJsonLine line;
        line.Add("source", job.source).Add("output", job.output).Add("clip", job.clip);
        lines += line.Text() + '\n';
    }
    return lines;
}

std::string TextIn(const CJsonMembers& members, std::string_view key)
{
    std::string text;
    members.TakeText(key, text);
    return text;
}

// The parts of a description.
struct Task
{
    CJsonMembers head;
    ShellOptions options;
    std::vector<ConversionJob> jobs;
};

bool ReadTask(std::string_view text, Task& task)
{
    std::string_view line;
    if (!NextLine(text, line) || task.head.Read(line) != EFailure::None)
        return false;
    const CJsonMembers::Member* const options = task.head.Find("options");
    std::string wrong;
    if (!options || !ReadOptionsJson(options->text, kAllOptions, task.options, wrong))
        return false;
    while (NextLine(text, line))
    {
        CJsonMembers job;
        if (job.Read(line) != EFailure::None)
            return false;
        task.jobs.push_back({TextIn(job, "source"), TextIn(job, "output"), TextIn(job, "clip")});
    }
    return true;
}

void ServeRun(const CWorkerStart& start, const Task& task, CFileRun& run)
{
    run.BeginInWorker(task.head);
    start.Serve(run);
}

void ServeConversion(const CWorkerStart& start, const Task& task)
{
    const RunState state{TextIn(task.head, "stateFolder"), TextIn(task.head, "stateName")};
    CConversionRun run(task.options, task.jobs, state);
    ServeRun(start, task, run);
}

// The profile is selected as in the program, which has reported what there is to say about it. A profile with
// a file is named by it.
void ServeBatch(const CWorkerStart& start, Task& task)
{
    const std::string profile = TextIn(task.head, "profile");
    if (!profile.empty())
        task.options.profile = profile;
    CShellNotices notices(task.options, EVoice::Silent);
    CShellConversion conversion(task.options, ChoicesOf(task.options), notices);
    if (task.jobs.empty() || !SelectBatchProfile(task.options, conversion, task.jobs.front().source))
        return;
    const RunState state{TextIn(task.head, "stateFolder"), TextIn(task.head, "stateName")};
    CBatchRun run(task.options, task.jobs, state, conversion, notices);
    ServeRun(start, task, run);
}

void ServeDetails(const CWorkerStart& start, const Task& task)
{
    std::vector<size_t> worst;
    const std::string list = TextIn(task.head, "worst");
    std::string_view rest = list;
    for (std::string_view word = NextToken(rest, ","); !word.empty(); word = NextToken(rest, ","))
        std::from_chars(word.data(), word.data() + word.size(), worst.emplace_back());
    std::optional<CDraftShelf> drafts;
    if (DraftShelfLink link; TakeShelf(task.head, link))
        drafts.emplace(link);
    CDetailHandler handler(task.options, task.jobs, drafts ? &*drafts : nullptr, worst, nullptr);
    start.Serve(handler);
}

} // namespace

void ServeIfWorker(int argc, char** argv)
{
    CWorkerStart start;
    if (argc != 3 || std::string_view(argv[1]) != kWorkerArgument || !start.Read(argv[2]))
        return;
    Task task;
    if (!ReadTask(start.Description(), task))
        std::_Exit(2);
    const std::string kind = TextIn(task.head, "run");
    if (kind == kDetails)
        ServeDetails(start, task);
    else if (kind == kBatchRun)
        ServeBatch(start, task);
    else
        ServeConversion(start, task);
    std::_Exit(2); // without serving
}

std::string CFileRun::Description() const
{
    const auto* const batch = dynamic_cast<const CBatchRun*>(this);
    CJsonLine head;
    head.Add("run", batch ? kBatchRun : kConversionRun)
        .AddJson("options", OptionsJson(options_, kAllOptions));
    head.Add("stateFolder", m_kState.folder).Add("stateName", m_kState.name).Add("key", m_kCommonKey);
    if (batch && !batch->Conversion().IsAdapted())
        head.Add("profile", batch->Conversion().ProfilePath());
    AddShelf(head, m_kDrafts ? &*m_kDrafts : nullptr);
    return head.Text() + '\n' + JobLines(m_kJobs);
}

void CFileRun::BeginInWorker(const CJsonMembers& head)
{
    m_kCommonKey = TextIn(head, "key");
    if (options_.resume)
    {
        m_kResume.Read(m_kState.folder);
        if (!options_.dryRun)
            m_kResume.Open(m_kState.folder, m_kState.name);
    }
    if (DraftShelfLink link; TakeShelf(head, link))
        m_kDrafts.emplace(link);
}

std::string CDetailHandler::Description() const
{
    CJsonLine head;
    std::string worst;
    for (const size_t index : m_kWorst)
        worst += std::to_string(index) + ',';
    head.Add("run", kDetails).AddJson("options", OptionsJson(options_, kAllOptions)).Add("worst", worst);
    AddShelf(head, drafts_);
    return head.Text() + '\n' + JobLines(jobs_);
}

} // namespace gw
