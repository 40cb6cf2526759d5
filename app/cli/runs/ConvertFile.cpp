// One conversion of the shell program: open, choose a profile, convert, save, measure. Each step runs only if
// the previous one succeeded. The outcome becomes the result line, the JSON record and a part of the page.

#include "ConvertFile.h"

#include "BetterOptions.h"
#include "CContentHash.h"
#include "CDraftShelf.h"
#include "CNode.h"
#include "COutputFile.h"
#include "CPagePart.h"
#include "CShellConversion.h"
#include "CShellNotices.h"
#include "CheckResult.h"
#include "ConversionAccount.h"
#include "Output.h"
#include "Paths.h"
#include "ResultExtension.h"
#include "ResultSize.h"
#include "Streams.h"
#include "Words.h"

#include <algorithm>
#include <array>
#include <optional>

namespace gw {

namespace {

constexpr const char* kOutcomeNames[] = {"converted", "would_convert", "skipped", "failed"};

// Keeps a motion reachable until exit instead of freeing it: the system frees a whole process faster, and
// deleting object by object takes three percent of a small conversion. Only for the last work of a process,
// and not for scenes, whose pictures can have temporary files.
void KeepUntilExit(CNode* root)
{
    static std::array<CNode*, 3> keptRoots{}; // reachable memory is not a leak
    const auto free = std::ranges::find(keptRoots, nullptr);
    if (!root || free == keptRoots.end())
        return;
    root->Retain();
    *free = root;
}

int FrameCount(const MotionEdits& edits, int all)
{
    const int64_t end = std::min<int64_t>(edits.lastFrame, all - 1) + 1;
    return static_cast<int>(std::max<int64_t>(end - edits.firstFrame, 0));
}

// A pipe or device is not a result of an earlier run.
bool IsSkipped(const ShellOptions& options, const std::string& output)
{
    return options.skipExisting && IsTaken(output) && !IsStream(output);
}

std::optional<Notice> WhyNotConvert(const ShellOptions& options, const ConversionJob& job)
{
    if (IsStream(job.output))
        return std::nullopt;
    if (IsSameFile(job.source, job.output))
        return MakeNotice(job.output, "own-source", "this is the source; choose another name for the result");
    return WhyNotWrite(options, job.output);
}

// Runs one job in steps. Each step returns whether the next one may run.
class CJobSteps
{
public:
    CJobSteps(const ShellOptions& options, const ConversionJob& job, CShellNotices& notices,
              ConversionAccount& account, const ConversionTools& tools)
        : options_(options), job_(job), notices_(notices), account_(account), tools_(tools),
          m_kConversion(options, ChoicesOf(options), notices)
    {
        if (tools.drafts)
            m_kConversion.UseDrafts(*tools.drafts);
    }

    /// For a process's only conversion.
    void KeepMotionsUntilExit() const
    {
        if (HasExtension(m_kConversion.ReadPath(), ".orn"))
            return;
        KeepUntilExit(m_kConversion.SourceRoot());
        KeepUntilExit(m_kConversion.Result().motionRoot.Get());
        if (m_kConversion.DrivingRoot() != m_kConversion.SourceRoot()) // an aligned copy
            KeepUntilExit(m_kConversion.DrivingRoot());
    }

    EConversion Run()
    {
        if (!m_kConversion.Open(job_.source) || !SelectProfile() || !m_kConversion.HasFrames() || !MayFit())
            return EConversion::Failed;
        if (options_.dryRun)
            return EConversion::Planned;
        if (!Convert())
            return EConversion::Failed;
        COutputFile output;
        if (!output.Open(job_.output, ResultExtension(options_, job_.output)))
            return Fail(output.Failure());
        notices_.ShowAs(output.Path(), job_.output);
        // Another run may have made it meanwhile, such as the workers of a killed one, and may do so until
        // the end.
        bool taken = IsSkipped(options_, job_.output);
        const bool written =
            !taken && m_kConversion.WriteEdited(output.Path(), options_.skipExisting ? &taken : nullptr);
        if (taken)
            return EConversion::Skipped;
        if (!written || notices_.HasFailed())
            return EConversion::Failed;
        if (!output.Deliver())
            return Fail(output.Failure());
        if (IsMeasured())
            Check();
        return EConversion::Converted;
    }

    /// Converts without saving, and draws.
    void Draw()
    {
        if (m_kConversion.Open(job_.source) && SelectProfile() && m_kConversion.HasFrames() && MayFit() &&
            Convert())
            Check();
    }

private:
    EConversion Fail(const Notice& reason)
    {
        notices_.Add(reason);
        return EConversion::Failed;
    }
    bool SelectProfile();
    bool Convert();
    // A later run with --resume may write a report, so measure for it.
    bool IsMeasured() const
    {
        return options_.check || tools_.part || !options_.html.empty() || !options_.report.empty() ||
               options_.resume;
    }
    void Check();
    void CheckOtherOptions();
    bool MayFit();

