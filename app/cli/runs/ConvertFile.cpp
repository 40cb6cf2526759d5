// One conversion of the shell program: open, choose a profile, convert, save, measure. Each step runs only if
// the previous one succeeded. The outcome becomes the result line, the JSON record and a part of the page.

#include "ConvertFile.h"

#include "CJsonWriter.h"
#include "CNode.h"
#include "CPagePart.h"
#include "CShellConversion.h"
#include "CShellNotices.h"
#include "CheckResult.h"
#include "CheckText.h"
#include "DoubtWords.h"
#include "NoticeJson.h"
#include "Output.h"
#include "Paths.h"
#include "ProfileChoice.h"
#include "ProfileFit.h"
#include "ResultSize.h"
#include "Text.h"
#include "Words.h"

#include <algorithm>
#include <array>
#include <cstdio>
#include <optional>

namespace gw {

namespace {

constexpr const char* kOutcomeNames[] = {"converted", "planned", "skipped", "failed"};

/// The facts that are reported about a conversion.
struct Account
{
    EConversion outcome = EConversion::Failed;
    std::string profile;
    std::string profilePath;
    int frames = 0;
    std::optional<CProfileFit> misfit;
    std::optional<MeasuredConversion> check;
    std::optional<MeasuredConversion> plainCheck; // for the same motion without options
    std::optional<ProfileChoice> chosen; ///< no value if the profile was named or is an original stock one
    const char* whySkipped = "the output exists";
};

// Keeps a motion reachable until exit instead of freeing it: the system frees a whole process faster, and
// deleting object by object takes three percent of a small conversion. Only for the last work of a process,
// and not for scenes, whose pictures can have temporary files.
void KeepUntilExit(CNode* root)
{
    static std::array<CNode*, 2> keptRoots{}; // reachable memory is not a leak
    const auto free = std::ranges::find(keptRoots, nullptr);
    if (!root || free == keptRoots.end())
        return;
    root->Retain();
    *free = root;
}

// Runs one job in steps. Each step returns whether the next one may run.
class CJobSteps
{
public:
    CJobSteps(const ShellOptions& options, const ConversionJob& job, CShellNotices& notices, Account& account,
              CPagePart* part)
        : options_(options), job_(job), notices_(notices), account_(account), m_pkPart(part),
          m_kConversion(options, {options.align, options.faithful, !options.noHands}, notices)
    {
    }

    /// For a process's only conversion.
    void KeepMotionsUntilExit() const
    {
        if (HasExtension(job_.source, ".orn"))
            return;
        KeepUntilExit(m_kConversion.SourceRoot());
        KeepUntilExit(m_kConversion.Result().motionRoot.Get());
    }

    EConversion Run()
    {
        if (!m_kConversion.Open(job_.source) || !SelectProfile() || !m_kConversion.HasFrames() || !MayFit())
            return EConversion::Failed;
        if (options_.dryRun)
            return EConversion::Planned;
        if (!Convert())
            return EConversion::Failed;
        // Another run may have made it meanwhile, such as the workers of a killed one, and may do so until
        // the end.
        bool taken = options_.skipExisting && IsTaken(job_.output);
        const bool written =
            !taken && m_kConversion.WriteResult(job_.output, options_.skipExisting ? &taken : nullptr);
        if (taken)
            return EConversion::Skipped;
        if (!written || notices_.HasFailed())
            return EConversion::Failed;
        if (IsMeasured())
            Check();
        return EConversion::Converted;
    }

private:
    bool SelectProfile();
    bool Convert();
    // A later run with --resume may write a report, so measure for it.
    bool IsMeasured() const
    {
        return options_.check || m_pkPart || !options_.report.empty() || options_.resume;
    }
    void Check();
    bool MayFit();

