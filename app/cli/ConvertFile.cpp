#include "ConvertFile.h"

#include "CBoneMapProfile.h"
#include "CFilePlatform.h"
#include "CJsonWriter.h"
#include "CShellContent.h"
#include "CShellWindow.h"
#include "FitWords.h"
#include "Output.h"
#include "ProfileFit.h"
#include "ReportJson.h"
#include "Text.h"
#include "Words.h"

#include <cstdio>
#include <optional>

namespace gw {

namespace {

constexpr const char* kOutcomeNames[] = {"converted", "planned", "skipped", "failed"};

/// What is told of a conversion.
struct Account
{
    EConversion outcome = EConversion::Failed;
    std::string profile;
    std::string profilePath;
    int frames = 0;
    std::optional<CProfileFit> misfit;
};

bool SelectProfile(const COptions& options, const CConversionJob& job, CShellContent& content,
                   Account& account)
{
    if (!options.profile.empty())
        return content.SelectProfile(options.profile);
    CProfileFit best;
    if (content.SelectFittingProfile(best))
        return true;
    SayNoneFits(job.source, best);
    account.misfit = best;
    return false;
}

// The state of the window's button is the rule; here only the reason is looked for.
bool MayConvert(const CShellWindow& window, const CConversionJob& job)
{
    if (window.IsEnabled("convert"))
        return true;
    if (!window.HasFailed())
        SayError(Printable(job.source) + ": the motion has no frames; there is nothing to convert");
    return false;
}

bool Convert(const CConversionJob& job, CShellWindow& window, CShellContent& content, Account& account)
{
    window.PassOverMissingBones();
    if (content.ConvertMotion() != 0)
        return true;
    CProfileFit fit;
    if (content.Measure(content.ProfilePath(), fit))
    {
        SayMisfit(job.source, fit);
        account.misfit = fit;
    }
    return false;
}

EConversion Run(const COptions& options, const CConversionJob& job, CShellWindow& window, Account& account)
{
    CFilePlatform platform(EPlatformWriting::No, options.dataFolder);
    CShellContent content(window, platform);
    window.SetPaths(job.source, job.output);
    if (content.OpenSource() == 0 || window.HasFailed() || !SelectProfile(options, job, content, account) ||
        !MayConvert(window, job))
        return EConversion::Failed;
    content.Profile()->GetProfileName(account.profile);
    account.profilePath = content.ProfilePath();
    if (options.dryRun)
        return EConversion::Planned;
    if (!Convert(job, window, content, account))
        return EConversion::Failed;
    content.SaveResult();
    account.frames = content.ResultMotion().GetKeyCount();
    return window.HasFailed() ? EConversion::Failed : EConversion::Converted;
}

void Print(const CConversionJob& job, const Account& account)
{
    const std::string paths = Printable(job.source) + " -> " + Printable(job.output);
    if (account.outcome == EConversion::Skipped)
        std::printf("%s: skipped, the output exists\n", paths.c_str());
    else if (account.outcome == EConversion::Planned)
        std::printf("%s: would be converted by profile %s\n", paths.c_str(), Quoted(account.profile).c_str());
    else if (account.outcome == EConversion::Converted)
        std::printf("%s: %d frames by profile %s\n", paths.c_str(), account.frames,
                    Quoted(account.profile).c_str());
}

void WriteJson(const CConversionJob& job, const Account& account, const CShellWindow& window)
{
    CJsonWriter json(stdout);
    json.BeginObject();
    json.Key("source").Text(job.source);
    json.Key("output").Text(job.output);
    json.Key("outcome").Text(kOutcomeNames[static_cast<size_t>(account.outcome)]);
    json.Key("profile").Text(account.profile);
    json.Key("profilePath").Text(account.profilePath);
    json.Key("frames").Integer(account.frames);
    WriteReports(json, window.Reports());
    if (account.misfit)
    {
        json.Key("fit").BeginObject();
        WriteFit(json, *account.misfit);
        json.EndObject();
    }
    json.EndObject();
    json.EndDocument();
}

EConversion Decide(const COptions& options, const CConversionJob& job, CShellWindow& window, Account& account)
{
    if (options.skipExisting && IsTaken(job.output))
        return EConversion::Skipped;
    return MayWrite(options, job.output) ? Run(options, job, window, account) : EConversion::Failed;
}

} // namespace

EConversion ConvertFile(const COptions& options, const CConversionJob& job)
{
    CShellWindow window(options);
    Account account;
    account.outcome = Decide(options, job, window, account);
    if (options.json)
        WriteJson(job, account, window);
    else if (!options.quiet)
        Print(job, account);
    return account.outcome;
}

} // namespace gw