    const ShellOptions& options_;
    const ConversionJob& job_;
    CShellNotices& notices_;
    ConversionAccount& account_;
    const ConversionTools& tools_;
    CShellConversion m_kConversion;
};

bool CJobSteps::SelectProfile()
{
    const bool selected = m_kConversion.SelectProfile();
    account_.misfit = m_kConversion.Nearest();
    account_.profile = m_kConversion.Profile().name;
    account_.chosen = m_kConversion.Chosen();
    account_.drafted = m_kConversion.IsDrafted();
    account_.mended = m_kConversion.Mended().Words();
    if (!account_.drafted || tools_.drafts->IsKept())
        account_.profilePath = m_kConversion.ProfilePath();
    if (account_.drafted && tools_.drafts->IsKept())
        account_.draftDigits = FileDigits(account_.profilePath);
    if (tools_.drafts)
        tools_.drafts->SettleCurrent(); // later sources need not wait any longer
    return selected;
}

bool CJobSteps::MayFit()
{
    const std::optional<Notice> refusal = WhyTooLarge(m_kConversion, job_);
    if (refusal)
        notices_.Add(*refusal);
    return !refusal;
}

bool CJobSteps::Convert()
{
    if (!m_kConversion.Convert(!options_.noLegs))
    {
        CProfileFit fit;
        if (!m_kConversion.IsAdapted() && m_kConversion.Measure(m_kConversion.ProfilePath(), fit) &&
            !fit.missing.empty())
            account_.misfit = fit;
        return false;
    }
    if (notices_.HasFailed())
        return false;
    const MotionEdits edits = m_kConversion.Edits();
    account_.frames = FrameCount(edits, m_kConversion.Result().GetKeyCount());
    return m_kConversion.HasFrames();
}

// Must not run before saving, because measuring poses both trees.
void CJobSteps::Check()
{
    ConvertedMotion motion = MotionOf(m_kConversion, job_);
    account_.check = MeasureMotion(motion, m_kConversion.ProfilePath());
    if (!account_.check)
        return;
    if (options_.check || tools_.part)
        CheckOtherOptions();
    motion.profile = account_.profile;
    motion.measured = &*account_.check;
    motion.plain = account_.plainCheck ? &*account_.plainCheck : nullptr;
    if (account_.betterCheck)
        motion.advice = BetterWords(*account_.check, *account_.betterCheck);
    if (!tools_.part)
        return;
    motion.model = ModelLink(options_.html, job_.output);
    tools_.part->Show(motion);
}

// Measures what the default conversion gave, or what more options would give.
void CJobSteps::CheckOtherOptions()
{
    if (options_.align || options_.faithful)
        account_.plainCheck = MeasureAnew(options_, {}, job_, m_kConversion);
    if (!MayBeBetter(options_, *account_.check))
        return;
    account_.betterCheck = MeasureAnew(options_, {true, true, !options_.noHands}, job_, m_kConversion);
    if (account_.betterCheck && !IsBetter(*account_.check, *account_.betterCheck))
        account_.betterCheck.reset();
}

EConversion Decide(const ShellOptions& options, const ConversionJob& job, CShellNotices& notices,
                   ConversionAccount& account, const ConversionTools& tools)
{
    if (IsSkipped(options, job.output))
        return EConversion::Skipped;
    const std::optional<Notice> refusal = WhyNotConvert(options, job);
    if (refusal)
    {
        notices.Add(*refusal);
        return EConversion::Failed;
    }
    CJobSteps steps(options, job, notices, account, tools);
    const EConversion outcome = steps.Run();
    if (tools.process == EProcess::Ends)
        steps.KeepMotionsUntilExit();
    return outcome;
}

} // namespace

const char* OutcomeName(EConversion outcome)
{
    return kOutcomeNames[static_cast<size_t>(outcome)];
}

EConversion ConvertFile(const ShellOptions& given, const ConversionJob& job, const ConversionTools& tools)
{
    ShellOptions options = given;
    if (!job.clip.empty())
        options.clip = job.clip;
    CShellNotices notices(options, tools.voice);
    ConversionAccount account;
    account.outcome = Decide(options, job, notices, account, tools);
    TellAccount(options, job, account, notices, tools.record);
    return account.outcome;
}

void DrawConversion(const ShellOptions& options, const ConversionJob& job, const ConversionTools& tools)
{
    CShellNotices notices(options, tools.voice);
    ConversionAccount account;
    CJobSteps(options, job, notices, account, tools).Draw();
}

void TellFailed(const ShellOptions& options, const ConversionJob& job, const Notice& reason,
                const ConversionTools& tools)
{
    CShellNotices notices(options, tools.voice);
    notices.Add(reason);
    TellAccount(options, job, {}, notices, tools.record);
}

void TellSkipped(const ShellOptions& options, const ConversionJob& job, const char* why, EVoice voice)
{
    ConversionAccount account;
    account.outcome = EConversion::Skipped;
    account.whySkipped = why;
    TellAccount(options, job, account, CShellNotices(options, voice), nullptr);
}

} // namespace gw