    const ShellOptions& options_;
    const ConversionJob& job_;
    CShellNotices& notices_;
    Account& account_;
    CPagePart* m_pkPart; // null if no page was requested
    CShellConversion m_kConversion;
};

bool CJobSteps::SelectProfile()
{
    const bool selected = m_kConversion.SelectProfile();
    account_.misfit = m_kConversion.Nearest();
    account_.profile = m_kConversion.Profile().name;
    account_.chosen = m_kConversion.Chosen();
    account_.profilePath = m_kConversion.ProfilePath();
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
    account_.frames = m_kConversion.Result().GetKeyCount();
    return m_kConversion.HasFrames();
}

// Must run after saving, because measuring poses both trees.
void CJobSteps::Check()
{
    ConvertedMotion motion = MotionOf(m_kConversion, job_);
    account_.check = MeasureMotion(motion, account_.profilePath);
    if (!account_.check)
        return;
    if (options_.check || m_pkPart)
        account_.plainCheck = MeasurePlainRules(options_, job_, account_.profilePath);
    motion.profile = account_.profile;
    motion.measured = &*account_.check;
    motion.plain = account_.plainCheck ? &*account_.plainCheck : nullptr;
    if (m_pkPart)
        m_pkPart->Show(motion);
}

EConversion Decide(const ShellOptions& options, const ConversionJob& job, CShellNotices& notices,
                   Account& account, CPagePart* part, EProcess process)
{
    if (options.skipExisting && IsTaken(job.output))
        return EConversion::Skipped;
    const std::optional<Notice> refusal = WhyNotWrite(options, job.output);
    if (refusal)
    {
        notices.Add(*refusal);
        return EConversion::Failed;
    }
    CJobSteps steps(options, job, notices, account, part);
    const EConversion outcome = steps.Run();
    if (process == EProcess::Ends)
        steps.KeepMotionsUntilExit();
    return outcome;
}

void PrintChecks(const Account& account)
{
    if (account.check)
        PrintCheck(*account.check, "check");
    if (account.plainCheck)
        PrintCheck(*account.plainCheck, "default conversion");
}

void WriteChecks(CJsonWriter& json, const Account& account)
{
    if (!account.check)
        return;
    json.Key("check").BeginObject();
    WriteCheck(json, *account.check);
    json.EndObject();
    if (!account.plainCheck)
        return;
    json.Key("plainCheck").BeginObject();
    WriteCheck(json, *account.plainCheck);
    json.EndObject();
}

// Adds the confidence after the name of a profile that was chosen automatically.
std::string ProfileWords(const Account& account)
{
    const std::string name = Quoted(account.profile);
    return account.chosen ? name + ", " + SurenessName(account.chosen->verdict.sureness) : name;
}

void Print(const ConversionJob& job, const Account& account)
{
    const std::string paths = Printable(job.source) + " -> " + Printable(job.output);
    if (account.outcome == EConversion::Skipped)
        std::printf("%s: skipped, %s\n", paths.c_str(), account.whySkipped);
    else if (account.outcome == EConversion::Planned)
        std::printf("%s: would be converted by profile %s\n", paths.c_str(), ProfileWords(account).c_str());
    else if (account.outcome == EConversion::Converted)
        std::printf("%s: %d frames by profile %s\n", paths.c_str(), account.frames,
                    ProfileWords(account).c_str());
}

void WriteJson(std::FILE* file, const ShellOptions& options, const ConversionJob& job, const Account& account,
               const CShellNotices& notices)
{
    CJsonWriter json(file);
    json.BeginObject();
    json.Key("source").Text(job.source);
    json.Key("output").Text(job.output);
    json.Key("outcome").Text(OutcomeName(account.outcome));
    json.Key("profile").Text(account.profile);
    json.Key("profilePath").Text(account.profilePath);
    json.Key("frames").Integer(account.frames);
    if (account.chosen)
        WriteVerdict(json, account.chosen->verdict);
    WriteNotices(json, notices.All());
    if (account.misfit)
    {
        json.Key("fit").BeginObject();
        WriteFit(json, *account.misfit);
        json.EndObject();
    }
    if (account.check && file != stdout)
        WriteKeyFigures(json, *account.check);
    if (options.check)
        WriteChecks(json, account);
    json.EndObject();
    json.EndDocument();
}

void Tell(const ShellOptions& options, const ConversionJob& job, const Account& account,
          const CShellNotices& notices, std::FILE* record)
{
    if (record)
        WriteJson(record, options, job, account, notices);
    if (options.json)
        WriteJson(stdout, options, job, account, notices);
    if (options.json || options.quiet)
        return;
    Print(job, account);
    if (options.check)
        PrintChecks(account);
}

} // namespace

const char* OutcomeName(EConversion outcome)
{
    return kOutcomeNames[static_cast<size_t>(outcome)];
}

EConversion ConvertFile(const ShellOptions& options, const ConversionJob& job, std::FILE* record,
                        CPagePart* part, EProcess process)
{
    CShellNotices notices(options);
    Account account;
    account.outcome = Decide(options, job, notices, account, part, process);
    Tell(options, job, account, notices, record);
    return account.outcome;
}

void TellFailed(const ShellOptions& options, const ConversionJob& job, const Notice& reason,
                std::FILE* record)
{
    CShellNotices notices(options);
    notices.Add(reason);
    Tell(options, job, {}, notices, record);
}

void TellSkipped(const ShellOptions& options, const ConversionJob& job, const char* why)
{
    Account account;
    account.outcome = EConversion::Skipped;
    account.whySkipped = why;
    Tell(options, job, account, CShellNotices(options), nullptr);
}

} // namespace gw
