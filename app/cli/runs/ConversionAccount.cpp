// What is reported about a conversion: the result line and the measurements, or the JSON record.

#include "ConversionAccount.h"

#include "BetterOptions.h"
#include "CJsonWriter.h"
#include "CShellNotices.h"
#include "CheckText.h"
#include "DoubtWords.h"
#include "JsonStatus.h"
#include "NoticeJson.h"
#include "Output.h"
#include "ProfileChoice.h"
#include "ShellOptions.h"
#include "Streams.h"
#include "Text.h"

namespace gw {

namespace {

void PrintChecks(const ConversionAccount& account)
{
    if (account.check)
        PrintCheck(*account.check, "check");
    if (account.plainCheck)
        PrintCheck(*account.plainCheck, "default conversion");
    if (account.check && account.betterCheck)
        std::printf("  %s\n", BetterWords(*account.check, *account.betterCheck).c_str());
}

void WriteChecks(CJsonWriter& json, const ConversionAccount& account)
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

// Adds the confidence after the name of a profile that was chosen automatically, and what was repaired.
std::string ProfileWords(const ConversionAccount& account)
{
    std::string words = account.drafted ? "drafted profile " : "profile ";
    words += Quoted(account.profile);
    if (account.chosen)
        words += std::string(", ") + SurenessName(account.chosen->verdict.sureness);
    if (!account.mended.empty())
        words += ", mended (" + account.mended + ')';
    return words;
}

std::string ResultLine(const ConversionJob& job, const ConversionAccount& account)
{
    const std::string paths = Printable(job.source) + " -> " + Printable(job.output);
    if (account.outcome == EConversion::Skipped)
        return paths + ": skipped, " + account.whySkipped;
    if (account.outcome == EConversion::Planned)
        return paths + ": would be converted by " + ProfileWords(account);
    return paths + ": " + std::to_string(account.frames) + " frames by " + ProfileWords(account);
}

void WriteProfile(CJsonWriter& json, const ConversionAccount& account)
{
    json.Key("profile").Text(account.profile);
    json.Key("profilePath").Text(account.profilePath);
    json.Key("frames").Integer(account.frames);
    if (account.drafted)
        json.Key("drafted").Bool(true);
    if (!account.draftDigits.empty())
        json.Key("draftDigits").Text(account.draftDigits);
    if (!account.mended.empty())
        json.Key("mended").Text(account.mended);
    if (account.chosen)
        WriteVerdict(json, account.chosen->verdict);
}

void WriteOutcome(CJsonWriter& json, const ConversionAccount& account, const CShellNotices& notices)
{
    if (account.outcome == EConversion::Failed)
        WriteStatus(json, OutcomeName(account.outcome), notices.All());
    else
        WriteStatus(json, OutcomeName(account.outcome));
}

void WriteJson(std::FILE* file, const ShellOptions& options, const ConversionJob& job,
               const ConversionAccount& account, const CShellNotices& notices)
{
    CJsonWriter json(file);
    json.BeginObject();
    json.Key("source").Text(job.source);
    json.Key("output").Text(job.output);
    json.Key("outcome").Text(OutcomeName(account.outcome));
    WriteOutcome(json, account, notices);
    if (!options.clip.empty())
        json.Key("clip").Text(options.clip);
    WriteProfile(json, account);
    WriteNotices(json, notices.All());
    if (account.misfit)
    {
        json.Key("fit").BeginObject();
        WriteFit(json, *account.misfit);
        json.EndObject();
    }
    if (account.check && file != stdout)
        WriteKeyFigures(json, *account.check, "figures");
    if (account.betterCheck)
        WriteKeyFigures(json, *account.betterCheck, "betterFigures");
    if (options.check)
        WriteChecks(json, account);
    json.EndObject();
    json.EndDocument();
}

} // namespace

void TellAccount(const ShellOptions& options, const ConversionJob& job, const ConversionAccount& account,
                 const CShellNotices& notices, std::FILE* record)
{
    if (record)
        WriteJson(record, options, job, account, notices);
    if (options.json)
        WriteJson(stdout, options, job, account, notices);
    if (options.json || options.quiet || notices.Voice() != EVoice::Speaks)
        return;
    if (account.outcome != EConversion::Failed)
        PrintResult(options, job.output, ResultLine(job, account));
    if (options.check && !IsStandardOutput(job.output))
        PrintChecks(account);
}

} // namespace gw
